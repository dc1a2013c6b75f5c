// The page as a site: screens, a missing network, and browsers that cannot show it.
import assert from 'node:assert/strict';
import { mkdirSync } from 'node:fs';
import { after, before, test } from 'node:test';
import { calm, launch, open, serve } from './browser.mjs';
import { difference, photograph } from './pixels.mjs';

const pictures = new URL('../../build/web/screens/', import.meta.url).pathname;
let site, browser;

before(async () => {
    mkdirSync(pictures, { recursive: true });
    site = await serve();
    browser = await launch();
});
after(async () => {
    await browser?.close();
    site?.stop();
});

// To look at, in build/web/screens.
const screens = {
    desktop: { viewport: { width: 1280, height: 800 } },
    phone: { viewport: { width: 390, height: 844 }, deviceScaleFactor: 3, isMobile: true, hasTouch: true },
    'phone-landscape': { viewport: { width: 844, height: 390 }, deviceScaleFactor: 3, isMobile: true, hasTouch: true },
};

for (const [name, screen] of Object.entries(screens)) {
    test(`fills the screen of a ${name}, at most twice as dense as the page`, async () => {
        const context = await browser.newContext(screen);
        const page = await open(context, site.address);
        await calm(page);
        await page.waitForTimeout(800);
        await page.screenshot({ path: `${pictures}${name}.png` });
        const { width, height } = screen.viewport;
        const facts = await page.evaluate(() => {
            const canvas = document.querySelector('#water');
            const tools = document.querySelector('#tools').getBoundingClientRect();
            const panel = document.querySelector('.lil-gui.lil-root');
            return {
                box: [canvas.clientWidth, canvas.clientHeight],
                pixels: [canvas.width, canvas.height],
                scrolls: document.documentElement.scrollHeight > innerHeight,
                toolsInside: tools.left >= 0 && tools.right <= innerWidth && tools.bottom <= innerHeight,
                panelShut: panel.classList.contains('lil-closed'),
            };
        });
        const density = Math.min(screen.deviceScaleFactor ?? 1, 2);
        assert.deepEqual(facts, {
            box: [width, height], pixels: [width * density, height * density], scrolls: false, toolsInside: true,
            panelShut: name !== 'desktop',
        });
        if (screen.hasTouch) {
            await page.touchscreen.tap(width / 2, height / 2);
            await page.waitForSelector('.status:not(.calm)', { state: 'attached' });
            await page.waitForSelector('#hint.gone', { state: 'attached' });
        }
        assert.deepEqual(page.problems, []);
        await context.close();
    });
}

test('every picture comes up, and no two look alike', async () => {
    const context = await browser.newContext({ viewport: { width: 200, height: 300 } });
    const seen = [];
    for (const picture of ['river', 'pool', 'shore']) {
        const page = await open(context, `${site.address}#picture=${picture}`);
        await calm(page);
        await page.waitForTimeout(800);
        seen.push(await photograph(page));
        await page.close();
    }
    for (const [a, b] of [[0, 1], [1, 2], [0, 2]]) assert.ok(difference(seen[a], seen[b]) > 15);
    await context.close();
});

test('opens without a network once it has been loaded', async () => {
    const own = await serve();
    const context = await browser.newContext({ viewport: { width: 200, height: 300 } });
    const page = await open(context, own.address);
    await page.evaluate(async () => {
        await navigator.serviceWorker.ready;
        if (!navigator.serviceWorker.controller) {
            await new Promise((resolve) => navigator.serviceWorker.addEventListener('controllerchange', resolve, { once: true }));
        }
    });
    own.stop();
    await context.setOffline(true);
    await page.reload();
    await page.waitForSelector('#water.shown');
    assert.deepEqual(page.problems, []);
    await context.close();
});

test('says in one sentence what the browser lacks', async () => {
    const without3d = await launch('--disable-3d-apis');
    const noWebGl = await without3d.newPage();
    await noWebGl.goto(site.address);
    await noWebGl.waitForSelector('#message:not([hidden])');
    assert.match(await noWebGl.textContent('#message'), /needs WebGL/);
    await without3d.close();

    const noVectors = await browser.newPage();
    await noVectors.addInitScript(() => {
        WebAssembly.validate = () => false;
    });
    await noVectors.goto(site.address);
    await noVectors.waitForSelector('#message:not([hidden])');
    assert.match(await noVectors.textContent('#message'), /needs WebAssembly with SIMD/);
    await noVectors.close();
});
