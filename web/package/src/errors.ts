export type ErrorCode =
    | 'webgl'         // the browser has no WebGL, or has switched it off
    | 'simd'          // the browser has no WebAssembly with SIMD
    | 'csp'           // the page's content security policy lacks 'wasm-unsafe-eval'
    | 'module'        // tidemark-water.wasm does not load
    | 'cross-origin'  // another server's picture does not load, or comes without Access-Control-Allow-Origin
    | 'load'          // this server's picture does not load
    | 'decode';       // the file is not a picture that the browser can show

export class WaterError extends Error {
    override readonly name = 'WaterError';

    constructor(readonly code: ErrorCode, message: string) {
        super(message);
    }

    /** Whether this water cannot be drawn any more. */
    get isFatal(): boolean {
        return ['webgl', 'simd', 'csp', 'module'].includes(this.code);
    }
}

const said = new Set<string>();

/** On the console, the same once a page. */
export function warnOnce(text: string): void {
    if (said.has(text)) return;
    said.add(text);
    console.warn(`tidemark-water: ${text}`);
}
