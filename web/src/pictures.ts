// Pictures to lie under the water: painted ones and the visitor's own.
import type { Pixels } from './module';
import type { Painting } from './painter';

const worker = new Worker(new URL('./painter.ts', import.meta.url), { type: 'module' });
const waiting = new Map<number, (pixels: Pixels) => void>();
let lastId = 0;

worker.onmessage = ({ data }: MessageEvent<{ id: number; pixels: Pixels }>) => {
    waiting.get(data.id)!(data.pixels);
    waiting.delete(data.id);
};

export function paint(painting: Painting, width: number, height: number): Promise<Pixels> {
    return new Promise((resolve) => {
        waiting.set(++lastId, resolve);
        worker.postMessage({ id: lastId, painting, width, height });
    });
}

// Turned as its camera says, and scaled so that no side is longer than `longest` pixels.
async function decode(file: File, longest: number): Promise<Pixels> {
    const bitmap = await createImageBitmap(file, { imageOrientation: 'from-image' });
    const scale = Math.min(1, longest / Math.max(bitmap.width, bitmap.height));
    const width = Math.max(1, Math.round(bitmap.width * scale));
    const height = Math.max(1, Math.round(bitmap.height * scale));
    const canvas = new OffscreenCanvas(width, height);
    const context = canvas.getContext('2d')!;
    context.imageSmoothingQuality = 'high';
    context.drawImage(bitmap, 0, 0, width, height);
    bitmap.close();
    return { width, height, rgba: context.getImageData(0, 0, width, height).data };
}

export interface Photos {
    portrait: Pixels;
    landscape: Pixels;
}

// One photo serves both portrait and landscape; of several, the first of each shape serves its own. Null where none can
// be read.
export async function readPhotos(files: File[], longest: number): Promise<Photos | null> {
    const results = await Promise.allSettled(files.map((file) => decode(file, longest)));
    const photos = results.filter((result) => result.status === 'fulfilled').map((result) => result.value);
    const first = photos[0];
    if (!first) return null;
    return {
        portrait: photos.find(({ width, height }) => height >= width) ?? first,
        landscape: photos.find(({ width, height }) => width > height) ?? first,
    };
}
