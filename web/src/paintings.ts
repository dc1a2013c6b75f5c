// Requests paintings from the worker, and starts it again after a failure.
import type { Ground } from './grounds';
import type { Painted } from './painter';

const waiting = new Map<number, { resolve(bitmap: ImageBitmap): void; reject(error: Error): void }>();
let lastId = 0;
let worker: Painter | undefined;

// src/early_painter.js starts a worker before this script is loaded, and requests a picture with the id 0.
interface Painter extends Worker {
    asked?: string;
    painted?: Painted;
}
declare global {
    var painter: Painter | null | undefined;
}

function startWorker(): Painter {
    const started: Painter = globalThis.painter ?? new Worker(new URL('./painter.ts', import.meta.url), { type: 'module' });
    globalThis.painter = null;
    const fail = () => {
        for (const { reject } of waiting.values()) reject(new Error('The painted pictures do not load. Please try again.'));
        waiting.clear();
        started.terminate();
        worker = undefined;
    };
    started.onerror = fail;
    started.onmessage = ({ data: { id, bitmap } }: { data: Painted }) => {
        if (!bitmap) return fail();
        waiting.get(id)?.resolve(bitmap);
        waiting.delete(id);
    };
    return started;
}

export function paint(ground: Ground, width: number, height: number): Promise<ImageBitmap> {
    return new Promise((resolve, reject) => {
        worker ??= startWorker();
        const isAsked = worker.asked === JSON.stringify([ground, width, height]);
        const id = isAsked ? 0 : ++lastId;
        waiting.set(id, { resolve, reject });
        if (!isAsked) return worker.postMessage({ id, ground, width, height });
        worker.asked = undefined;  // its bitmap has one user
        if (worker.painted) worker.onmessage!(new MessageEvent('message', { data: worker.painted }));
    });
}
