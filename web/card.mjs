// Draws public/card.jpg, the picture that other sites show for a link to the page, with the built page, and public/icon.png
// from its favicon. Run it with `npm run card`.
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
    water.drop(500, 430);
    for (let step = 0; step <= 30; ++step) {
        window.touch(step ? 2 : 0, 740 + 12 * step, 400 - 80 * Math.sin(step / 6));
        window.frames(1);
    }
    window.touch(1, 1100, 400 - 80 * Math.sin(30 / 6));
    window.frames(10);
});
await page.screenshot({ path: fileOf('card.jpg'), type: 'jpeg', quality: 82 });

// Fills the square, because phones cut icons to a shape of their own.
const drawing = readFileSync(fileOf('favicon.svg'), 'utf8').replace(/<circle.*\/>/, '<rect width="64" height="64" fill="url(#water)"/>');
await page.setViewportSize({ width: 512, height: 512 });
await page.setContent(`<body style="margin: 0">${drawing}`);
await page.screenshot({ path: fileOf('icon.png') });

await browser.close();
await server.close();
