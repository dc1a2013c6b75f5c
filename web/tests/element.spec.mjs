// The element of the package on pages that are not the playground's.
import { execFileSync } from 'node:child_process';
import { readFileSync } from 'node:fs';
import { join } from 'node:path';
import { expect, slope, test } from './page.mjs';

const dist = new URL('../package/dist/', import.meta.url).pathname;
const script = '<script type="module" src="tidemark-water.js"></script>';
const types = { html: 'text/html', js: 'text/javascript', wasm: 'application/wasm', png: 'image/png' };

// A page at an address of its own, with the built package beside it and pictures at hand.
async function show(page, html, { headers = {}, files = {}, at = 'http://pond.test/page.html' } = {}) {
    files = { 'pond.png': slope(64, 64).buffer, 'words.png': 'words', 'page.html': `<!doctype html><html lang="en">${html}`, ...files };
    await page.route('**/*.test/**', (route) => {
        const name = new URL(route.request().url()).pathname.slice(1);
        const body = files[name] ?? (/^tidemark-water/.test(name) && readFileSync(join(dist, name)));
        if (!body) return route.fulfill({ status: 404 });
        const only = { 'access-control-allow-origin': 'http://pond.test' };  // without it, any page may
        return route.fulfill({ body, headers: { 'content-type': types[name.split('.').pop()], ...only, ...headers } });
    });
    await page.goto(at);
}
const element = (page) => page.locator('tidemark-water');
const drawn = (page) => page.locator('tidemark-water[shown]').first().waitFor();

const heap = async (page) => {
    const client = await page.context().newCDPSession(page);
    await client.send('HeapProfiler.collectGarbage');
    await client.send('Performance.enable');
    const { metrics } = await client.send('Performance.getMetrics');
    return Object.fromEntries(metrics.map(({ name, value }) => [name, value]));
};

test('200 waters come and go, and leave nothing', async ({ page }) => {
    await page.addInitScript(() => {
        window.memories = [];
        const { instantiate } = WebAssembly;
        WebAssembly.instantiate = async (...given) => {
            const instance = await instantiate(...given);
            window.memories.push(new WeakRef(Object.values(instance.exports).find((part) => part instanceof WebAssembly.Memory)));
            return instance;
        };
    });
    await show(page, script);
    const mount = (count) => page.evaluate(async (count) => {
        for (let i = 0; i < count; ++i) {
            const water = document.createElement('tidemark-water');
            Object.assign(water, { src: 'pond.png', ink: true });
            document.body.append(water);
            await new Promise((resolve) => water.addEventListener('ready', resolve));
            water.remove();
        }
    }, count);
    await mount(10);
    const before = await heap(page);
    await mount(190);
    const after = await heap(page);
    expect(await page.evaluate(() => window.memories.length)).toBe(200);
    expect(await page.evaluate(() => window.memories.filter((memory) => memory.deref()).length)).toBeLessThan(3);
    expect(after.JSEventListeners).toBeLessThanOrEqual(before.JSEventListeners);
    expect(after.Nodes).toBeLessThanOrEqual(before.Nodes);
    expect(after.JSHeapUsedSize - before.JSHeapUsedSize).toBeLessThan(190 * 1000);
});

test('twenty waters that never rest all show their picture, and the touched one moves', async ({ page }) => {
    await page.setViewportSize({ width: 800, height: 700 });
    const one = '<tidemark-water src="pond.png" rain="9" style="float: left; width: 160px"></tidemark-water>';
    await show(page, script + one.repeat(20));
    await expect(page.locator('tidemark-water[shown]')).toHaveCount(20);
    const moving = () => element(page).evaluateAll((all) => all.map(({ water }) => water.live));
    expect((await moving()).filter(Boolean).length).toBeLessThan(16);
    const still = (await moving()).indexOf(false);
    await element(page).nth(still).click();
    await expect.poll(async () => (await moving())[still]).toBe(true);
    await page.screenshot({ path: '../build/web/screens/twenty.png' });
});

for (const [code, body, options] of [
    ['cross-origin', '<tidemark-water src="http://pond.test/pond.png">', { at: 'http://other.test/page.html' }],
    ['decode', '<tidemark-water src="words.png">'],
    ['load', '<tidemark-water src="none.png">'],
    ['module', '<tidemark-water>', { files: { 'tidemark-water.wasm': 'words' } }],
    ['csp', '<tidemark-water>', { headers: { 'content-security-policy': "default-src 'self'" } }],
    ['webgl', '<tidemark-water><img slot="fallback" src="pond.png" alt="A pond">'],
]) {
    test(`what does not work has the code ${code}, and the fallback stays`, async ({ page, problems }) => {
        if (code === 'webgl') await page.addInitScript(() => { HTMLCanvasElement.prototype.getContext = () => null; });
        await page.addInitScript(() => addEventListener('DOMContentLoaded', () => {
            window.codes = [];
            document.querySelector('tidemark-water').addEventListener('error', ({ detail }) => window.codes.push(detail.code));
        }));
        await show(page, `${body}</tidemark-water>${script}`, options);
        await expect.poll(() => page.evaluate(() => window.codes)).toEqual([code]);
        problems.length = 0;  // the browser's own words on it
        if (code === 'webgl') await expect(page.getByAltText('A pond')).toBeVisible();
        await expect(element(page)).not.toHaveAttribute('shown');
    });
}

const strict = { 'content-security-policy': "default-src 'none'; script-src 'self' 'wasm-unsafe-eval'; img-src 'self' blob:; connect-src 'self'" };
test('under a strict policy, in a shadow root, content is clicked and rippled, keys drop, and motion keeps to the wish', async ({ page }) => {
    await page.emulateMedia({ reducedMotion: 'reduce' });
    const host = `customElements.define('a-page', class extends HTMLElement { connectedCallback() {
        this.attachShadow({ mode: 'open' }).append(document.querySelector('template').content); } });`;
    await show(page, `${script}<script type="module" src="host.js"></script><a-page></a-page><template>
        <tidemark-water src="pond.png" rain="20" first-drop interaction="hover press"><button>Buy</button></tidemark-water></template>`,
    { headers: strict, files: { 'host.js': host } });
    await drawn(page);
    const water = element(page);
    const calm = (yes) => expect.poll(() => water.evaluate(({ water }) => water.calm)).toBe(yes);
    await calm(true);  // neither rain nor a drop
    await water.evaluate((node) => node.querySelector('button').addEventListener('click', () => { node.clicks = (node.clicks ?? 0) + 1; }));
    await page.getByText('Buy').click();
    await calm(false);
    expect(await water.evaluate(({ clicks }) => clicks)).toBe(1);
    await calm(true);
    await page.getByRole('button', { name: /Water/ }).focus();
    await page.keyboard.press('ArrowLeft');
    await page.keyboard.press('Enter');
    await calm(false);
    const blob = await water.evaluate(async (node) => {
        const picture = await createImageBitmap(await node.toBlob());
        return [picture.width, picture.height];
    });
    expect(blob).toEqual([await water.evaluate(({ clientWidth }) => clientWidth), 160]);
});

test('a canvas of the page, a source that moves, and an import without a browser', async ({ page }) => {
    execFileSync('node', ['-e', "import('./tidemark-water.js')"], { cwd: dist });
    await show(page, '<canvas id="own" style="width: 100px; height: 100px"></canvas>');
    const seen = await page.evaluate(async () => {
        const { createWater } = await import('./tidemark-water.js');
        const source = Object.assign(document.createElement('canvas'), { width: 8, height: 8 });
        const paint = (color) => {
            const context = source.getContext('2d');
            context.fillStyle = color;
            context.fillRect(0, 0, 8, 8);
        };
        paint('red');
        const water = createWater(document.querySelector('#own'), { src: source });
        const red = async () => {
            const canvas = new OffscreenCanvas(1, 1).getContext('2d');
            canvas.drawImage(await createImageBitmap(await water.toBlob()), 0, 0, 1, 1);
            return canvas.getImageData(0, 0, 1, 1).data[0];
        };
        await water.ready;
        const before = await red();
        paint('black');
        await new Promise((resolve) => setTimeout(resolve, 300));
        const after = await red();
        water.destroy();
        return [before, after];
    });
    expect(seen[0]).toBeGreaterThan(200);
    expect(seen[1]).toBeLessThan(40);
});
