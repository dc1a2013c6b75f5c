// What the page does with pointers and photos. Lost contexts are tried in the other engines.
import { difference, expect, flatPixels, open, pixelsAfter, slope, takeOver, test } from './page.mjs';

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
    test.slow();
    await open(page);
    await takeOver(page);
    const size = () => page.evaluate(() => window.tidemark.water.water.picture.size());
    await page.setInputFiles('#files', [slope(400, 200), slope(200, 500)]);
    await expect.poll(size).toEqual([200, 500]);
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [200, 500]);
    await page.setViewportSize({ width: 300, height: 200 });
    await expect.poll(size).toEqual([400, 200]);
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [400, 200]);

    await page.evaluate(() => {
        const dataTransfer = new DataTransfer();
        dataTransfer.items.add(new File(['words'], 'words.png'));
        document.body.dispatchEvent(new DragEvent('drop', { dataTransfer, bubbles: true }));
    });
    await expect(page.getByRole('status')).toHaveText(/not a picture/);
    expectMiddleOf(await flatPixels(page), page.viewportSize(), [400, 200]);
});

test('a tap raises rings that come to rest, and then no frames are asked for', async ({ page }) => {
    await open(page, '#ink=0');
    const rests = () => page.evaluate(() => window.tidemark.water.water.calm);
    await expect.poll(rests).toBe(true);
    await page.mouse.click(100, 150);
    await expect.poll(rests).toBe(false);
    await expect.poll(rests).toBe(true);
    expect(await page.evaluate(() => {
        let asked = 0;
        window.requestAnimationFrame = () => ++asked;
        return new Promise((resolve) => setTimeout(() => resolve(asked), 200));
    })).toBe(0);
});

test('pointers become touches: one draws, as often as the library expects, and the others only ripple', async ({ page }) => {
    await open(page, '#ink=0');
    const seen = await page.evaluate(() => {
        const { water } = document.querySelector('tidemark-water');
        const seen = [];
        water.touch = (...touch) => seen.push(touch);
        water.ripple = (x, y) => seen.push(['ripple', x, y]);
        let time = 1000;
        const send = (type, pointerId, clientX, later, options) => {
            const event = new PointerEvent(type, {
                pointerId, clientX, clientY: 10, button: 0, buttons: 1, pointerType: 'touch', bubbles: true, ...options });
            Object.defineProperty(event, 'timeStamp', { value: (time += later) });
            document.querySelector('tidemark-water').dispatchEvent(event);
        };
        send('pointerdown', 1, 10, 0);
        send('pointermove', 1, 11, 1);    // a screen of a thousand reports a second
        send('pointermove', 1, 12, 7);
        send('pointerdown', 2, 90, 1);
        send('pointermove', 2, 91, 9);    // not far enough for another ripple
        send('pointermove', 2, 120, 9);
        send('pointerup', 2, 120, 1);
        send('pointerup', 1, 13, 1);
        send('pointerdown', 2, 90, 1, { pointerType: 'pen', pressure: 0.25 });
        send('pointercancel', 2, 92, 9);
        send('pointermove', 3, 40, 9, { pointerType: 'mouse', buttons: 0 });
        return seen;
    });
    expect(seen).toEqual([[0, 10, 10, 1], [2, 12, 10, 1], ['ripple', 90, 10], ['ripple', 120, 10], [1, 13, 10, 1],
        [0, 90, 10, 0.5], [3, 92, 10, 1], ['ripple', 40, 10]]);
});

test('keys and buttons switch the ink, and clear it', async ({ page }) => {
    test.slow();
    await open(page);
    await takeOver(page);
    const flat = await flatPixels(page);
    const drawn = () => {
        window.native._touch(0, 100, 150, 1);
        window.native._touch(1, 100, 150, 1);
        window.frames(25);
        return window.read();
    };
    const inked = difference(await pixelsAfter(page, drawn), flat);
    await page.click('#clear');
    const cleared = difference(await pixelsAfter(page, () => (window.frames(2), window.read())), flat);
    await flatPixels(page);
    await page.keyboard.press('i');
    await page.waitForFunction(() => window.tidemark.water.getAttribute('ink') === 'off');
    const clear = difference(await pixelsAfter(page, drawn), flat);
    expect(inked).toBeGreaterThan(1.2 * clear);
    expect(cleared).toBeLessThan(inked);
});
