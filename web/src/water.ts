// The water of the canvas, with types.
import { lookKeys, type Look } from './look';
import { loadModule, type Pixels } from './module';

// The action codes of the library.
export enum Touch {
    down = 0,
    up = 1,
    move = 2,
    cancel = 3,
}

export enum Frame {
    resting = 0,
    waiting = 1,
    drawn = 2,
}

export type Water = NonNullable<Awaited<ReturnType<typeof openWater>>>;

// Null where there is no WebGL.
export async function openWater() {
    const module = await loadModule();
    if (!module._openCanvas(1)) return null;

    const fill = (which: number, { width, height, rgba }: Pixels) => {
        const place = module._pictureToFill(which, width, height);
        module.HEAPU8.set(rgba, place);
    };
    return {
        largestPicture: Math.min(module._largestPicture(), 2048),
        setLook(look: Look) {
            const place = module._lookToFill() >> 2;
            lookKeys.forEach(({ name, whole }, i) => {
                (whole ? module.HEAP32 : module.HEAPF32)[place + i] = look[name]!;
            });
            module._applyLook();
        },
        setPictures(portrait: Pixels, landscape: Pixels, light: Pixels) {
            fill(0, portrait);
            fill(1, landscape);
            fill(2, light);
            module._showPictures();
        },
        resize: module._resize,
        setInk: module._setInk,
        setRain: module._setRain,
        clearInk: module._clearInk,
        touch: (action: Touch, x: number, y: number, pressure: number) => module._touch(action, x, y, pressure),
        renewContext: module._renewContext,
        frame: (seconds: number): Frame => module._frame(seconds),
    };
}
