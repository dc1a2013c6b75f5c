// A worker that paints the built-in pictures, so that the water does not wait for them.
import createPainter from '../../build/web/tidemark-painter.js';
import url from '../../build/web/tidemark-painter.wasm?url';

export type Painting = 'pool' | 'river' | 'shore';

const loaded = createPainter({ locateFile: () => url });

onmessage = async ({ data }: MessageEvent<{ id: number; painting: Painting; width: number; height: number }>) => {
    const { id, painting, width, height } = data;
    const module = await loaded;
    const paint = { pool: module._paintTiledPool, river: module._paintRiverBed, shore: module._paintSandyShore }[painting];
    const place = paint(width, height);
    const pixels = new Uint8ClampedArray(module.HEAPU8.slice(place, place + 4 * width * height).buffer);
    const bitmap = await createImageBitmap(new ImageData(pixels, width, height));
    postMessage({ id, bitmap }, { transfer: [bitmap] });
};
