// The worker that paints the pictures of the page, so that the main thread keeps drawing.
import createPainter, { type Painter } from '../../build/web/tidemark-painter.js';
import url from '../../build/web/tidemark-painter.wasm?url';
import type { Ground } from './grounds';

export interface Painted {
    id: number;
    bitmap?: ImageBitmap;  // undefined if painting has failed
}

interface Task {
    id: number;
    ground: Ground;
    width: number;
    height: number;
}

const loaded: Promise<Painter> = createPainter({ locateFile: () => url });
loaded.catch(() => {});  // paint() reports it

async function paint({ ground, width, height }: Task): Promise<ImageBitmap> {
    const module = await loaded;
    const fill = { pool: module._paintTiledPool, river: module._paintRiverBed, shore: module._paintSandyShore }[ground];
    const place = fill(width, height);
    const pixels = new Uint8ClampedArray(module.HEAPU8.slice(place, place + 4 * width * height).buffer);
    return createImageBitmap(new ImageData(pixels, width, height));
}

onmessage = ({ data }: MessageEvent<Task>) => paint(data).then(
    (bitmap) => postMessage({ id: data.id, bitmap }, { transfer: [bitmap] }),
    () => postMessage({ id: data.id }),
);
