// Loads pictures and uploads them into textures, cropped and scaled to the view. The page keeps no decoded copy: after a
// lost context the browser decodes the file again.
import { WaterError } from './errors.js';
import light from './light.webp';

export type Source =
    | string | URL | Blob | ImageBitmap | HTMLImageElement | HTMLVideoElement | HTMLCanvasElement | OffscreenCanvas;

export interface Picture {
    drawable: CanvasImageSource;
    size(): [number, number];
    /** Whether it may change from frame to frame. */
    moving(): boolean;
    /** Whether it has changed since the last call. */
    changed(): boolean;
    /** Whether the look darkens and tints it. Moving pictures keep their colours: each frame would have to be measured. */
    shaded: boolean;
}

/** The CSS colour by which a picture is multiplied. `brightness` is the mean of its channels, 0 to 1. */
export type Shade = (brightness: number) => string;

function canvasOf(width: number, height: number): HTMLCanvasElement {
    const canvas = document.createElement('canvas');
    canvas.width = width;
    canvas.height = height;
    return canvas;
}

// A browser requests a file once if all images request it in the same mode. One from the page's own server can be used
// without `crossorigin`, unless the server redirects to another one.
function modeOf(address: URL): string | null {
    const shown = [...document.images].find((image) => (image.currentSrc || image.src) === address.href);
    return shown && address.origin === self.origin ? shown.crossOrigin : 'anonymous';
}

async function loadImage(url: string, priority: 'high' | 'low' | 'auto', blob?: Blob, mode = modeOf): Promise<HTMLImageElement> {
    const image = new Image();
    let address: URL;
    try {
        address = new URL(url, document.baseURI);
    } catch {
        throw new WaterError('load', `${url} is no address.`);
    }
    // Same-origin addresses, too: they may redirect to another server, and a sandboxed frame has an origin of its own.
    if (/^https?:/.test(address.protocol)) image.crossOrigin = mode(address);
    image.fetchPriority = priority;
    image.src = url;
    const loaded = await new Promise<boolean>((resolve) => {
        image.onload = () => resolve(true);
        image.onerror = () => resolve(false);
    });
    if (loaded) {
        await image.decode().catch(() => {});  // some SVGs are drawn although decode() rejects
        return image;
    }
    if (blob) throw new WaterError('decode', 'The file is not a picture that this browser can show.');
    // Without cookies, a missing file of another server looks the same as a refusal.
    const away = image.crossOrigin && address.origin !== self.origin;
    const response = away ? null : await fetch(url, { mode: 'no-cors' }).catch(() => null);
    if (away || response?.type === 'opaque') {
        throw new WaterError('cross-origin', `${url} does not load, or its server does not send Access-Control-Allow-Origin for this page.`);
    }
    if (response?.ok) throw new WaterError('decode', `${url} is not a picture that this browser can show.`);
    throw new WaterError('load', `${url} does not load.`);
}

const still = (drawable: CanvasImageSource, size: () => [number, number]): Picture =>
    ({ drawable, size, moving: () => false, changed: () => false, shaded: true });

/** Throws if a texture would refuse the picture. */
function probe(picture: Picture): Picture {
    const { drawable } = picture;
    // Such an image loads only if its pixels can be read. Drawing it would decode it once more.
    if (drawable instanceof HTMLImageElement && drawable.crossOrigin !== null && drawable.naturalWidth > 0) return picture;
    const context = canvasOf(1, 1).getContext('2d', { willReadFrequently: true });
    const [width, height] = picture.size();
    if (!context || !width || !height) return picture;
    try {
        context.drawImage(drawable, 0, 0, 1, 1, 0, 0, 1, 1);
    } catch {
        throw new WaterError('decode', 'The picture is broken.');
    }
    try {
        context.getImageData(0, 0, 1, 1);
    } catch {
        throw new WaterError('cross-origin', 'The server of the picture does not allow this page to use it.');
    }
    return picture;
}

async function loadVideo(video: HTMLVideoElement): Promise<void> {
    if (video.readyState > 1) return;
    await new Promise<unknown>((resolve, reject) => {
        const fail = () => reject(new WaterError('load', `${video.currentSrc} does not load.`));
        if (video.error) fail();
        video.addEventListener('loadeddata', resolve, { once: true });
        video.addEventListener('error', fail, { once: true });
    });
}

export async function loadPicture(source: Source, priority: 'high' | 'low' | 'auto' = 'auto'): Promise<Picture> {
    const picture = await load(source, priority);
    try {
        return probe(picture);
    } catch (error) {
        if (typeof source !== 'string' && !(source instanceof URL)) throw error;
        return probe(pictureOf(await loadImage(String(source), priority, undefined, () => 'anonymous')));
    }
}

// An SVG may have no size of its own.
const pictureOf = (image: HTMLImageElement): Picture => still(image, () => [image.naturalWidth || 1024, image.naturalHeight || 1024]);

async function load(source: Source, priority: 'high' | 'low' | 'auto'): Promise<Picture> {
    if (source instanceof HTMLVideoElement) {
        await loadVideo(source);
        let time = -1;
        return {
            drawable: source,
            size: () => [source.videoWidth, source.videoHeight],
            moving: () => !source.paused && !source.ended,
            changed: () => source.readyState > 1 && time !== (time = source.currentTime),
            shaded: false,
        };
    }
    if (source instanceof HTMLCanvasElement || (typeof OffscreenCanvas === 'function' && source instanceof OffscreenCanvas)) {
        return { drawable: source, size: () => [source.width, source.height], moving: () => true, changed: () => true, shaded: false };
    }
    if (source instanceof ImageBitmap) return still(source, () => [source.width, source.height]);
    let image: HTMLImageElement;
    if (source instanceof HTMLImageElement) {
        await source.decode().catch(() => {});
        image = source;
    } else if (source instanceof Blob) {
        const url = URL.createObjectURL(source);
        image = await loadImage(url, priority, source).finally(() => URL.revokeObjectURL(url));
    } else {
        image = await loadImage(String(source), priority);
    }
    return pictureOf(image);
}

// The part of a picture that a view of another shape shows: 0 is left or top, 1 is right or bottom.
export type Place = readonly [x: number, y: number];

/** Reads a computed `object-position`, in percent; the middle for other units. */
export function placeOf(position: string): Place {
    const share = (text = '') => (text.endsWith('%') ? Math.min(Math.max(parseFloat(text) / 100, 0), 1) : 0.5);
    const [x, y] = position.split(' ');
    return [share(x), share(y)];
}

/** Draws the picture so that it covers the canvas, as `object-fit: cover` does. */
export function drawCover(canvas: HTMLCanvasElement, picture: Picture, [x, y]: Place): void {
    const { width, height } = canvas;
    const [fullWidth, fullHeight] = picture.size();
    const scale = Math.min(fullWidth / width, fullHeight / height);
    const context = canvas.getContext('2d', { alpha: false })!;
    context.imageSmoothingQuality = 'high';
    if (!(scale > 0)) return;
    context.drawImage(picture.drawable, (fullWidth - width * scale) * x, (fullHeight - height * scale) * y,
        width * scale, height * scale, 0, 0, width, height);
}

// Returns the mean brightness of the part of the picture that covers width x height. It is drawn again on a small canvas of
// the processor, because reading back a canvas of the graphics processor waits for all its pending work.
function brightnessOf(picture: Picture, width: number, height: number, place: Place): number {
    const scale = 32 / Math.max(width, height);
    const small = canvasOf(Math.ceil(width * scale), Math.ceil(height * scale));
    const context = small.getContext('2d', { alpha: false, willReadFrequently: true })!;
    drawCover(small, picture, place);
    const { data } = context.getImageData(0, 0, small.width, small.height);
    return data.reduce((sum, value, i) => (i % 4 < 3 ? sum + value : sum), 0) / (255 * 0.75 * data.length);
}

/** Multiplies the colours of a canvas that `picture` covers by the shade for its brightness. */
export function multiply(canvas: HTMLCanvasElement, picture: Picture, place: Place, shade: Shade): void {
    if (shade(1) === '#ffffff') return;  // the shade of darker pictures is not darker
    const context = canvas.getContext('2d')!;
    context.fillStyle = shade(brightnessOf(picture, canvas.width, canvas.height, place));
    context.globalCompositeOperation = 'multiply';
    context.fillRect(0, 0, canvas.width, canvas.height);
    context.globalCompositeOperation = 'source-over';
}

let scratch: HTMLCanvasElement | undefined;

/** Fills the bound texture with a part of the picture, scaled to width x height. The first row is the top. */
export function uploadCover(gl: WebGLRenderingContext, picture: Picture, width: number, height: number, place: Place, shade: Shade): void {
    scratch ??= canvasOf(width, height);
    if (scratch.width !== width) scratch.width = width;
    if (scratch.height !== height) scratch.height = height;
    drawCover(scratch, picture, place);
    try {
        if (picture.shaded) multiply(scratch, picture, place, shade);
        gl.texImage2D(gl.TEXTURE_2D, 0, gl.RGBA, gl.RGBA, gl.UNSIGNED_BYTE, scratch);
    } catch {  // a picture of another origin was drawn on the canvas after probe()
        scratch = undefined;
        throw new WaterError('cross-origin', 'The picture holds what this page may not use.');
    }
    if (!picture.moving()) scratch.width = scratch.height = 1;
}

let shipped: Promise<Picture> | undefined;

/** The light that waves reflect: sky with the sun's glitter. */
export const shippedLight = (): Promise<Picture> =>
    (shipped ??= createImageBitmap(new Blob([light], { type: 'image/webp' }))
        .then((bitmap) => still(bitmap, () => [bitmap.width, bitmap.height])));

/** Deep water, for a page without a picture. */
export function plainPicture(): Picture {
    const canvas = canvasOf(256, 256);
    const context = canvas.getContext('2d')!;
    const depth = context.createRadialGradient(100, 75, 0, 100, 75, 220);
    depth.addColorStop(0, '#2c7f8f');
    depth.addColorStop(1, '#0d3d4f');
    context.fillStyle = depth;
    context.fillRect(0, 0, 256, 256);
    return still(canvas, () => [256, 256]);
}

/** Grey, which `mix-blend-mode: hard-light` does not change. Lighter colours add light, darker ones remove it. */
export function greyPicture(): Picture {
    const canvas = canvasOf(1, 1);
    const context = canvas.getContext('2d')!;
    context.fillStyle = '#808080';
    context.fillRect(0, 0, 1, 1);
    return { ...still(canvas, () => [1, 1]), shaded: false };
}
