// Files over HTTP, and Chromium to look at them.
import { once } from 'node:events';
import { readFile } from 'node:fs/promises';
import { createServer } from 'node:http';
import { extname, join, normalize } from 'node:path';

import { chromium } from 'playwright-core';

const TYPES = {
    '.html': 'text/html; charset=utf-8',
    '.js': 'text/javascript',
    '.wasm': 'application/wasm',
};

/** Serves a folder; what headers there are besides is asked for each path. */
export async function served(folder, headersOf = () => ({})) {
    const requests = [];
    const server = createServer(async (request, response) => {
        const path = normalize(new URL(request.url, 'http://localhost').pathname);
        requests.push(path);
        const name = path.endsWith('/') ? `${path}index.html` : path;
        try {
            const bytes = await readFile(join(folder, name));
            const type = TYPES[extname(name)] ?? 'application/octet-stream';
            response.writeHead(200, { 'Content-Type': type, ...headersOf(path) });
            response.end(bytes);
        } catch {
            response.writeHead(404).end();
        }
    }).listen(0, '127.0.0.1');
    await once(server, 'listening');
    const address = `http://127.0.0.1:${server.address().port}`;
    return { address, requests, close: () => server.close() };
}

/** Debian's Chromium. */
export function browser() {
    return chromium.launch({ executablePath: '/usr/bin/chromium', args: ['--no-sandbox'] });
}

/** What `window.result` of a page becomes, once it is there, and what the page complained of. */
export async function resultOf(running, address) {
    const page = await running.newPage();
    const complaints = [];
    page.on('pageerror', (error) => complaints.push(error.message));
    page.on('console', (message) => {
        if (message.type() === 'error') complaints.push(message.text());
    });
    await page.goto(address);
    const result = await page.waitForFunction(() => globalThis.result, null, { timeout: 20_000 });
    const value = await result.jsonValue();
    await page.close();
    return { value, complaints };
}
