/*
 * Keeps the page in the browser. Each build is a version with a cache of its own, filled as a whole: a visit is
 * answered by one build alone, and by the next one when no tab has the old one open any more.
 */

const version = 'VERSION';
const files = ['FILES'];
const prefix = `voreleffect-studio ${self.registration.scope} `;

/** The answer with the headers by which the browser gives the page a clock of microseconds. */
function isolated(answer) {
    const headers = new Headers(answer.headers);
    headers.set('Cross-Origin-Opener-Policy', 'same-origin');
    headers.set('Cross-Origin-Embedder-Policy', 'require-corp');
    return new Response(answer.body, { status: answer.status, headers });
}

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
            .then((kept) => (kept ? isolated(kept) : fetch(request))),
    );
});
