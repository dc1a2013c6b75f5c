// Compares frames of the page with frames of the desktop program.
import { execFile } from 'node:child_process';
import { mkdirSync, readFileSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { promisify } from 'node:util';
import { PNG } from 'pngjs';
import { expect, open, pixelsAfter, slope, takeOver, test } from './page.mjs';

const root = new URL('../..', import.meta.url).pathname;
const preview = process.env.TIDEMARK_PREVIEW ?? join(root, 'build/release/preview/tidemark-preview');
const [width, height] = [135, 240];

test.use({ viewport: { width, height }, contextOptions: { reducedMotion: 'reduce' } });  // no first drop

test('frames of a script equal those of tidemark-preview', async ({ page }, { outputDir }) => {
    test.slow();
    const script = join(root, 'scenes/curl.touch');
    mkdirSync(outputDir, { recursive: true });
    const [ground, light] = [slope(width, height), slope(512, 512)].map(({ name, buffer }) => {
        writeFileSync(join(outputDir, name), buffer);
        return { file: join(outputDir, name), url: `data:image/png;base64,${buffer.toString('base64')}` };
    });
    const pictures = ['--portrait', ground.file, '--landscape', ground.file, '--light', light.file];
    // Honey tints the ground, the light and the ink. It has no breeze, which would depend on the time since the first frame, and
    // with a step of the ink in each frame the ink does not depend on it either.
    const preset = 'honey';
    const look = join(outputDir, 'steps.properties');
    writeFileSync(look, 'inkStepsPerSecond = 60\n');
    const options = ['--preset', preset, '--look', look, ...pictures, '--script', script, '--size', `${width}x${height}`, '--seconds', '0.8', '--every', '12', '--out', outputDir];
    // Softpipe filters textures exactly, as the browser's driver does. llvmpipe has weights of 8 bits, too few for the ink, which is
    // packed into two bytes.
    const drawn = promisify(execFile)(preview, options, { env: { ...process.env, GALLIUM_DRIVER: 'softpipe' } });

    const actions = ['down', 'up', 'move', 'cancel'];
    // The program rounds the points of a script to whole pixels.
    const pixels = (text, extent) => Math.round((parseFloat(text) * extent) / 100);
    const touches = readFileSync(script, 'utf8').split('\n').filter((line) => /^\d/.test(line)).map((line) => {
        const [time, action, x, y] = line.split(/\s+/);
        return [Number(time), actions.indexOf(action), pixels(x, width), pixels(y, height)];
    });
    await page.addInitScript(() => { Math.random = () => 0; });  // so the seed is 1, as in the program
    await open(page, `#preset=${preset}&inkStepsPerSecond=60`);
    await page.evaluate(async ([ground, light]) => {
        const { water } = window.tidemark;
        Object.assign(water, { light, src: ground });
        await water.setPicture(ground);
    }, [ground.url, light.url]);
    await page.waitForFunction(() => window.tidemark.water.water.chooser.light?.drawable instanceof HTMLImageElement);
    await takeOver(page);
    const frames = await pixelsAfter(page, (touches) => {
        window.settle();
        const taken = [];
        for (let i = 0, next = 0; i < 48; ++i) {
            for (; next < touches.length && touches[next][0] < ((i + 1) * 1000) / 60; ++next) {
                const [time, ...touch] = touches[next];
                window.touch(...touch, time / 1000 - i / 60);
            }
            if (i % 12 === 0) taken.push(window.read());
            else window.frames(1);
        }
        return taken;
    }, touches);
    await drawn;
    for (const [i, frame] of frames.entries()) {
        const reference = PNG.sync.read(readFileSync(join(outputDir, `frame-${String(i).padStart(4, '0')}.png`))).data;
        let apart = 0;
        for (let at = 0; at < frame.length; at += 4) {
            if ([0, 1, 2].some((c) => Math.abs(frame[at + c] - reference[at + c]) > 2)) ++apart;
        }
        expect(apart / (width * height), `frame ${12 * i}`).toBeLessThan(0.01);
    }
});
