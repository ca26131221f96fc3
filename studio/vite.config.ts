import { defineConfig } from 'vite';

export default defineConfig({
    base: './',
    build: { target: 'es2022', modulePreload: { polyfill: false }, assetsInlineLimit: 0 },
    worker: { format: 'es' },
    preview: { host: '127.0.0.1', port: 4173, strictPort: true },
});
