// The library and its host as WebAssembly: compiled once a page, with an instance for each water, because the library
// keeps its state in globals.
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

/** Both pictures that may be under the water, for `_picturesChanged`. */
export const backgrounds = (1 << Slot.portrait) | (1 << Slot.landscape);

// The smallest module with a vector in it: a function that makes one and drops it.
const vectors = new Uint8Array([
    0, 97, 115, 109, 1, 0, 0, 0, 1, 4, 1, 96, 0, 0, 3, 2, 1, 0, 10, 9, 1, 7, 0, 65, 0, 253, 15, 26, 11,
]);

/** Compiled, or its address. */
export type ModuleSource = string | URL | WebAssembly.Module;

let source: ModuleSource | undefined;
let compiled: Promise<WebAssembly.Module> | undefined;

/** Where tidemark-water.wasm is, for waters from now on; beside the script where nothing else is said. */
export function setModule(module: ModuleSource): void {
    source = module;
    compiled = undefined;
}

async function fetchModule(): Promise<WebAssembly.Module> {
    if (typeof WebAssembly !== 'object' || !WebAssembly.validate(vectors)) {
        throw new WaterError('simd', 'This browser has no WebAssembly with SIMD.');
    }
    if (source instanceof WebAssembly.Module) return source;
    const url = source ?? new URL('tidemark-water.wasm', import.meta.url);
    const mend = 'setModule() says where it is, see "Bundlers" in the README of tidemark-water';
    const response = await fetch(url).catch(() => null);
    if (!response?.ok) throw new WaterError('module', `${url} does not load. ${mend}.`);
    try {
        // Not streaming: that would ask every server for the right type of content, for a few dozen kilobytes.
        return await WebAssembly.compile(await response.arrayBuffer());
    } catch (error) {
        const text = String(error);
        if (/CSP|content security|unsafe-eval/i.test(text)) {
            throw new WaterError('csp', "The content security policy needs script-src 'wasm-unsafe-eval'.");
        }
        throw new WaterError('module', `${url} is no module: ${text}. ${mend}.`);
    }
}

// A module that did not load is tried again with the next water.
export function compile(): Promise<WebAssembly.Module> {
    return (compiled ??= fetchModule().catch((error) => {
        compiled = undefined;
        throw error;
    }));
}

/** Fills the texture that is bound with width x height pixels; the light has as many as it likes. */
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
    setLook(look: Look): void;
    /** The colour by which a picture of this brightness, 0 to 1, is multiplied, for style sheets. */
    shade(slot: Slot, brightness: number): string;
    /** After a lost context: the same, restored, or another one. */
    renew(context: WebGLRenderingContext): void;
}

// The compiler's glue marks the canvas, which may outlive the water.
const unmark = ({ canvas }: WebGLRenderingContext) => delete (canvas as { GLctxObject?: unknown }).GLctxObject;

export async function instantiate(
    module: WebAssembly.Module, context: WebGLRenderingContext, load: Load, seed: number,
): Promise<Native> {
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
    instance._begin(seed);
    unmark(context);
    return Object.assign(instance, {
        setLook(look: Look) {
            const place = instance._nameToFill();
            for (const [name, value] of Object.entries(look)) {
                instance.HEAPU8.set(new TextEncoder().encode(`${name}\0`), place);
                if (!instance._setLookValue(value)) console.warn(`tidemark-water: the look refuses ${name} = ${value}.`);
            }
            instance._applyLook();
        },
        shade: (slot: Slot, brightness: number) => `#${instance._shade(slot, brightness).toString(16).padStart(6, '0')}`,
        renew(context: WebGLRenderingContext) {
            instance.context = context;
            instance._renewContext();
            unmark(context);
        },
    });
}
