// Tests of the playground's photos, pointers, sizes and ink.
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

test('a photo is shown, of two the one that fits; a broken file changes nothing', async ({ page }) => {
    test.slow();
    await open(page, '#wet=0&groundRed=1&groundGreen=1');
    await takeOver(page);
    const size = () => page.evaluate(() => window.tidemark.water.water.chooser.picture.size());
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

test('a tap raises rings that come to rest, and then no frames are requested', async ({ page }) => {
    await open(page, '#breeze=0');
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

test('pointers become touches: one draws with every report, at its place and time, and the others only ripple', async ({ page }) => {
    await open(page);
    const seen = await page.evaluate(() => {
        const { native } = document.querySelector('tidemark-water').water;
        const seen = [];
        native._touch = (action, x, y, pressure, seconds) => seen.push([action, 200 * x, 300 * y, pressure, 1000 * seconds]);
        native._splash = (x) => seen.push(['ripple', 200 * x]);
        const make = (type, pointerId, clientX, timeStamp, options) => {
            const event = new PointerEvent(type, {
                pointerId, clientX, clientY: 15, button: 0, buttons: 1, pointerType: 'touch', pressure: 0.8, bubbles: true, ...options });
            return Object.defineProperty(event, 'timeStamp', { value: timeStamp });
        };
        const send = (...event) => document.querySelector('tidemark-water').dispatchEvent(make(...event));
        send('pointerdown', 1, 10, 1000);
        const moved = make('pointermove', 1, 12.5, 1009);
        moved.getCoalescedEvents = () => [make('pointermove', 1, 11, 1001), moved];
        document.querySelector('tidemark-water').dispatchEvent(moved);
        send('pointerdown', 2, 90, 1010);
        send('pointermove', 2, 91, 1019);  // too near for another ripple
        send('pointermove', 2, 120, 1028);
        send('pointerup', 2, 120, 1029);
        send('pointerup', 1, 13, 1030);
        send('pointerdown', 2, 90, 1031, { pointerType: 'pen', pressure: 0.25 });
        send('pointercancel', 2, 92, 1040);
        send('pointermove', 3, 40, 1049, { pointerType: 'mouse', buttons: 0 });
        return seen.map((one) => one.map((part) => (part.toFixed ? Number(part.toFixed(6)) : part)));
    });
    expect(seen).toEqual([[0, 10, 15, -1, 1000], [2, 11, 15, -1, 1001], [2, 12.5, 15, -1, 1009], ['ripple', 90], ['ripple', 120],
        [1, 13, 15, -1, 1030], [0, 90, 15, 0.25, 1031], [3, 92, 15, -1, 1040], ['ripple', 40]]);
});

test('a canvas is stretched while its size changes, and gets its pixels and the picture once', async ({ page }) => {
    await open(page, '?src=favicon.svg');
    await takeOver(page);
    const flat = await flatPixels(page);
    expect(await page.evaluate(async () => {
        const { canvas } = window.tidemark.water.water;
        const sizes = [];
        const follow = async (width, height) => {
            Object.assign(document.querySelector('#water').style, { width: `${width}px`, height: `${height}px` });
            for (let i = 0; i < 2; ++i) await new Promise(requestAnimationFrame);  // the observer reports the size
            for (let i = 0; i < 3; ++i) {
                window.frames(1);
                if (sizes.at(-1) !== canvas.width) sizes.push(canvas.width);
            }
        };
        for (let width = 210; width <= 290; width += 10) await follow(width, 200);
        await follow(300, 200);  // another orientation
        window.frames(6);
        sizes.push(canvas.width);
        return sizes;
    })).toEqual([200, 300]);
    const mean = (pixels) => difference(pixels, Buffer.alloc(pixels.length));
    expect(mean(await flatPixels(page)) / mean(flat)).toBeCloseTo(1, 1);
});

test('a key switches the ink off, and a button clears it', async ({ page }) => {
    test.slow();
    await open(page, '#ink=1');
    await takeOver(page);
    const flat = await flatPixels(page);
    const drawn = () => {
        window.touch(0, 100, 150);
        window.touch(1, 100, 150);
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
