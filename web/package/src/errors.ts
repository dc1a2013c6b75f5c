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
}
