// A real browser with the built page in a folder of a plain web server.
import { createServer } from 'node:http';
import { readFile } from 'node:fs/promises';
import { extname, join } from 'node:path';
import { chromium } from 'playwright-core';

const dist = new URL('../dist', import.meta.url).pathname;
const types = {
    '.css': 'text/css', '.html': 'text/html', '.js': 'text/javascript', '.svg': 'image/svg+xml', '.txt': 'text/plain',
    '.wasm': 'application/wasm',
};

// Not at the root, so that a path that is not relative shows.
const folder = '/some/where/';

export async function serve() {
    const server = createServer(async ({ url }, response) => {
        const path = new URL(url, 'http://localhost').pathname;
        const name = path === folder ? 'index.html' : path.slice(folder.length);
        try {
            if (!path.startsWith(folder)) throw new Error('outside');
            const bytes = await readFile(join(dist, name));
            response.writeHead(200, { 'content-type': types[extname(name)] }).end(bytes);
        } catch {
            response.writeHead(404).end();
        }
    });
    await new Promise((resolve) => server.listen(0, 'localhost', resolve));
    return { address: `http://localhost:${server.address().port}${folder}`, stop: () => server.close() };
}

export const launch = (...flags) =>
    chromium.launch({
        executablePath: process.env.CHROMIUM ?? '/usr/bin/chromium',
        args: [
            '--headless=new', '--no-sandbox', '--use-angle=swiftshader', '--enable-unsafe-swiftshader', '--disable-quic',
            '--no-first-run', '--disable-background-networking', '--disable-component-update', '--disable-sync', ...flags,
        ],
    });

// Opens the page and waits until it shows calm water. `problems` collects what the console says.
export async function open(context, address) {
    const page = await context.newPage();
    page.problems = [];
    page.on('console', (message) => {
        if (['error', 'warning'].includes(message.type())) page.problems.push(message.text());
    });
    page.on('pageerror', (error) => page.problems.push(String(error)));
    await page.goto(address);
    await page.waitForSelector('#water.shown');
    return page;
}

export async function calm(page) {
    // What has just been asked for shows in the next frame.
    await page.evaluate(() => new Promise((resolve) => requestAnimationFrame(() => requestAnimationFrame(resolve))));
    await page.waitForSelector('.status.calm', { state: 'attached', timeout: 60_000 });
}

// Puts `text` into the panel's field of that name, as a visitor would.
export async function setValue(page, name, text) {
    const field = page.locator('.lil-number', { has: page.getByText(name, { exact: true }) }).locator('input');
    await field.fill(String(text));
    await field.press('Enter');
}
