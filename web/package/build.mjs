// Makes dist/: the modules, the WebAssembly beside them, and types. Fails where they are larger than promised.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { basename, dirname, join } from 'node:path';
import { fileURLToPath } from 'node:url';
import { gzipSync } from 'node:zlib';
import { build } from 'esbuild';

const here = dirname(fileURLToPath(import.meta.url));
const root = join(here, '../..');
const most = 90_000;  // bytes, compressed

rmSync(join(here, 'dist'), { recursive: true, force: true });
mkdirSync(join(here, 'dist'));
const dist = join(here, 'dist');
const { metafile } = await build({
    // The element's module is that of the canvases and a little more.
    entryPoints: { 'tidemark-water': join(here, 'src/index.ts'), core: join(here, 'src/core.ts') },
    outdir: dist,
    chunkNames: 'shared',
    splitting: true,
    bundle: true,
    minify: true,
    format: 'esm',
    target: 'es2022',
    loader: { '.webp': 'binary', '.css': 'text' },
    legalComments: 'none',
    metafile: true,
});
copyFileSync(join(here, 'src/style.css'), join(dist, 'style.css'));
copyFileSync(join(root, 'build/web/tidemark-water.wasm'), join(dist, 'tidemark-water.wasm'));
execFileSync('npx', ['tsc', '--project', here], { cwd: here, stdio: 'inherit' });
writeFileSync(join(here, 'licenses.txt'),
    ['LICENSE', 'THIRD_PARTY.md'].map((name) => readFileSync(join(root, name), 'utf8')).join('\n'));

const files = [...Object.keys(metafile.outputs).map((path) => basename(path)), 'tidemark-water.wasm'];
const sizes = files.map((file) => gzipSync(readFileSync(join(dist, file)), { level: 9 }).length);
const bytes = sizes.reduce((sum, size) => sum + size);
if (bytes >= most) throw new Error(`the package has ${bytes} bytes compressed, more than ${most}`);
console.log(`${files.map((file, i) => `${file} ${sizes[i]}`).join(', ')}: ${bytes} bytes compressed`);
