// The work that delays the first picture.
import { expect, open, test } from './page.mjs';

// To read from a canvas that the graphics draw is to wait until they have done all that they were told.
test('before the first picture nothing is read back from the graphics', async ({ page }) => {
    await page.addInitScript(() => {
        window.reads = [];
        const { prototype } = CanvasRenderingContext2D;
        const { getImageData } = prototype;
        prototype.getImageData = function (...area) {
            window.reads.push(this.getContextAttributes().willReadFrequently);
            return getImageData.apply(this, area);
        };
    });
    await open(page);
    const reads = await page.evaluate(() => window.reads);
    expect(reads.length).toBeGreaterThan(0);
    expect(reads).not.toContain(false);
});
