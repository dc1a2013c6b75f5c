// What the page does with pointers, photos and a lost context.
import { difference, expect, flatPixels, open, pixelsAfter, slope, takeOver, test } from './page.mjs';

const shows = (page, picture) =>
    expect.poll(() => page.evaluate(() => window.tidemark.settings.picture)).toBe(picture);

function expectMiddleOf(pixels, view, [width, height]) {
    const scale = Math.max(view.width / width, view.height / height);
    for (let y = 5; y < view.height; y += 20) {
        for (let x = 5; x < view.width; x += 20) {
            const at = 4 * (y * view.width + x);
            const red = (255 * (width / 2 + (x + 0.5 - view.width / 2) / scale)) / width;
            const green = (255 * (height / 2 + (y + 0.5 - view.height / 2) / scale)) / height;
            expect(Math.hypot(pixels[at] - red, pixels[at + 1] - green), `at ${x}, ${y}`).toBeLessThan(8);
        }
    }
}

test('shows the photo, and each of two in its turn; a file that is none leaves it', async ({ page }) => {
    await open(page);
    await takeOver(page);
    await page.setInputFiles('#files', [slope(400, 200), slope(200, 500)]);
    await shows(page, 'photo');
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [200, 500]);
    await page.setViewportSize({ width: 300, height: 200 });
    await page.waitForFunction(() => document.querySelector('canvas').width === 300);
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [400, 200]);

    await page.evaluate(() => {
        const dataTransfer = new DataTransfer();
        dataTransfer.items.add(new File(['words'], 'words.png'));
        document.querySelector('canvas').dispatchEvent(new DragEvent('drop', { dataTransfer, bubbles: true }));
    });
    await expect(page.getByRole('alert')).toHaveText(/not a picture/);
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [400, 200]);
});

test('a tap raises rings that come to rest, and then no frames are asked for', async ({ page }) => {
    await open(page, '#ink=0');
    await page.mouse.click(100, 150);
    await page.waitForSelector('.status:not(.calm)', { state: 'attached' });
    await page.waitForSelector('.status.calm', { state: 'attached' });
    expect(await page.evaluate(() => {
        let asked = 0;
        window.requestAnimationFrame = () => ++asked;
        return new Promise((resolve) => setTimeout(() => resolve(asked), 200));
    })).toBe(0);
});

test('pointers become touches: one at a time, as often as the library expects, pens with their pressure', async ({ page }) => {
    await open(page, '#ink=0');
    await takeOver(page);
    const touches = await page.evaluate(() => {
        const { water } = window.tidemark;
        const canvas = document.querySelector('canvas');
        canvas.setPointerCapture = () => {};  // made-up pointers cannot be captured
        const touches = [];
        water.touch = (...touch) => touches.push(touch);
        let time = 1000;
        const send = (type, pointerId, clientX, later, options) => {
            const event = new PointerEvent(type, { pointerId, clientX, clientY: 10, button: 0, ...options });
            Object.defineProperty(event, 'timeStamp', { value: (time += later) });
            canvas.dispatchEvent(event);
        };
        send('pointerdown', 1, 10, 0);
        send('pointermove', 1, 11, 1);    // a mouse of a thousand reports a second
        send('pointermove', 1, 12, 7);
        send('pointerdown', 2, 90, 1);    // a second finger waits
        send('pointermove', 2, 91, 9);
        send('pointerup', 2, 91, 1);
        send('pointerup', 1, 13, 1);
        send('pointerdown', 2, 90, 1, { pointerType: 'pen', pressure: 0.25 });
        send('pointercancel', 2, 92, 9);
        return touches;
    });
    expect(touches).toEqual([[0, 10, 10, 1], [2, 12, 10, 1], [1, 13, 10, 1], [0, 90, 10, 0.5], [3, 92, 10, 1]]);
});

test('keys and buttons switch the ink, and clear it', async ({ page }) => {
    await open(page);
    await takeOver(page);
    const flat = await flatPixels(page);
    const drawn = () => {
        window.tidemark.water.touch(0, 100, 150, 1);
        window.tidemark.water.touch(1, 100, 150, 1);
        window.frames(25);
        return window.read();
    };
    const inked = difference(await pixelsAfter(page, drawn), flat);
    await page.click('#clear');
    const cleared = difference(await pixelsAfter(page, () => (window.frames(2), window.read())), flat);
    await flatPixels(page);
    await page.keyboard.press('i');
    const clear = difference(await pixelsAfter(page, drawn), flat);
    expect(inked).toBeGreaterThan(1.2 * clear);
    expect(cleared).toBeLessThan(inked);
});

test('a lost context is survived', async ({ page }) => {
    await open(page);
    await takeOver(page);
    const flat = await flatPixels(page);
    await page.evaluate(async () => {
        const canvas = document.querySelector('canvas');
        const extension = canvas.getContext('webgl').getExtension('WEBGL_lose_context');
        const event = (name) => new Promise((resolve) => canvas.addEventListener(name, resolve, { once: true }));
        const [lost, restored] = [event('webglcontextlost'), event('webglcontextrestored')];
        extension.loseContext();
        await lost;
        setTimeout(() => extension.restoreContext());
        await restored;
        window.tidemark.loop.pause();
    });
    expect(difference(await flatPixels(page), flat)).toBeLessThan(0.3);
});
