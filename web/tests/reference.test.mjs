// The page draws what the desktop program draws.
import assert from 'node:assert/strict';
import { execFileSync } from 'node:child_process';
import { mkdtempSync, readFileSync, rmSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';
import { after, before, test } from 'node:test';
import { calm, launch, open, serve } from './browser.mjs';
import { decode, shareWithin } from './pixels.mjs';
import { pixelsAfter, takeOver } from './script.mjs';

const root = new URL('../..', import.meta.url).pathname;
const preview = process.env.TIDEMARK_PREVIEW ?? join(root, 'build/release/preview/tidemark-preview');
const [width, height] = [270, 480];
let site, browser;

before(async () => {
    site = await serve();
    browser = await launch();
});
after(async () => {
    await browser?.close();
    site?.stop();
});

test('frames of a script equal those of tidemark-preview', async () => {
    const script = join(root, 'scenes/demo.touch');
    const directory = mkdtempSync(join(tmpdir(), 'tidemark-'));
    // The driver that filters textures exactly, as the browser's does; the faster one has weights of 8 bits, which the
    // two bytes of the ink's texels do not stand.
    const options = ['--script', script, '--size', `${width}x${height}`, '--seconds', '1.7', '--every', '20', '--out', directory];
    execFileSync(preview, options, { env: { ...process.env, GALLIUM_DRIVER: 'softpipe' } });
    const references = Array.from({ length: 6 }, (_, i) => decode(join(directory, `frame-${String(i).padStart(4, '0')}.png`)));
    rmSync(directory, { recursive: true });

    const actions = ['down', 'up', 'move', 'cancel'];
    const pixels = (text, extent) => Math.round((parseFloat(text) * extent) / 100);
    const touches = readFileSync(script, 'utf8').split('\n').filter((line) => /^\d/.test(line)).map((line) => {
        const [time, action, x, y, pressure] = line.split(/\s+/);
        return [Number(time), actions.indexOf(action), pixels(x, width), pixels(y, height), Number(pressure)];
    });
    const context = await browser.newContext({ viewport: { width, height } });
    const page = await open(context, site.address);
    await calm(page);
    await takeOver(page);
    const frames = await pixelsAfter(page, (touches) => {
        const taken = [];
        for (let i = 0, next = 0; i < 102; ++i) {
            for (; next < touches.length && touches[next][0] < ((i + 1) * 1000) / 60; ++next) {
                window.tidemark.water.touch(...touches[next].slice(1));
            }
            // A look that is handed over asks for a frame, also where nothing moves.
            if (i === 0) window.tidemark.water.setLook(window.tidemark.settings.look);
            window.frames(1);
            if (i % 20 === 0) taken.push(window.read());
        }
        return taken;
    }, touches);
    for (const [i, frame] of frames.entries()) {
        const share = shareWithin(frame, references[i], 2);
        console.log(`frame ${20 * i}: ${(100 * share).toFixed(2)} % of the pixels within 2`);
        assert.ok(share >= 0.99, `frame ${20 * i}: only ${share} of the pixels`);
    }
});
