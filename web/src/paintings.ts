// The painted pictures, out of a worker, which is started anew where it failed.
import type { Ground } from './grounds';
import type { Painted } from './painter';

const waiting = new Map<number, { resolve(bitmap: ImageBitmap): void; reject(error: Error): void }>();
let lastId = 0;
let worker: Worker | undefined;

declare global {
    var painter: Worker | null | undefined;  // which the built page starts before its scripts are there
}

function startWorker(): Worker {
    const started = globalThis.painter ?? new Worker(new URL('./painter.ts', import.meta.url), { type: 'module' });
    globalThis.painter = null;
    const fail = () => {
        for (const { reject } of waiting.values()) reject(new Error('The painted pictures do not load. Please try again.'));
        waiting.clear();
        started.terminate();
        worker = undefined;
    };
    started.onerror = fail;
    started.onmessage = ({ data: { id, bitmap } }: MessageEvent<Painted>) => {
        if (!bitmap) return fail();
        waiting.get(id)?.resolve(bitmap);
        waiting.delete(id);
    };
    return started;
}

export function paint(ground: Ground, width: number, height: number): Promise<ImageBitmap> {
    return new Promise((resolve, reject) => {
        waiting.set(++lastId, { resolve, reject });
        worker ??= startWorker();
        worker.postMessage({ id: lastId, ground, width, height });
    });
}
