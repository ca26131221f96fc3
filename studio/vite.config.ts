import { defineConfig } from 'vite';
import { offline } from './tools/offline.ts';

/** A page that no other one shares its process with has a clock of microseconds. */
const isolation = {
    'Cross-Origin-Opener-Policy': 'same-origin',
    'Cross-Origin-Embedder-Policy': 'require-corp',
};

export default defineConfig({
    base: './',
    plugins: [offline()],
    build: {
        target: 'es2022',
        outDir: '../build/studio',
        emptyOutDir: true,
        modulePreload: { polyfill: false },
        assetsInlineLimit: 0,
    },
    worker: { format: 'es' },
    preview: { host: '127.0.0.1', port: 4173, strictPort: true, headers: isolation },
});
