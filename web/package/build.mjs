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

// What editors read of the element: the comments of its attributes.
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
        slots: [{ name: '', description: 'what is above the water' }, { name: 'fallback', description: 'shows until the water does' }],
        cssParts: [{ name: 'water' }, { name: 'marker', description: 'where a key lets a drop fall' }],
        cssStates: ['ready', 'calm', 'paused', 'failed'].map((name) => ({ name })),
    };
    return { schemaVersion: '2.1.0', modules: [{ kind: 'javascript-module', path: 'dist/tidemark-water.js', declarations: [declaration] }] };
}

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
writeFileSync(join(dist, 'custom-elements.json'), JSON.stringify(manifest(), null, 4));
writeFileSync(join(here, 'licenses.txt'),
    ['LICENSE', 'THIRD_PARTY.md'].map((name) => readFileSync(join(root, name), 'utf8')).join('\n'));

const files = [...Object.keys(metafile.outputs).map((path) => basename(path)), 'tidemark-water.wasm'];
const sizes = files.map((file) => gzipSync(readFileSync(join(dist, file)), { level: 9 }).length);
const bytes = sizes.reduce((sum, size) => sum + size);
if (bytes >= most) throw new Error(`the package has ${bytes} bytes compressed, more than ${most}`);
console.log(`${files.map((file, i) => `${file} ${sizes[i]}`).join(', ')}: ${bytes} bytes compressed`);
