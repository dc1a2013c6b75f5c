// Pictures as arrays of RGBA bytes.
import { execFileSync } from 'node:child_process';

export const decode = (file, input) =>
    execFileSync('ffmpeg', ['-v', 'error', '-i', file, '-f', 'rawvideo', '-pix_fmt', 'rgba', '-'], {
        input,
        maxBuffer: 1 << 28,
    });

// A PNG file of width x height pixels, each the RGB bytes that colour(column, row) gives.
export function encode(width, height, colour) {
    const raw = Buffer.alloc(width * height * 3);
    for (let i = 0; i < width * height; ++i) raw.set(colour(i % width, Math.floor(i / width)), 3 * i);
    return execFileSync(
        'ffmpeg',
        ['-v', 'error', '-f', 'rawvideo', '-pix_fmt', 'rgb24', '-s', `${width}x${height}`, '-i', '-', '-f', 'image2pipe', '-c:v', 'png', '-'],
        { input: raw },
    );
}

// What the visitor sees of the water, at one pixel a pixel of the page.
export const photograph = async (page) =>
    decode('-', await page.screenshot({ style: '#tools, #hint, .lil-gui { visibility: hidden }' }));

// The mean difference of two pictures a channel, 0 to 255.
export function difference(a, b) {
    let sum = 0;
    for (let i = 0; i < a.length; ++i) sum += Math.abs(a[i] - b[i]);
    return sum / a.length;
}

// The share of pixels of which no channel differs by more than `tolerance`.
export function shareWithin(a, b, tolerance) {
    let close = 0;
    for (let i = 0; i < a.length; i += 4) {
        if ([0, 1, 2].every((c) => Math.abs(a[i + c] - b[i + c]) <= tolerance)) ++close;
    }
    return close / (a.length / 4);
}
