// The tests use the system's Chromium. The built page is in a folder, where absolute paths do not load, and under the content
// security policy of vite.config.js, whose violations the browser reports as errors.
import { defineConfig } from '@playwright/test';

export default defineConfig({
    testDir: '.',
    outputDir: '../../build/web/test-results',
    workers: 2,
    fullyParallel: true,
    timeout: 90_000,
    expect: { timeout: 20_000 },
    use: {
        baseURL: `http://localhost:${process.env.SITE_PORT}/some/where/`,
        viewport: { width: 200, height: 300 },
        actionTimeout: 20_000,
        launchOptions: {
            executablePath: process.env.CHROMIUM ?? '/usr/bin/chromium',
            args: ['--headless=new', '--no-sandbox', '--use-angle=swiftshader', '--enable-unsafe-swiftshader', '--disable-quic',
                '--no-first-run', '--disable-background-networking', '--disable-component-update', '--disable-sync'],
        },
    },
    webServer: {
        command: 'npx vite preview --host localhost --port 0 --base /some/where/',  // any free port
        cwd: new URL('..', import.meta.url).pathname,
        wait: { stdout: /localhost:(\x1b\[1m)?(?<SITE_PORT>\d+)/ },  // the number is printed in bold
    },
});
