// The library and its host as WebAssembly; scripts/web.sh compiles them.
import createTidemark from '../../build/web/tidemark.js';
import url from '../../build/web/tidemark.wasm?url';

export const loadModule = () => createTidemark({ locateFile: () => url });

export interface Pixels {
    width: number;
    height: number;
    rgba: Uint8Array | Uint8ClampedArray;  // rows from the top
}
