// Helpers of the tests: they open pages with water, draw single frames, and compare pictures.
import { mkdirSync } from 'node:fs';
import { join } from 'node:path';
import { test as plain, expect } from '@playwright/test';
import { PNG } from 'pngjs';

export { expect };

// Screenshots are for people; no test reads them.
export function screenshotPath(name) {
    const folder = new URL('../../build/web/screens', import.meta.url).pathname;
    mkdirSync(folder, { recursive: true });
    return join(folder, `${name}.png`);
}

// A test fails if the page reports an error or a warning that the test has not removed from `problems`.
export const test = plain.extend({
    problems: ({}, use) => use([]),
    page: async ({ page, problems }, use) => {
        page.on('console', (message) => {
            if (['error', 'warning'].includes(message.type())) problems.push(`${message.text()} ${message.location().url}`);
        });
        page.on('pageerror', (error) => problems.push(String(error)));
        await use(page);
        expect(problems).toEqual([]);
    },
});

// Opens the playground and waits until its water is visible.
export async function open(page, hash = '') {
    await page.goto(`./${hash}`);
    await page.waitForSelector('#water[shown]');
}

// Stops the page's loop and clock, and adds functions to `window` that draw frames of 1/60 s.
export const takeOver = (page) =>
    page.evaluate(() => {
        const { water } = document.querySelector('tidemark-water');
        const { canvas, native, graphics: { gl } } = water;
        water.isRunning = () => false;
        let seconds = performance.now() / 1000;
        performance.now = () => 1000 * seconds;
        const frame = () => water.frame(native, 1000 * (seconds += 1 / 60));
        window.frames = (count) => {
            for (let i = 0; i < count; ++i) frame();
        };
        window.settle = () => {
            for (let i = 0; frame() !== 0; ++i) if (i > 2000) throw new Error('no rest');
        };
        // x and y are in CSS pixels; `later` is in seconds after the last frame.
        window.touch = (action, x, y, later = 0) =>
            native._touch(action, x / canvas.clientWidth, y / canvas.clientHeight, -1, seconds + later);
        // Draws and reads in one task, because the browser clears the canvas after it. The first row is the top.
        window.read = () => {
            native._redraw();
            window.frames(1);
            const { width, height } = canvas;
            const pixels = new Uint8Array(4 * width * height);
            gl.readPixels(0, 0, width, height, gl.RGBA, gl.UNSIGNED_BYTE, pixels);
            let text = '';
            for (let row = height - 1; row >= 0; --row) {
                text += String.fromCharCode(...pixels.subarray(4 * width * row, 4 * width * (row + 1)));
            }
            return btoa(text);
        };
    });

// Runs `play` in the page. It returns the result of window.read(), or an array of results.
export async function pixelsAfter(page, play, argument) {
    const result = await page.evaluate(play, argument);
    return Array.isArray(result) ? result.map((text) => Buffer.from(text, 'base64')) : Buffer.from(result, 'base64');
}

export const flatPixels = (page) => pixelsAfter(page, () => (window.settle(), window.read()));

// A PNG file whose red increases to the right and whose green increases downwards.
export function slope(width, height) {
    const png = new PNG({ width, height });
    for (let i = 0; i < width * height; ++i) {
        png.data.set([(255 * (i % width)) / width, (255 * Math.floor(i / width)) / height, 40, 255], 4 * i);
    }
    return { name: `${width}x${height}.png`, mimeType: 'image/png', buffer: PNG.sync.write(png) };
}

// The mean absolute difference of two pictures' channels, 0 to 255.
export function difference(a, b) {
    let sum = 0;
    for (let i = 0; i < a.length; ++i) sum += Math.abs(a[i] - b[i]);
    return sum / a.length;
}
