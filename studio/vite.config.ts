import { defineConfig } from 'vite';
import { offline } from './build/offline.ts';

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
    server: { host: '127.0.0.1', fs: { allow: ['..'] } },
    preview: { host: '127.0.0.1', port: 4173, strictPort: true },
});
