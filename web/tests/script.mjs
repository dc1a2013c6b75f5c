// Plays touches to the page's water frame by frame, without its loop and its clock.

// Runs in the page: the loop stands still from here on.
export const takeOver = (page) =>
    page.evaluate(() => {
        const { loop, water } = window.tidemark;
        const canvas = document.querySelector('canvas');
        const gl = canvas.getContext('webgl');
        loop.pause();
        let seconds = performance.now() / 1000;
        window.frames = (count) => {
            for (let i = 0; i < count; ++i) water.frame((seconds += 1 / 60));
        };
        window.settle = () => {
            for (let i = 0; i < 2000; ++i) if (water.frame((seconds += 1 / 60)) === 0) return;
            throw new Error('the water does not come to rest');
        };
        // Only in the task that has drawn: afterwards the browser takes the canvas away. Rows from the top.
        window.read = () => {
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

// Runs `play` in the page, which returns what read() gives, or several.
export async function pixelsAfter(page, play, argument) {
    const result = await page.evaluate(play, argument);
    return Array.isArray(result) ? result.map((text) => Buffer.from(text, 'base64')) : Buffer.from(result, 'base64');
}
