import { defineConfig } from '@playwright/test';

const port = 4317;

export default defineConfig({
    testDir: 'e2e',
    fullyParallel: true,
    workers: 2,
    // What waits for long waits for a busy machine; a page that a browser loses there is tried once more.
    timeout: 120_000,
    expect: { timeout: 20_000 },
    retries: 1,
    reporter: [['list']],
    use: {
        baseURL: `http://127.0.0.1:${port}/`,
        viewport: { width: 1440, height: 900 },
        launchOptions: { executablePath: '/usr/bin/chromium', args: ['--no-sandbox'] },
    },
    // Speed is measured when nothing else runs.
    projects: [
        { name: 'page', testIgnore: 'speed.spec.ts' },
        { name: 'speed', testMatch: 'speed.spec.ts', dependencies: ['page'] },
    ],
    webServer: {
        command: `npx vite preview --port ${port}`,
        port,
        reuseExistingServer: false,
    },
});
