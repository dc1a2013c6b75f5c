import { createHash } from 'node:crypto';
import { readdirSync, readFileSync, statSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { defineConfig } from 'vite';

const out = new URL('dist', import.meta.url).pathname;
const largestSite = 1_000_000;  // bytes before compression

// Adds the licenses, and the service worker, which has to know every file of the site and to change with each.
function completeSite() {
    return {
        name: 'complete-site',
        apply: 'build',
        closeBundle() {
            const text = (name) => readFileSync(new URL(`../${name}`, import.meta.url), 'utf8');
            writeFileSync(join(out, 'licenses.txt'), `${text('LICENSE')}\n${text('THIRD_PARTY.md')}`);
            const paths = readdirSync(out, { recursive: true }).filter((path) => statSync(join(out, path)).isFile()).sort();
            const hash = createHash('sha256');
            for (const path of paths) hash.update(path).update(readFileSync(join(out, path)));
            const code = readFileSync(new URL('src/service_worker.js', import.meta.url), 'utf8')
                .replace("'VERSION'", JSON.stringify(hash.digest('hex').slice(0, 16)))
                .replace("['FILES']", JSON.stringify(['./', ...paths]));
            writeFileSync(join(out, 'service_worker.js'), code);
            const bytes = [...paths, 'service_worker.js'].reduce((sum, path) => sum + statSync(join(out, path)).size, 0);
            if (bytes >= largestSite) throw new Error(`the site has ${bytes} bytes, more than ${largestSite}`);
            console.log(`${bytes} bytes in all`);
        },
    };
}

// What the scripts will ask for, asked for with the page, and the painter already started: round trips less until the
// first picture.
function hurry() {
    const start = (file) => `if (!location.search.includes('src=')) {
        painter = new Worker('./${file}', { type: 'module' });
        painter.onerror = () => { painter = null; };
    }`;
    const hint = (file) => (file.includes('painter')
        ? { rel: 'prefetch', href: `./${file}` }  // by the worker
        : { rel: 'preload', as: 'fetch', crossorigin: true, href: `./${file}` });
    return {
        name: 'hurry',
        apply: 'build',
        transformIndexHtml: {
            order: 'post',
            handler: (html, { bundle }) => Object.keys(bundle).filter((file) => /\.wasm$|\/painter-/.test(file)).map((file) => ({
                injectTo: 'head',
                ...(file.endsWith('.wasm') ? { tag: 'link', attrs: hint(file) } : { tag: 'script', children: start(file) }),
            })),
        },
    };
}

export default defineConfig({
    base: './',  // any folder of any server
    worker: { format: 'es' },
    server: { fs: { allow: ['..'] } },  // host/look.properties and build/web
    plugins: [hurry(), completeSite()],
});
