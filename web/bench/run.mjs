// Measures the package in headless Chromium on its software GPU, in turn with another page of ripples, and writes a
// document: node bench/run.mjs PEER DOCUMENT, where PEER is the folder into which npm has installed the other page's
// packages.
import { readFileSync, statSync, writeFileSync } from 'node:fs';
import { createServer } from 'node:http';
import { cpus, loadavg } from 'node:os';
import { extname, join } from 'node:path';
import { gzipSync } from 'node:zlib';
import { chromium } from '@playwright/test';
import { build } from 'esbuild';
import config from '../tests/playwright.config.mjs';

const [peer, output] = process.argv.slice(2);
const web = new URL('..', import.meta.url).pathname;
const picture = join(web, 'package/examples/pebbles.webp');
const folders = {
    bench: join(web, 'bench'),
    dist: join(web, 'package/dist'),
    named: join(web, '../build/web/named'),  // what web/native/CMakeLists.txt makes for a profiler
    peer: join(peer, 'node_modules'),
};
await build({
    entryPoints: [join(web, 'package/src/index.ts')],
    outfile: join(folders.named, 'index.js'),
    bundle: true,
    format: 'esm',
    target: 'es2022',
    loader: { '.webp': 'binary', '.css': 'text' },
    plugins: [{
        name: 'named',
        setup: ({ onResolve }) => onResolve({ filter: /web\/tidemark-water\.js$/ }, () => ({ path: join(folders.named, 'tidemark-water.js') })),
    }],
});

const views = [[360, 640], [720, 1280], [1440, 900]];
const middle = views[1];
const settled = 3000;   // milliseconds until the pace has chosen how finely to draw
const measured = 2500;  // milliseconds
const rounds = 5;

const water = (attributes = '') => `<tidemark-water src="/picture.webp" ${attributes}></tidemark-water>`;
const scenes = { water: water(), ink: water('ink'), rain: water('rain'), 'card of 20': water('rain').repeat(20) };
const pages = {
    peer: `<div id="peer"></div><script src="/peer/jquery/dist/jquery.min.js"></script>
<script src="/peer/jquery.ripples/dist/jquery.ripples-min.js"></script><script>$('#peer').ripples({ resolution: 512 })</script>`,
    first: `<link rel="modulepreload" href="/dist/shared.js">
<link rel="preload" href="/dist/tidemark-water.wasm" as="fetch" crossorigin><script type="module" src="/dist/tidemark-water.js"></script>
<tidemark-water><img slot="fallback" src="/picture.webp" alt="" crossorigin></tidemark-water>
<script>document.querySelector('tidemark-water').addEventListener('ready', () => (window.readyAt = performance.now()))</script>`,
};
const page = (scene, script) => `<!doctype html><html lang="en"><meta charset="utf-8"><title>bench</title>
<style>body { margin: 0; display: grid; height: 100vh } tidemark-water { min-height: 0 }
body:has(tidemark-water:nth-of-type(20)) { grid-template-columns: repeat(4, 1fr) }
#peer { background: url(/picture.webp) center / cover }</style>
${scene === 'first' ? '' : '<script src="/bench/page.js"></script>'}
${pages[scene] ?? `<script type="module" src="${script}"></script>${scenes[scene]}`}`;

const types = { '.js': 'text/javascript', '.wasm': 'application/wasm', '.webp': 'image/webp' };
const zipped = new Map();
function zippedFile(path) {
    if (!zipped.has(path)) zipped.set(path, gzipSync(readFileSync(path), { level: 9 }));
    return zipped.get(path);
}
const server = createServer((request, response) => {
    const { pathname, searchParams } = new URL(request.url, 'http://localhost');
    const [, folder, ...rest] = pathname.split('/');
    const path = folder in folders ? join(folders[folder], ...rest) : picture;
    try {
        const isPage = pathname === '/';
        const content = isPage ? gzipSync(page(searchParams.get('scene'), searchParams.get('script'))) : zippedFile(path);
        // An isolated page's clock has a resolution of 5 us, any other's one of 100 us.
        response.writeHead(200, {
            'content-type': isPage ? 'text/html' : types[extname(path)], 'content-encoding': 'gzip',
            'cross-origin-opener-policy': 'same-origin', 'cross-origin-embedder-policy': 'require-corp' });
        response.end(content);
    } catch {
        response.writeHead(404).end();
    }
});
await new Promise((resolve) => server.listen(0, 'localhost', resolve));
const browser = await chromium.launch(config.use.launchOptions);

const rank = (values, share) => values.toSorted((a, b) => a - b)[Math.floor(share * (values.length - 1))];
const median = (values) => rank(values, 0.5);

// `use` gets the tab and a session of the browser's protocol, once the scene shows.
async function withScene(scene, [width, height], density, use, { script = '/dist/tidemark-water.js', prepare = async () => {} } = {}) {
    const context = await browser.newContext({ viewport: { width, height }, deviceScaleFactor: density });
    try {
        const tab = await context.newPage();
        const session = await context.newCDPSession(tab);
        await prepare(session);
        await tab.goto(`http://localhost:${server.address().port}/?${new URLSearchParams({ scene, script })}`);
        await tab.waitForFunction(() => document.querySelector('#peer, tidemark-water[shown]'));
        return await use(tab, session);
    } finally {
        await context.close();
    }
}

async function settle(tab, scene) {
    if (scene !== 'rain' && scene !== 'card of 20') {
        await tab.evaluate(() => window.bench.drag(document.querySelector('tidemark-water, #peer')));
    }
    await tab.waitForTimeout(settled);
}
const framesOf = (tab, milliseconds) => tab.evaluate((milliseconds) => window.bench.frames(milliseconds), milliseconds);

const measure = (scene, view, density) => withScene(scene, view, density, async (tab) => {
    await settle(tab, scene);
    const frames = await framesOf(tab, measured);
    const whole = frames.map((frame) => frame.whole);
    const size = await tab.evaluate(() => {
        const canvas = document.querySelector('tidemark-water')?.water.canvas;
        return canvas ? `${canvas.width}×${canvas.height}` : '';
    });
    return {
        whole: median(whole), slow: rank(whole, 0.95), rate: 1000 * (frames.length - 1) / (frames.at(-1).now - frames[0].now),
        main: median(frames.map((frame) => frame.main)), size };
});

// The profiler's samples of the main thread, as shares.
const parts = {
    waves: /stepWaves|addRipple/,
    heights: /SurfaceMesh|Breeze|^_*(sin|cos|k_sin|k_cos|rem_pio2)$/,
    ink: /TShader|Fluid::(?!Ripple)|packVelocity|rand48/,
    'rest of the library': null,
    'Emscripten\'s GL': /^_*gl[A-Z]|[wW]eb[gG][lL]|^known$|^UTF8|wasm-to-js/,
    WebGL: null,
    'element and pointers': null,
};
function partOf({ functionName, url }, webgl) {
    if (url.startsWith('wasm')) return ['waves', 'heights', 'ink'].find((part) => parts[part].test(functionName)) ?? 'rest of the library';
    if (!url) return webgl.has(functionName) && functionName !== 'readPixels' ? 'WebGL' : null;
    if (!url.endsWith('/index.js')) return null;
    return parts['Emscripten\'s GL'].test(functionName) ? 'Emscripten\'s GL' : 'element and pointers';
}
const profile = (scene) => withScene(scene, middle, 1, async (tab, session) => {
    const interval = 50;  // us
    await settle(tab, scene);
    const webgl = new Set(await tab.evaluate(() => Object.getOwnPropertyNames(WebGLRenderingContext.prototype)));
    await session.send('Profiler.enable');
    await session.send('Profiler.setSamplingInterval', { interval });
    await session.send('Profiler.start');
    const frames = await framesOf(tab, 2 * measured);
    const { profile: { nodes, samples, timeDeltas } } = await session.send('Profiler.stop');
    const partOfNode = new Map(nodes.map(({ id, callFrame }) => [id, partOf(callFrame, webgl)]));
    const sums = Object.fromEntries(Object.keys(parts).map((part) => [part, 0]));
    samples.forEach((id, i) => {
        const part = partOfNode.get(id);
        // While another program has the processor no samples are taken.
        if (part) sums[part] += Math.min(timeDeltas[i + 1] ?? interval, 3 * interval);
    });
    const all = Object.values(sums).reduce((sum, value) => sum + value);
    const usual = frames.filter(({ uploads }) => uploads === (scene === 'ink' ? 1 : 0));
    return {
        main: usual.length > 0 ? median(usual.map((frame) => frame.main)) : NaN,
        shares: Object.values(sums).map((sum) => sum / all),
        memory: await tab.evaluate(() => document.querySelector('tidemark-water').water.native.HEAPU8.length) };
}, { script: '/named/index.js' });

const firstPicture = (network) => withScene('first', middle, 1, (tab) => tab.evaluate(() => ({
    at: window.readyAt,
    files: performance.getEntriesByType('resource').map(({ name }) => name.split('/dist/')[1]).filter(Boolean),
})), {
    prepare: async (session) => {
        await session.send('Network.enable');
        if (network) await session.send('Network.emulateNetworkConditions', { offline: false, ...network });
    },
});

const round = (value, digits = 1) => (Number.isFinite(value) ? value.toFixed(digits) : '');
const table = (head, rows) => [head, head.map(() => '---'), ...rows].map((row) => `| ${row.join(' | ')} |`).join('\n');

async function report() {
    const ratios = { water: [], ink: [] };
    for (let i = 0; i < rounds; ++i) {
        const other = await measure('peer', middle, 1);
        for (const scene of Object.keys(ratios)) ratios[scene].push((await measure(scene, middle, 1)).whole / other.whole);
    }
    const rows = [];
    for (const view of views) {
        for (const density of [1, 2]) {
            for (const scene of Object.keys(scenes)) {
                const { whole, slow, rate, main, size } = await measure(scene, view, density);
                rows.push([scene, view.join('×'), density, size, round(whole), round(slow), round(rate, 0), round(main, 2)]);
                console.log(rows.at(-1).join('  '));
            }
        }
    }
    const shares = [];
    const memory = {};
    for (const scene of Object.keys(scenes)) {
        const result = await profile(scene);
        shares.push([scene, round(result.main, 2), ...result.shares.map((share) => `${round(100 * share, 0)} %`)]);
        memory[scene] = result.memory;
    }
    const slow4g = { latency: 150, downloadThroughput: 200_000, uploadThroughput: 200_000 };
    const first = { none: [], slow4g: [] };
    for (let i = 0; i < rounds; ++i) {
        first.none.push(await firstPicture(null));
        first.slow4g.push(await firstPicture(slow4g));
    }
    const { files } = first.none[0];
    const firstAt = (times) => round(median(times.map(({ at }) => at)), 0);
    const bytes = files.map((name) => `${name} ${zippedFile(join(folders.dist, name)).length}`);
    const total = files.reduce((sum, name) => sum + zippedFile(join(folders.dist, name)).length, 0);

    return `# Benchmark of the page

Written by \`scripts/bench.sh --web\`: Chromium ${browser.version()} without a window, its software GPU on
${cpus().length} cores of: ${cpus()[0].model}, with a load average of ${round(loadavg()[1])}. If the load
average is above the number of cores, other processes slowed this run down: compare rows of the same run only.

A whole frame lasts from its call until its pixels can be read. In *water* and *ink* a pointer draws circles; *rain* and
*card of 20*, twenty elements on a page, have rain and no pointer. The quality is \`auto\`; "size drawn" is the resolution
that it has chosen after ${settled / 1000} s.

Whole frames at ${middle.join('×')}, density 1, against those of [jquery.ripples](https://www.npmjs.com/package/jquery.ripples) at its resolution
512, which draws the same picture under the same circles. Medians of ${rounds} rounds in turn.

${table(['ours / jquery.ripples', 'goal', 'ratio', 'lowest', 'highest'], [['water', 0.85], ['ink', 1.3]].map(([scene, goal]) =>
        [scene, `at most ${goal}`, round(median(ratios[scene]), 2), round(Math.min(...ratios[scene]), 2), round(Math.max(...ratios[scene]), 2)]))}

${table(['scene', 'view', 'density', 'size drawn', 'whole frame, ms', 'slowest twentieth, ms', 'frames/s', 'main thread, ms'], rows)}

Main-thread time of a frame at ${middle.join('×')}, density 1. "ms" is the median, with ink of the frames that run exactly one ink
step if there are any. The other columns are shares of the profiler's samples. *WebGL* is the browser's side of the calls; the
driver runs in another process.

${table(['scene', 'ms', ...Object.keys(parts)], shares)}

${table(['', ''], [
        ['first picture', `${firstAt(first.none)} ms`],
        ['first picture on slow 4G (1.6 Mbit/s, 150 ms)', `${firstAt(first.slow4g)} ms, with a picture of ${statSync(picture).size} bytes`],
        ['package, compressed', `${total} bytes: ${bytes.join(', ')}`],
        ['WebAssembly memory of a water', Object.entries(memory).filter(([scene]) => ['water', 'ink'].includes(scene)).map(([scene, size]) => `${round(size / 2 ** 20)} MiB with ${scene === 'ink' ? 'ink' : 'water only'}`).join(', ')],
    ])}
`;
}

try {
    writeFileSync(output, await report());
} finally {
    await browser.close();
    server.close();
}
