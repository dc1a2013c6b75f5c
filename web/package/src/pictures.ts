// Pictures on their way into textures. They go from the browser's decoder to the GPU, cropped and scaled to the view;
// what stays in memory is the file as it came, which the browser decodes again after a lost context.
import { WaterError } from './errors.js';
import light from './light.webp';

export type Source =
    | string | URL | Blob | ImageBitmap | HTMLImageElement | HTMLVideoElement | HTMLCanvasElement | OffscreenCanvas;

export interface Picture {
    drawable: CanvasImageSource;
    size(): [number, number];
    /** Whether it may change by itself now. */
    moving(): boolean;
    /** Whether it has changed since the last call. */
    changed(): boolean;
    /** Whether the look darkens and tints it. Not what moves, which would be measured with every frame. */
    shaded: boolean;
}

/** The colour by which a picture is multiplied whose channels have this mean, 0 to 1. */
export type Shade = (brightness: number) => string;

function canvasOf(width: number, height: number): HTMLCanvasElement {
    const canvas = document.createElement('canvas');
    canvas.width = width;
    canvas.height = height;
    return canvas;
}

async function loadImage(url: string, priority: 'high' | 'low' | 'auto', blob?: Blob): Promise<HTMLImageElement> {
    const image = new Image();
    let address: URL;
    try {
        address = new URL(url, document.baseURI);
    } catch {
        throw new WaterError('load', `${url} is no address.`);
    }
    // Also where the address is the page's own: it may lead to another server, and a frame may be a sandbox.
    if (/^https?:/.test(address.protocol)) image.crossOrigin = 'anonymous';
    image.fetchPriority = priority;
    image.src = url;
    const loaded = await new Promise<boolean>((resolve) => {
        image.onload = () => resolve(true);
        image.onerror = () => resolve(false);
    });
    if (loaded) {
        await image.decode().catch(() => {});  // refused for some SVGs, which draw all the same
        return image;
    }
    if (blob) throw new WaterError('decode', 'The file is not a picture that this browser can show.');
    // Only a request with cookies could tell another server's refusal from a missing file.
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

/** Throws for what a texture would refuse in the middle of a frame. */
function probe(picture: Picture): Picture {
    const context = canvasOf(1, 1).getContext('2d', { willReadFrequently: true });
    const [width, height] = picture.size();
    if (!context || !width || !height) return picture;
    try {
        context.drawImage(picture.drawable, 0, 0, 1, 1, 0, 0, 1, 1);
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
    return probe(await load(source, priority));
}

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
    // A drawing may have proportions and no size.
    return still(image, () => [image.naturalWidth || 1024, image.naturalHeight || 1024]);
}

// Where of a picture a view shows its part: 0 is left or top, 1 right or bottom.
export type Place = readonly [x: number, y: number];

/** The place that a computed `object-position` names in percents. */
export function placeOf(position: string): Place {
    const share = (text = '') => (text.endsWith('%') ? Math.min(Math.max(parseFloat(text) / 100, 0), 1) : 0.5);
    const [x, y] = position.split(' ');
    return [share(x), share(y)];
}

/** Covers the whole canvas. */
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

function brightnessOf(canvas: HTMLCanvasElement): number {
    const side = 32;
    const context = canvasOf(side, side).getContext('2d', { willReadFrequently: true })!;
    context.imageSmoothingQuality = 'high';
    context.drawImage(canvas, 0, 0, side, side);
    const { data } = context.getImageData(0, 0, side, side);
    return data.reduce((sum, value, i) => (i % 4 < 3 ? sum + value : sum), 0) / (255 * 3 * side * side);
}

/** Multiplies the colours of a canvas. */
export function multiply(canvas: HTMLCanvasElement, shade: Shade): void {
    if (shade(1) === '#ffffff') return;  // and then for a darker one as well
    const context = canvas.getContext('2d')!;
    context.fillStyle = shade(brightnessOf(canvas));
    context.globalCompositeOperation = 'multiply';
    context.fillRect(0, 0, canvas.width, canvas.height);
    context.globalCompositeOperation = 'source-over';
}

let scratch: HTMLCanvasElement | undefined;

/** Fills the texture that is bound with a part of the picture, scaled to width x height. Rows go from the top. */
export function uploadCover(gl: WebGLRenderingContext, picture: Picture, width: number, height: number, place: Place, shade: Shade): void {
    scratch ??= canvasOf(width, height);
    if (scratch.width !== width) scratch.width = width;
    if (scratch.height !== height) scratch.height = height;
    drawCover(scratch, picture, place);
    try {
        if (picture.shaded) multiply(scratch, shade);
        gl.texImage2D(gl.TEXTURE_2D, 0, gl.RGBA, gl.RGBA, gl.UNSIGNED_BYTE, scratch);
    } catch {  // a canvas that was drawn on since
        scratch = undefined;
        throw new WaterError('cross-origin', 'The picture holds what this page may not use.');
    }
    if (!picture.moving()) scratch.width = scratch.height = 1;
}

let shipped: Promise<Picture> | undefined;

/** What the waves throw back: sky with the sun's glitter. */
export const shippedLight = (): Promise<Picture> =>
    (shipped ??= createImageBitmap(new Blob([light], { type: 'image/webp' }))
        .then((bitmap) => still(bitmap, () => [bitmap.width, bitmap.height])));

/** Without a picture: deep water. */
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

/** What `mix-blend-mode: hard-light` leaves out: lighter than this it adds light, darker it takes some. */
export function greyPicture(): Picture {
    const canvas = canvasOf(1, 1);
    const context = canvas.getContext('2d')!;
    context.fillStyle = '#808080';
    context.fillRect(0, 0, 1, 1);
    return { ...still(canvas, () => [1, 1]), shaded: false };
}
