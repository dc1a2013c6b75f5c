// The painted pictures, out of a worker.
import type { Painting } from './painter';

interface Waiting {
    resolve(bitmap: ImageBitmap): void;
    reject(error: unknown): void;
}

const worker = new Worker(new URL('./painter.ts', import.meta.url), { type: 'module' });
const waiting = new Map<number, Waiting>();
let lastId = 0;

worker.onmessage = ({ data }: MessageEvent<{ id: number; bitmap: ImageBitmap }>) => {
    waiting.get(data.id)?.resolve(data.bitmap);
    waiting.delete(data.id);
};
worker.onerror = () => {
    for (const { reject } of waiting.values()) reject(new Error('The painted pictures do not load.'));
    waiting.clear();
};

export function paint(painting: Painting, width: number, height: number): Promise<ImageBitmap> {
    return new Promise((resolve, reject) => {
        waiting.set(++lastId, { resolve, reject });
        worker.postMessage({ id: lastId, painting, width, height });
    });
}
