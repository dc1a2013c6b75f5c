import { createHash } from 'node:crypto';
import { readdirSync, readFileSync, statSync, writeFileSync } from 'node:fs';
import { join, posix } from 'node:path';
import { Marked } from 'marked';
import { defineConfig } from 'vite';
import { presets } from 'tidemark-water/core';
import { usualPreset } from './src/grounds';

const out = new URL('dist', import.meta.url).pathname;
const largestSite = 1_000_000;  // bytes, not compressed

// Renders the documents that the page links to as HTML pages. Links to other files become plain text, and pictures, which
// would double the size of the site, become their descriptions.
const documents = ['README.md', 'web/README.md', 'web/package/README.md', 'android/README.md',
    ...['bench', 'bench-page', 'contract', 'engine', 'host', 'look', 'promises'].map((name) => `docs/${name}.md`)];

function renderDocuments() {
    const pageOf = (path) => path.replace(/\.md$/, '.html');
    const render = (path) => {
        const marked = new Marked({
            renderer: {
                image: ({ text }) => `<em>${text}</em>`,
                html: ({ text }) => text.replace(/<img[^>]*alt="([^"]*)"[^>]*>/g, '<em>$1</em>'),
                link({ href, tokens }) {
                    const text = this.parser.parseInline(tokens);
                    if (/^https?:/.test(href)) return `<a href="${href}">${text}</a>`;
                    const [file, place] = href.split('#');
                    const target = file ? posix.join(posix.dirname(path), file) : path;
                    return documents.includes(target) ? `<a href="${posix.relative(posix.dirname(path), pageOf(target))}${place ? `#${place}` : ''}">${text}</a>` : text;
                },
                heading({ tokens, depth }) {
                    const text = this.parser.parseInline(tokens);
                    return `<h${depth} id="${text.toLowerCase().replace(/[^\w ]/g, '').replaceAll(' ', '-')}">${text}</h${depth}>`;
                },
            },
        });
        const text = readFileSync(new URL(`../${path}`, import.meta.url), 'utf8');
        const top = '../'.repeat(path.split('/').length);
        return `<!doctype html><html lang="en"><head><meta charset="utf-8"><title>${/^# (.*)/m.exec(text)[1]}</title>
<meta name="viewport" content="width=device-width, initial-scale=1"><link rel="icon" href="${top}favicon.svg"><link rel="stylesheet" href="${top}documents.css"></head>
<body><p><a href="${top}">Tidemark</a></p>${marked.parse(text)}</body></html>`;
    };
    return {
        name: 'render-documents',
        apply: 'build',
        generateBundle() {
            for (const path of documents) this.emitFile({ type: 'asset', fileName: `documents/${pageOf(path)}`, source: render(path) });
        },
    };
}

// The picture of shared links needs an absolute address.
const site = process.env.SITE ?? '.';

// Writes the licenses, and the service worker with the list of all files and a version that changes with each of them.
function completeSite() {
    return {
        name: 'complete-site',
        apply: 'build',
        transformIndexHtml: (html) => html.replace('./card.jpg', `${site}/card.jpg`),
        closeBundle() {
            const text = (name) => readFileSync(new URL(`../${name}`, import.meta.url), 'utf8');
            writeFileSync(join(out, 'licenses.txt'), `${text('LICENSE')}\n${text('THIRD_PARTY.md')}`);
            const paths = readdirSync(out, { recursive: true }).filter((path) => statSync(join(out, path)).isFile()).sort();
            const offline = paths.filter((path) => path !== 'card.jpg');  // only other sites show it
            const hash = createHash('sha256');
            for (const path of paths) hash.update(path).update(readFileSync(join(out, path)));
            const code = readFileSync(new URL('src/service_worker.js', import.meta.url), 'utf8')
                .replace("'VERSION'", JSON.stringify(hash.digest('hex').slice(0, 16)))
                .replace("['FILES']", JSON.stringify(['./', ...offline]));
            writeFileSync(join(out, 'service_worker.js'), code);
            const bytes = [...paths, 'service_worker.js'].reduce((sum, path) => sum + statSync(join(out, path)).size, 0);
            if (bytes >= largestSite) throw new Error(`the site has ${bytes} bytes, more than ${largestSite}`);
            console.log(`${bytes} bytes in all`);
        },
    };
}

// Adds tags that load the modules together with the page and start the painter, which saves round trips before the first
// picture. The painter comes first, because it takes longest.
function preloadModules() {
    const tags = [
        [/\/painter-|painter.*\.wasm$/, { rel: 'prefetch', fetchpriority: 'high' }],  // loaded by the worker
        [/water.*\.wasm$/, { rel: 'preload', as: 'fetch', crossorigin: true }],
    ];
    return {
        name: 'preload-modules',
        apply: 'build',
        generateBundle(_, bundle) {
            const painter = Object.keys(bundle).find((file) => file.includes('/painter-'));
            const source = readFileSync(new URL('src/early_painter.js', import.meta.url), 'utf8')
                .replace('PAINTER', `./${painter}`).replace('GROUND', JSON.stringify(presets[usualPreset].ground));
            this.emitFile({ type: 'asset', name: 'early_painter.js', source });
        },
        transformIndexHtml: {
            order: 'post',
            handler: (html, { bundle }) => {
                const files = Object.keys(bundle).map((file) => `./${file}`);
                const early = files.find((file) => file.includes('/early_painter-'));
                const viewport = html.match(/<meta name="viewport".*>/);
                if (!early || !viewport) throw new Error('the early painter has no place in the page');
                return {
                    // The script reads the size of the view. Below a style sheet it would run only once that has loaded.
                    html: html.replace(viewport[0], `$&\n        <script src="${early}"></script>`),
                    tags: tags.flatMap(([pattern, attrs]) => files.filter((file) => pattern.test(file)).map((href) => ({
                        tag: 'link', attrs: { ...attrs, href }, injectTo: 'head-prepend' }))),
                };
            },
        },
    };
}

export default defineConfig({
    appType: 'mpa',  // unknown addresses give 404 instead of this page
    base: './',  // the site works in any folder of a server
    worker: { format: 'es' },
    server: { fs: { allow: ['..'] } },  // host/look.properties and build/web
    // Refuses inline scripts and styles.
    preview: { headers: { 'content-security-policy': "default-src 'self'; script-src 'self' 'wasm-unsafe-eval'; img-src * blob: data:" } },
    plugins: [preloadModules(), renderDocuments(), completeSite()],
});
