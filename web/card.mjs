// Draws public/card.jpg, which other sites show for a link to the page, and public/icon.png, out of the built page and
// its favicon: `npm run card`.
import { readFileSync } from 'node:fs';
import { chromium } from '@playwright/test';
import { preview } from 'vite';
import { takeOver } from './tests/page.mjs';
import config from './tests/playwright.config.mjs';

const fileOf = (name) => new URL(`public/${name}`, import.meta.url).pathname;
const server = await preview({ preview: { port: 0 } });
const browser = await chromium.launch(config.use.launchOptions);

const page = await browser.newPage({ viewport: { width: 1200, height: 630 }, bypassCSP: true });
await page.goto(server.resolvedUrls.local[0]);
await page.waitForSelector('#water[shown]');
await page.addStyleTag({ content: `#tools, #panel, #hint, #brand nav { display: none }
    #brand { padding: 44px 52px 80px } #brand h1 { font-size: 68px } #brand p { font-size: 27px; margin-top: 10px }` });
await takeOver(page);
await page.evaluate(() => {
    const water = document.querySelector('tidemark-water');
    water.drop(850, 330);
    window.frames(34);
    water.drop(560, 470, { strength: 0.7 });
    window.frames(20);
    for (let step = 0; step <= 24; ++step) {
        window.touch(step ? 2 : 0, 620 + 16 * step, 500 - 60 * Math.sin(step / 5));
        window.frames(1);
    }
    window.touch(1, 1004, 500 - 60 * Math.sin(24 / 5));
    window.frames(6);
});
await page.screenshot({ path: fileOf('card.jpg'), type: 'jpeg', quality: 82 });

// Filled to the edges, which phones cut in a shape of their own.
const drawing = readFileSync(fileOf('favicon.svg'), 'utf8').replace(/<circle.*\/>/, '<rect width="64" height="64" fill="url(#water)"/>');
await page.setViewportSize({ width: 512, height: 512 });
await page.setContent(`<body style="margin: 0">${drawing}`);
await page.screenshot({ path: fileOf('icon.png') });

await browser.close();
await server.close();
