// A worker that paints the built-in pictures, so that the water does not wait for them.
import { loadModule } from './module';

export type Painting = 'river' | 'pool' | 'shore' | 'light';

const loaded = loadModule();

onmessage = async ({ data }: MessageEvent<{ id: number; painting: Painting; width: number; height: number }>) => {
    const { id, painting, width, height } = data;
    const module = await loaded;
    const paint = {
        river: module._paintRiverBed,
        pool: module._paintTiledPool,
        shore: module._paintSandyShore,
        light: module._paintWaterLight,
    }[painting];
    const place = paint(width, height);
    const rgba = module.HEAPU8.slice(place, place + 4 * width * height);
    postMessage({ id, pixels: { width, height, rgba } }, { transfer: [rgba.buffer] });
};
