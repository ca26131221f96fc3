/** Lets the page open without a network: the service worker keeps what the build made. */
export function startOffline(): void {
    if (!('serviceWorker' in navigator)) return;
    addEventListener('load', () => {
        navigator.serviceWorker.register('./service_worker.js').catch(() => undefined);
    });
}
