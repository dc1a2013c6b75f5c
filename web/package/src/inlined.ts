// The entry `tidemark-water/inlined`: one file that contains the module, for tools that do not serve the .wasm file.
import bytes from '../../../build/web/tidemark-water.wasm';
import { setModule } from './native.js';

export * from './index.js';

setModule(bytes);
