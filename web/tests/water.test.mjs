// What the visitor sees: the picture, rings, ink, and the water's rest.
import assert from 'node:assert/strict';
import { after, afterEach, before, beforeEach, test } from 'node:test';
import { calm, launch, open, serve } from './browser.mjs';
import { difference, encode, photograph } from './pixels.mjs';

const [width, height] = [320, 480];
let site, browser, context, page;

before(async () => {
    site = await serve();
    browser = await launch();
});
after(async () => {
    await browser?.close();
    site?.stop();
});
beforeEach(async () => {
    context = await browser.newContext({ viewport: { width, height } });
    page = await open(context, site.address);
    await calm(page);
    await page.waitForFunction(() => getComputedStyle(document.querySelector('#water')).opacity === '1');
});
afterEach(async () => {
    assert.deepEqual(page.problems, []);
    await context.close();
});

// Red grows to the right, green downwards.
const slope = (w, h) => encode(w, h, (column, row) => [(255 * column) / w, (255 * row) / h, 40]);

function assertShowsMiddleOf(pixels, w, h, view = { width, height }) {
    const scale = Math.max(view.width / w, view.height / h);
    for (let y = 5; y < view.height; y += 20) {
        for (let x = 5; x < view.width; x += 20) {
            const at = 4 * (y * view.width + x);
            const column = w / 2 + (x + 0.5 - view.width / 2) / scale;
            const row = h / 2 + (y + 0.5 - view.height / 2) / scale;
            assert.ok(Math.abs(pixels[at] - (255 * column) / w) < 6, `red at ${x}, ${y} is ${pixels[at]}`);
            assert.ok(Math.abs(pixels[at + 1] - (255 * row) / h) < 6, `green at ${x}, ${y} is ${pixels[at + 1]}`);
        }
    }
}

const dropFiles = (files) =>
    page.evaluate((files) => {
        const data = new DataTransfer();
        for (const { name, base64 } of files) {
            const bytes = Uint8Array.from(atob(base64), (letter) => letter.charCodeAt(0));
            data.items.add(new File([bytes], name));
        }
        document.querySelector('#water').dispatchEvent(
            new DragEvent('drop', { dataTransfer: data, bubbles: true, cancelable: true }));
    }, files);
const shows = (picture) =>
    page.waitForFunction((picture) => window.tidemark.settings.picture === picture, picture);

test('a flat surface shows the dropped photo, and each of two in its turn', async () => {
    await dropFiles([{ name: 'landscape.png', base64: slope(300, 200).toString('base64') }]);
    await shows('photo');
    await calm(page);
    assertShowsMiddleOf(await photograph(page), 300, 200);

    await page.setInputFiles('#files', [
        { name: 'landscape.png', mimeType: 'image/png', buffer: slope(400, 200) },
        { name: 'portrait.png', mimeType: 'image/png', buffer: slope(200, 500) },
    ]);
    await page.waitForTimeout(500);
    await calm(page);
    assertShowsMiddleOf(await photograph(page), 200, 500);
    await page.setViewportSize({ width: height, height: width });
    await page.waitForTimeout(500);
    await calm(page);
    assertShowsMiddleOf(await photograph(page), 400, 200, { width: height, height: width });

    await dropFiles([{ name: 'words.txt', base64: btoa('not a picture') }]);
    await page.waitForSelector('#message:not([hidden])');
    assert.match(await page.textContent('#message'), /not a picture/);
});

test('a tap raises rings that come to rest, and then no frames are drawn', async () => {
    await page.keyboard.press('i');
    await calm(page);
    const flat = await photograph(page);
    await page.mouse.click(160, 240);
    await page.waitForTimeout(250);
    const rings = difference(await photograph(page), flat);
    await calm(page);
    // The library calls speeds calm that the eye no longer sees.
    const rest = difference(await photograph(page), flat);
    assert.ok(rest < 1 && rings > 3 * rest, `rings ${rings}, rest ${rest}`);
    const asked = await page.evaluate(async () => {
        let count = 0;
        const request = window.requestAnimationFrame;
        window.requestAnimationFrame = (call) => request((++count, call));
        await new Promise((resolve) => setTimeout(resolve, 300));
        return count;
    });
    assert.equal(asked, 0);
});

test('a drag with ink darkens along its path and fades, and is cleared at once', async () => {
    const flat = await photograph(page);
    const darkening = async () => {
        const pixels = await photograph(page);
        const red = (x, y) => {
            let sum = 0;
            for (let dy = -8; dy <= 8; ++dy) {
                for (let dx = -8; dx <= 8; ++dx) {
                    const at = 4 * ((y + dy) * width + x + dx);
                    sum += flat[at] - pixels[at];
                }
            }
            return sum / 17 ** 2;
        };
        return { path: (red(120, 240) + red(160, 240) + red(200, 240)) / 3, aside: red(160, 60) };
    };
    const drag = async () => {
        await page.mouse.move(60, 240);
        await page.mouse.down();
        await page.mouse.move(260, 240, { steps: 20 });
        await page.mouse.up();
    };
    await drag();
    const dark = await darkening();
    assert.ok(dark.path > 20, `darker by ${dark.path}`);
    assert.ok(dark.path > 3 * Math.abs(dark.aside), `beside the path by ${dark.aside}`);
    await calm(page);
    assert.ok(Math.abs((await darkening()).path) < 2, 'faded');

    await drag();
    await page.click('#clear');
    await page.evaluate(() => new Promise((resolve) => setTimeout(resolve, 300)));
    assert.ok((await darkening()).path < 15, 'cleared');
});

test('a pen presses harder than it strokes lightly', async () => {
    await page.keyboard.press('i');
    await calm(page);
    const flat = await photograph(page);
    const rings = async (pressure) => {
        await page.evaluate((pressure) => {
            const canvas = document.querySelector('#water');
            canvas.setPointerCapture = () => {};  // made-up pointers cannot be captured
            for (const type of ['pointerdown', 'pointerup']) {
                canvas.dispatchEvent(new PointerEvent(type, {
                    pointerId: 7, pointerType: 'pen', pressure, clientX: 160, clientY: 240, button: 0,
                }));
            }
            const { loop } = window.tidemark;
            loop.drawNow();
            loop.pause();
        }, pressure);
        await page.waitForTimeout(200);
        const changed = difference(await photograph(page), flat);
        await page.evaluate(() => window.tidemark.loop.resume());
        await calm(page);
        return changed;
    };
    const light = await rings(0.1);
    const firm = await rings(0.9);
    assert.ok(light > 0 && firm > 1.5 * light, `light ${light}, firm ${firm}`);
});

test('a lost context is survived, with ink and without', async () => {
    for (const press of ['', 'i']) {
        if (press) await page.keyboard.press(press);
        await calm(page);
        const flat = await photograph(page);
        await page.evaluate(async () => {
            const canvas = document.querySelector('#water');
            const extension = canvas.getContext('webgl').getExtension('WEBGL_lose_context');
            const event = (name) => new Promise((resolve) => canvas.addEventListener(name, resolve, { once: true }));
            const lost = event('webglcontextlost');
            extension.loseContext();
            await lost;
            const restored = event('webglcontextrestored');
            setTimeout(() => extension.restoreContext(), 50);
            await restored;
        });
        await page.waitForTimeout(300);
        await calm(page);
        assert.ok(difference(await photograph(page), flat) < 0.3, 'the same picture');
        await page.mouse.click(160, 240);
        await page.waitForTimeout(250);
        assert.ok(difference(await photograph(page), flat) > 1, 'rings');
        await calm(page);
    }
});
