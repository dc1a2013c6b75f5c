export type ErrorCode =
    | 'webgl'         // the browser has no WebGL, or WebGL is switched off
    | 'simd'          // the browser has no WebAssembly with SIMD
    | 'csp'           // the page's content security policy lacks 'wasm-unsafe-eval'
    | 'module'        // tidemark-water.wasm does not load
    | 'cross-origin'  // another server's picture does not load, or has no Access-Control-Allow-Origin for this page
    | 'load'          // this server's picture does not load
    | 'decode';       // the browser cannot decode the file as a picture

export class WaterError extends Error {
    override readonly name = 'WaterError';

    constructor(readonly code: ErrorCode, message: string) {
        super(message);
    }

    /** Whether the error ends the water: it cannot be drawn any more. */
    get isFatal(): boolean {
        return ['webgl', 'simd', 'csp', 'module'].includes(this.code);
    }
}

const warned = new Set<string>();

/** Writes a warning to the console, each text once. */
export function warnOnce(text: string): void {
    if (warned.has(text)) return;
    warned.add(text);
    console.warn(`tidemark-water: ${text}`);
}
