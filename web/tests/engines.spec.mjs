// Tests of the playground in Debian's Firefox and WebKitGTK, which Playwright cannot drive.
import { writeFileSync } from 'node:fs';
import { expect, test } from '@playwright/test';
import { PNG } from 'pngjs';
import puppeteer from 'puppeteer-core';
import { Builder, By } from 'selenium-webdriver';
import { DriverService } from 'selenium-webdriver/remote/index.js';
import { screenshotPath } from './page.mjs';

// The sandboxes of both engines block software graphics.
const env = { ...process.env, LIBGL_ALWAYS_SOFTWARE: '1', WEBKIT_DISABLE_SANDBOX_THIS_IS_DANGEROUS: '1' };

const watch = () => {
    window.problems = [];
    console.error = console.warn = onerror = (...words) => window.problems.push(words.join(' '));
    onunhandledrejection = ({ reason }) => window.problems.push(String(reason));
};

// Both functions add the functions that end their processes to `started`.
async function firefox(started) {
    const extraPrefsFirefox = { 'webgl.force-enabled': true, 'webgl.disable-fail-if-major-performance-caveat': true, 'security.sandbox.content.level': 0 };
    const browser = await puppeteer.launch({ browser: 'firefox', executablePath: '/usr/bin/firefox-esr', headless: false, env, extraPrefsFirefox });
    started.push(() => browser.close());
    const [page] = await browser.pages();
    await page.evaluateOnNewDocument(watch);
    return {
        resize: (width, height) => page.setViewport({ width, height }),
        show: (url) => page.goto(url),
        run: (action) => page.evaluate(action),
        async drag(y, from, to) {
            await page.mouse.move(from, y);
            await page.mouse.down();
            await page.mouse.move(to, y, { steps: 3 });
            await page.mouse.up();
        },
        pick: async (file) => (await page.$('#files')).uploadFile(file),
        look: async () => Buffer.from(await page.screenshot()),
    };
}

async function webkit(started) {
    const service = new DriverService.Builder('/usr/bin/WebKitWebDriver').setEnvironment(env).setLoopback(true).build();
    started.push(() => service.kill());
    const options = { binary: '/usr/lib/x86_64-linux-gnu/webkit2gtk-4.1/MiniBrowser', args: ['--automation', '--enable-webgl=true'] };
    const capabilities = { browserName: 'MiniBrowser', 'webkitgtk:browserOptions': options };
    const driver = await new Builder().usingServer(await service.start()).withCapabilities(capabilities).build();
    started.push(() => driver.quit());
    return {
        resize: (width, height) => driver.manage().window().setRect({ x: 0, y: 0, width, height }),
        show: async (url) => (await driver.get(url), driver.executeScript(watch)),  // this driver runs no script before the page's
        run: (action) => driver.executeScript(action),
        drag: (y, from, to) => driver.actions().move({ x: from, y }).press().move({ x: to, y }).release().perform(),
        pick: async (file) => (await driver.findElement(By.id('files'))).sendKeys(file),
        look: async () => Buffer.from(await driver.takeScreenshot(), 'base64'),
    };
}

for (const [name, start] of Object.entries({ firefox, webkit })) {
    test(`the playground in ${name}`, async ({ baseURL }, info) => {
        test.slow();
        const started = [];
        try {
            const engine = await start(started);
            const { run, look } = engine;
            const message = () => run(() => document.querySelector('#message').textContent);
            const calm = () => run(() => window.tidemark.water.water.calm);
            // The lowest red along a line across the water.
            const red = async () => {
                const { width, data } = PNG.sync.read(await look());
                return Math.min(...Array.from({ length: 200 }, (_, x) => data[4 * (300 * width + 80 + x)]));
            };
            for (const [size, ...extent] of [['desktop', 1200, 900], ['small-phone', 320, 568], ['phone', 390, 844]]) {
                await engine.resize(...extent);
                // The settings keep the colours of a photo, without a breeze. The new address loads the page again.
                await engine.show(`${baseURL}?${size}#wet=0&groundRed=1&groundGreen=1&breeze=0`);
                await expect.poll(() => run(() => document.querySelector('#water[shown]') !== null)).toBe(true);
                await new Promise((resolve) => setTimeout(resolve, 1500));
                writeFileSync(screenshotPath(`${name}-${size}`), await look());
            }
            const photo = info.outputPath('photo.svg');
            writeFileSync(photo, '<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 9 9"><path fill="#ffc080" d="M0 0h9v9H0z"/></svg>');
            await engine.pick(photo);
            await expect.poll(calm).toBe(true);
            await expect.poll(red).toBeGreaterThan(240);
            await engine.drag(500, 200, 200);
            await expect.poll(calm).toBe(false);
            // The ink fades within a second, in which these engines draw a few frames.
            await expect(async () => {
                await engine.drag(300, 100, 260);
                expect(await red()).toBeLessThan(150);
            }).toPass({ timeout: 20_000 });

            // WebKit allows a hundred calls of replaceState() in ten seconds.
            await run(() => {
                const slider = [...document.querySelectorAll('#panel label')].find(({ textContent }) => textContent === 'Rain').control;
                for (let i = 0; i < 180; ++i) Object.assign(slider, { value: i % 60 }).dispatchEvent(new Event('input'));
            });
            await expect.poll(() => run(() => location.hash)).toMatch(/rain=59/);

            await run(() => Object.assign(window.tidemark.water, { rain: 0 }).clearInk());
            await run(() => window.tidemark.water.water.graphics.lose.loseContext());
            await expect.poll(message).toMatch(/come back/);
            await run(() => window.tidemark.water.water.graphics.lose.restoreContext());
            await expect.poll(message).toBe('');
            await expect.poll(red).toBeGreaterThan(240);  // without a touch
            expect(await run(() => window.problems)).toEqual([]);
        } finally {
            for (const close of started.reverse()) await close().catch(console.error);
        }
    });
}
