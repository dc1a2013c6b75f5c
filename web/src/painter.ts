// A worker that paints the built-in pictures, so that the water does not wait for them.
import createPainter, { type Painter } from '../../build/web/tidemark-painter.js';
import url from '../../build/web/tidemark-painter.wasm?url';

export type Painting = 'pool' | 'river' | 'shore';

export interface Painted {
    id: number;
    bitmap?: ImageBitmap;  // none where it failed
}

const loaded: Promise<Painter | null> = createPainter({ locateFile: () => url }).catch(() => null);

onmessage = async ({ data }: MessageEvent<{ id: number; painting: Painting; width: number; height: number }>) => {
    const { id, painting, width, height } = data;
    const module = await loaded;
    if (!module) return postMessage({ id });
    const paint = { pool: module._paintTiledPool, river: module._paintRiverBed, shore: module._paintSandyShore }[painting];
    const place = paint(width, height);
    const pixels = new Uint8ClampedArray(module.HEAPU8.slice(place, place + 4 * width * height).buffer);
    const bitmap = await createImageBitmap(new ImageData(pixels, width, height));
    postMessage({ id, bitmap }, { transfer: [bitmap] });
};
