// The library and its host as WebAssembly. A page compiles the module once and makes an instance for each water, because
// the library keeps its state in globals.
import createInstance from '../../../build/web/tidemark-water.js';
import { WaterError } from './errors.js';
import type { Look } from './look.js';

// The action codes of the library.
export enum TouchAction {
    down = 0,
    up = 1,
    move = 2,
    cancel = 3,
}

export enum Frame {
    resting = 0,
    waiting = 1,
    drawn = 2,
    resize = 3,
}

export enum Slot {
    portrait = 0,
    landscape = 1,
    light = 2,
}

/** The slot of the picture that a canvas of this shape shows. */
export const slotOf = ({ width, height }: HTMLCanvasElement): Slot => (width > height ? Slot.landscape : Slot.portrait);

/** Both pictures that may be under the water, for `_picturesChanged`. */
export const backgrounds = (1 << Slot.portrait) | (1 << Slot.landscape);

// A module that a browser without SIMD refuses: its one function makes a vector and drops it.
const vectorModule = new Uint8Array([
    0, 97, 115, 109, 1, 0, 0, 0, 1, 4, 1, 96, 0, 0, 3, 2, 1, 0, 10, 9, 1, 7, 0, 65, 0, 253, 15, 26, 11,
]);

/** An address, the bytes, or the compiled module. */
export type ModuleSource = string | URL | BufferSource | WebAssembly.Module;

let source: ModuleSource | undefined;
let compiled: Promise<WebAssembly.Module> | undefined;

/** Sets the module of all waters that are made later. Without a call it is the tidemark-water.wasm beside the script. */
export function setModule(module: ModuleSource): void {
    source = module;
    compiled = undefined;
}

async function fetchModule(): Promise<WebAssembly.Module> {
    if (typeof WebAssembly !== 'object' || !WebAssembly.validate(vectorModule)) {
        throw new WaterError('simd', 'This browser has no WebAssembly with SIMD.');
    }
    if (source instanceof WebAssembly.Module) return source;
    const given = source ?? new URL('tidemark-water.wasm', import.meta.url);
    const isAddress = typeof given === 'string' || given instanceof URL;
    const name = isAddress ? given : 'The argument of setModule()';
    const mend = 'Call setModule() with the address of the file, see "Bundlers" in the README of tidemark-water';
    const response = isAddress ? await fetch(given).catch(() => null) : new Response(given);
    if (!response?.ok) throw new WaterError('module', `${name} does not load. ${mend}.`);
    try {
        // compileStreaming() would need servers that send the content type application/wasm.
        return await WebAssembly.compile(await response.arrayBuffer());
    } catch (error) {
        const text = String(error);
        if (/CSP|content security|unsafe-eval/i.test(text)) {
            throw new WaterError('csp', "The content security policy needs script-src 'wasm-unsafe-eval'.");
        }
        throw new WaterError('module', `${name} is not a WebAssembly module: ${text}. ${mend}.`);
    }
}

// Starts in a microtask: `import` upgrades the elements of the document before the page can call setModule(). After a
// failure the next water tries again.
export function compile(): Promise<WebAssembly.Module> {
    return (compiled ??= Promise.resolve().then(fetchModule).catch((error) => {
        compiled = undefined;
        throw error;
    }));
}

/** Fills the bound texture with width x height pixels. The light may have another size. */
export type Load = (slot: Slot, width: number, height: number) => void;

interface Instance {
    context: WebGLRenderingContext;
    HEAPU8: Uint8Array;
    _begin(seed: number): void;
    _nameToFill(): number;
    _setLookValue(value: number): number;
    _applyLook(): void;
    _setView(width: number, height: number, density: number, seconds: number): void;
    _setQuality(quality: number): void;
    _setShortestFrame(seconds: number): void;
    _width(): number;
    _height(): number;
    _resized(): void;
    _setInk(withInk: boolean): void;
    _setRain(falling: boolean): void;
    _setBreezeAlways(always: boolean): void;
    _clearInk(): void;
    _touch(action: number, x: number, y: number, pressure: number, seconds: number): void;
    _drop(x: number, y: number, weight: number): void;
    _splash(x: number, y: number, weight: number): void;
    _picturesChanged(which: number): void;
    _shade(slot: Slot, brightness: number): number;
    _redraw(): void;
    _renewContext(): void;
    _frame(seconds: number): number;
}
export interface Native extends Instance {
    /** Returns false, and does nothing, where these values are already set. */
    setDrawing(look: Look, quality: number, ink: boolean): boolean;
    /** The CSS colour by which a picture of this mean brightness, 0 to 1, is multiplied. */
    shade(slot: Slot, brightness: number): string;
    /** Makes all graphics objects anew, after a lost context, in the restored one or in another. */
    renew(context: WebGLRenderingContext): void;
}

// The compiler's glue keeps a reference in the canvas, which may outlive the water.
const unmark = ({ canvas }: WebGLRenderingContext) => delete (canvas as { GLctxObject?: unknown }).GLctxObject;

export async function instantiate(module: WebAssembly.Module, context: WebGLRenderingContext, load: Load): Promise<Native> {
    const instance = await new Promise<unknown>((resolve, reject) => {
        createInstance({
            context,
            load,
            instantiateWasm(imports: WebAssembly.Imports, done: (instance: WebAssembly.Instance) => void) {
                WebAssembly.instantiate(module, imports).then(done, reject);
                return {};
            },
        }).then(resolve, reject);
    }) as Instance;
    instance._begin(1 + Math.floor(Math.random() * 1e6));
    unmark(context);
    let drawing = '';
    return Object.assign(instance, {
        setDrawing(look: Look, quality: number, ink: boolean) {
            const wanted = JSON.stringify([look, quality, ink]);
            if (wanted === drawing) return false;
            drawing = wanted;
            const place = instance._nameToFill();
            for (const [name, value] of Object.entries(look)) {
                instance.HEAPU8.set(new TextEncoder().encode(`${name}\0`), place);
                if (!instance._setLookValue(value)) console.warn(`tidemark-water: the look refuses ${name} = ${value}.`);
            }
            instance._applyLook();
            instance._setQuality(quality);
            instance._setInk(ink);
            return true;
        },
        shade: (slot: Slot, brightness: number) => `#${instance._shade(slot, brightness).toString(16).padStart(6, '0')}`,
        renew(context: WebGLRenderingContext) {
            instance.context = context;
            instance._renewContext();
            unmark(context);
        },
    });
}
