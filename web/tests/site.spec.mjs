// Tests of the playground as a site: screens, links, use without a network, and failures of its worker.
import { difference, expect, flatPixels, open, screenshotPath, takeOver, test } from './page.mjs';

const screens = {
    desktop: { viewport: { width: 1440, height: 900 } },
    phone: { viewport: { width: 390, height: 844 }, deviceScaleFactor: 3, isMobile: true, hasTouch: true },
    'small-phone': { viewport: { width: 320, height: 568 }, deviceScaleFactor: 2, isMobile: true, hasTouch: true },
    'phone-landscape': { viewport: { width: 844, height: 390 }, deviceScaleFactor: 3, isMobile: true, hasTouch: true },
};
for (const [name, screen] of Object.entries(screens)) {
    test.describe(name, () => {
        test.use({ ...screen, contextOptions: { reducedMotion: 'reduce' } });  // no frames, so that their rate does not change the number of pixels
        test('fills the screen, at most twice as dense as the page', async ({ page }) => {
            await open(page);
            const canvas = page.getByRole('button', { name: /Water/ });
            await expect(canvas).toHaveCSS('opacity', '1');
            await page.screenshot({ path: screenshotPath(name) });
            const { width, height } = screen.viewport;
            const density = Math.min(screen.deviceScaleFactor ?? 1, 2);
            expect(await canvas.evaluate(({ width, height }) => [width, height])).toEqual([width * density, height * density]);
            expect(await page.evaluate(() => document.documentElement.scrollHeight <= innerHeight)).toBe(true);
            for (const tool of await page.locator('#tools button').all()) {
                await expect(tool).toBeInViewport({ ratio: 1 });
                expect(await tool.evaluate(({ scrollWidth, clientWidth }) => scrollWidth - clientWidth)).toBe(0);
            }
            if (screen.hasTouch) await page.touchscreen.tap(width / 2, height / 2);
            else await page.mouse.click(width / 2, height / 2);
            await expect(page.locator('#hint')).toHaveClass(/gone/);
            if (screen.hasTouch) await page.click('#look');
            await expect(page.getByRole('button', { name: 'Clear lake' })).toBeInViewport({ ratio: 1 });
            expect(await page.locator('#panel').evaluate(({ scrollWidth, clientWidth }) => scrollWidth - clientWidth)).toBe(0);
        });
    });
}

test('all links, icons and pictures of the page and its documents exist', async ({ page, baseURL }) => {
    await page.goto('./');
    const { icons } = await (await page.request.get('./manifest.webmanifest')).json();
    const addresses = new Set(icons.map(({ src }) => new URL(src, baseURL).href));
    const collect = async () => {
        const places = await page.evaluate(() => [...document.querySelectorAll('[href], meta[property="og:image"]')].map(({ href, content }) => href ?? content));
        for (const place of places) addresses.add(new URL(place, page.url()).href.split('#')[0]);
    };
    await collect();
    for (const address of addresses) {  // the loop adds those of each document
        if (!address.startsWith(baseURL)) continue;
        expect((await page.request.get(address)).ok(), address).toBe(true);
        if (!address.endsWith('.html')) continue;
        await page.goto(address);
        await collect();
    }
    expect([...addresses].filter((address) => address.endsWith('.html')).length).toBeGreaterThan(6);
});

// Without a policy in force, the other tests would not notice its violations.
test('the strict content security policy is in force', async ({ page, problems }) => {
    await page.goto('./');
    const ran = await page.evaluate(() => {
        document.head.append(Object.assign(document.createElement('script'), { textContent: 'window.ran = true' }));
        document.head.append(Object.assign(document.createElement('style'), { textContent: 'h1 { width: 1px }' }));
        return [window.ran, getComputedStyle(document.querySelector('h1')).width === '1px'];
    });
    expect(ran).toEqual([undefined, false]);
    expect(problems.splice(0).filter((text) => /Content Security Policy/.test(text)).length).toBeGreaterThan(1);
});

test('the page opens without a network after the first visit, and its pictures differ', async ({ page, context, baseURL }) => {
    const [older, neighbour] = [`tidemark ${baseURL} 1`, `tidemark ${baseURL}else/ 1`];
    await page.addInitScript((names) => {
        if (navigator.serviceWorker?.controller === null) for (const name of names) caches.open(name);
    }, [older, neighbour]);
    await open(page);
    await page.evaluate(async () => {
        const { serviceWorker } = navigator;
        await serviceWorker.ready;
        if (!serviceWorker.controller) await new Promise((resolve) => { serviceWorker.oncontrollerchange = resolve; });
    });
    const kept = await page.evaluate(() => caches.keys());
    expect(kept).toContain(neighbour);
    expect(kept).not.toContain(older);
    await context.setOffline(true);
    const seen = [];
    for (const picture of ['river', 'pool', 'shore']) {
        await page.goto('about:blank');
        await open(page, `#picture=${picture}`);
        await takeOver(page);
        seen.push(await flatPixels(page));
    }
    for (const [a, b] of [[0, 1], [1, 2], [0, 2]]) expect(difference(seen[a], seen[b])).toBeGreaterThan(15);
});

test('a failed worker is reported and started again; the last of two pictures wins', async ({ page }) => {
    await page.addInitScript(() => {
        window.works = [];
        window.started = [];
        window.Worker = class {
            constructor(url) { window.started.push(url); }
            postMessage = ({ id }) => window.works.push((bitmap) => this.onmessage({ data: { id, bitmap } }));
            terminate() {}
        };
        window.answer = async (i, side) => window.works.at(i)(side && await createImageBitmap(new ImageData(side, side)));
    });
    await page.goto('./');
    const answer = (i, side) => page.evaluate(([i, side]) => window.answer(i, side), [i, side]);
    await page.waitForFunction(() => window.works.length > 0);
    expect(await page.evaluate(() => window.started)).toEqual([expect.stringMatching(/^\.\/assets\/painter/)]);  // early_painter.js has started one worker
    await answer(0);
    await expect(page.locator('#message.shown')).toHaveText(/painted pictures do not load/);
    await page.setViewportSize({ width: 500, height: 800 });
    await page.click('#look');
    await page.getByRole('button', { name: 'River bed' }).click();
    await expect(page.locator('body')).toHaveClass(/busy/);
    await page.getByRole('button', { name: 'Sandy shore' }).click();
    await page.waitForFunction(() => window.works.length > 2);
    await answer(-1, 30);
    await answer(-2, 20);
    await expect(page.locator('body')).not.toHaveClass(/busy/);
    expect(await page.evaluate(() => window.tidemark.water.water.chooser.picture.size())).toEqual([30, 30]);
    await expect(page.locator('#message')).toHaveText('');
});
