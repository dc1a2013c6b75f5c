// Makes dist/: one module, the WebAssembly beside it, and types. Fails where the two are larger than promised.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { dirname, join } from 'node:path';
import { fileURLToPath } from 'node:url';
import { gzipSync } from 'node:zlib';
import { build } from 'esbuild';

const here = dirname(fileURLToPath(import.meta.url));
const root = join(here, '../..');
const most = 90_000;  // bytes, compressed

rmSync(join(here, 'dist'), { recursive: true, force: true });
mkdirSync(join(here, 'dist'));
const module = join(here, 'dist/tidemark-water.js');
const wasm = join(here, 'dist/tidemark-water.wasm');
await build({
    entryPoints: [join(here, 'src/index.ts')],
    outfile: module,
    bundle: true,
    minify: true,
    format: 'esm',
    target: 'es2022',
    loader: { '.webp': 'binary' },
    legalComments: 'none',
});
copyFileSync(join(root, 'build/web/tidemark-water.wasm'), wasm);
execFileSync('npx', ['tsc', '--project', here], { cwd: here, stdio: 'inherit' });
writeFileSync(join(here, 'licenses.txt'),
    ['LICENSE', 'THIRD_PARTY.md'].map((name) => readFileSync(join(root, name), 'utf8')).join('\n'));

const sizes = [module, wasm].map((file) => gzipSync(readFileSync(file), { level: 9 }).length);
const bytes = sizes[0] + sizes[1];
if (bytes >= most) throw new Error(`the package has ${bytes} bytes compressed, more than ${most}`);
console.log(`tidemark-water.js ${sizes[0]} and .wasm ${sizes[1]} bytes compressed`);
