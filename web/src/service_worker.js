// Keeps the whole site, so that it opens without a network. The build inserts the version and the files.

// All pages of an origin share its caches, so the names contain the path of this page.
const ours = `tidemark ${self.registration.scope} `;
const cacheName = ours + 'VERSION';
const files = ['FILES'];

async function keepAll() {
    const cache = await caches.open(cacheName);
    await cache.addAll(files.map((file) => new Request(file, { cache: 'reload' })));
    await self.skipWaiting();
}

async function dropOlder() {
    const names = (await caches.keys()).filter((name) => name.startsWith(ours) && name !== cacheName);
    await Promise.all(names.map((name) => caches.delete(name)));
    await self.clients.claim();
}

async function answer(request) {
    const cache = await caches.open(cacheName);
    return (await cache.match(request, { ignoreSearch: true, ignoreVary: true })) ?? fetch(request);
}

self.addEventListener('install', (event) => event.waitUntil(keepAll()));
self.addEventListener('activate', (event) => event.waitUntil(dropOlder()));
self.addEventListener('fetch', (event) => {
    if (event.request.method === 'GET') event.respondWith(answer(event.request));
});
