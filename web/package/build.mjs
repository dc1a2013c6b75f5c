// Builds dist/: the scripts, the WebAssembly module, the types and the manifest. Fails if a page would load 90 KB or more.
import { execFileSync } from 'node:child_process';
import { copyFileSync, mkdirSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { basename, dirname, join } from 'node:path';
import { fileURLToPath } from 'node:url';
import { gzipSync } from 'node:zlib';
import { build } from 'esbuild';
import { rollup } from 'rollup';

const here = dirname(fileURLToPath(import.meta.url));
const root = join(here, '../..');
const most = 90_000;  // bytes of all files that a page loads, each compressed with gzip -9

// The custom elements manifest for editors. Its descriptions are the comments of attributes.ts.
function manifest() {
    const table = readFileSync(join(here, 'src/attributes.ts'), 'utf8');
    const entries = table.matchAll(/\/\*\*\n +\* (.*)\n +\* @default (.*)\n +\*\/\n +(\w+): \{ kind: '(\w+)'/g);
    const attributes = [...entries].map(([, description, without, fieldName, kind]) => ({
        name: fieldName === 'fetchPriority' ? 'fetchpriority' : fieldName.replace(/[A-Z]/g, (letter) => `-${letter.toLowerCase()}`),
        fieldName, description, default: without, type: { text: { flag: 'boolean', number: 'number' }[kind] ?? 'string' },
    }));
    const events = ['ready', 'calm', 'wake', 'error', 'contextlost', 'contextrestored'].map((name) => ({ name, type: { text: 'CustomEvent' } }));
    const declaration = {
        kind: 'class', customElement: true, name: 'WaterElement', tagName: 'tidemark-water', attributes, events,
        slots: [{ name: '', description: 'content above the water' }, { name: 'fallback', description: 'visible until the water is' }],
        cssParts: [{ name: 'water' }, { name: 'marker', description: 'the point where Enter and Space let a drop fall' }],
        cssStates: ['ready', 'calm', 'paused', 'failed'].map((name) => ({ name })),
    };
    return { schemaVersion: '2.1.0', modules: [{ kind: 'javascript-module', path: 'dist/tidemark-water.js', declarations: [declaration] }] };
}

// Removes the functions that Emscripten's glue declares and never calls. esbuild removes unused code only at the top level.
const shakeGlue = {
    name: 'shake-glue',
    setup: ({ onLoad }) => onLoad({ filter: /\/tidemark-water\.js$/ }, async ({ path }) => {
        const glue = await rollup({ input: path });
        const { output: [{ code }] } = await glue.generate({ format: 'es' });
        return { contents: code };
    }),
};

const dist = join(here, 'dist');
rmSync(dist, { recursive: true, force: true });
mkdirSync(dist);
const options = {
    outdir: dist,
    bundle: true,
    minify: true,
    format: 'esm',
    target: 'es2022',
    loader: { '.webp': 'binary', '.wasm': 'binary', '.css': 'text' },
    plugins: [shakeGlue],
    legalComments: 'none',
    metafile: true,
};
// Both entries share one file, so a page that imports both loads nothing twice.
const entryPoints = { 'tidemark-water': join(here, 'src/index.ts'), core: join(here, 'src/core.ts') };
const { metafile } = await build({ ...options, entryPoints, splitting: true, chunkNames: 'shared' });
// Bundlers copy each file that `new URL(name, import.meta.url)` names. This entry needs none.
await build({ ...options, entryPoints: [join(here, 'src/inlined.ts')], define: { 'import.meta.url': 'location.href' } });
copyFileSync(join(here, 'src/style.css'), join(dist, 'style.css'));
copyFileSync(join(root, 'build/web/tidemark-water.wasm'), join(dist, 'tidemark-water.wasm'));
execFileSync('npx', ['tsc', '--project', here], { cwd: here, stdio: 'inherit' });
writeFileSync(join(dist, 'custom-elements.json'), JSON.stringify(manifest(), null, 4));
writeFileSync(join(here, 'licenses.txt'),
    ['LICENSE', 'THIRD_PARTY.md'].map((name) => readFileSync(join(root, name), 'utf8')).join('\n'));

const files = [...Object.keys(metafile.outputs).map((path) => basename(path)), 'tidemark-water.wasm'];
const sizes = files.map((file) => gzipSync(readFileSync(join(dist, file)), { level: 9 }).length);
const bytes = sizes.reduce((sum, size) => sum + size);
if (bytes >= most) throw new Error(`the package has ${bytes} bytes compressed, more than ${most}`);
console.log(`${files.map((file, i) => `${file} ${sizes[i]}`).join(', ')}: ${bytes} bytes compressed`);
