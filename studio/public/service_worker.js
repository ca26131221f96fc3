/*
 * Keeps the page in the browser. Each build is a version with a cache of its own, filled as a whole: a visit is
 * answered by one build alone, and by the next one when no tab has the old one open any more.
 */

const version = 'VERSION';
const files = ['FILES'];
const prefix = `voreleffect-studio ${self.registration.scope} `;

self.addEventListener('install', (event) => {
    event.waitUntil(
        caches
            .open(prefix + version)
            .then((cache) =>
                cache.addAll(files.map((file) => new Request(file, { cache: 'reload' }))),
            ),
    );
});

self.addEventListener('activate', (event) => {
    event.waitUntil(
        caches
            .keys()
            .then((names) =>
                names.filter((name) => name.startsWith(prefix) && name !== prefix + version),
            )
            .then((old) => Promise.all(old.map((name) => caches.delete(name))))
            .then(() => self.clients.claim()),
    );
});

self.addEventListener('fetch', (event) => {
    const { request } = event;
    if (request.method !== 'GET' || new URL(request.url).origin !== self.location.origin) return;
    event.respondWith(
        caches
            .open(prefix + version)
            .then((cache) => cache.match(request, { ignoreSearch: true, ignoreVary: true }))
            .then((kept) => kept ?? fetch(request)),
    );
});
