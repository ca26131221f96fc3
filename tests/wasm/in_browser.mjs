// Runs a program of the tests that was compiled for WebAssembly in headless Chromium, with the files that
// stand behind the dashes:
//
//     node tests/wasm/in_browser.mjs PROGRAM.wasm [ARGUMENT...] -- [FILE...]
//
// The page comes from this process and sends back what the program printed, and its exit code.
import { spawn } from 'node:child_process';
import { mkdtempSync, readFileSync, rmSync } from 'node:fs';
import { createServer } from 'node:http';
import { tmpdir } from 'node:os';
import { join } from 'node:path';

const kLongestRun = 120_000;
const dashes = process.argv.indexOf('--');
const [program, ...rest] = process.argv.slice(2, dashes);
const names = process.argv.slice(dashes + 1);

const page = `<!doctype html><meta charset="utf-8"><script type="module">
import { run } from '/wasi.mjs';
const bytesOf = async (path) => new Uint8Array(await (await fetch(path)).arrayBuffer());
let text = '';
let code = 1;
try {
    const names = ${JSON.stringify(names)};
    const files = new Map(await Promise.all(names.map(async (name, i) => [name, await bytesOf('/file/' + i)])));
    code = run(await WebAssembly.compile(await bytesOf('/program')), {
        args: ${JSON.stringify(['program', ...rest])},
        // From the root: a relative name begins there as well.
        files: { namesIn: () => undefined, bytesOf: (path) => files.get(path) ?? files.get(path.slice(1)) },
        print: (descriptor, printed) => { text += printed; },
    });
} catch (thrown) {
    text += thrown.stack;
}
await fetch('/done', { method: 'POST', body: JSON.stringify({ code, text }) });
</script>`;

/** What is served by its path; nothing where there is no such page. */
function served(path) {
    if (path === '/') return { type: 'text/html', body: page };
    if (path === '/wasi.mjs') {
        return { type: 'text/javascript', body: readFileSync(new URL('wasi.mjs', import.meta.url)) };
    }
    if (path === '/program') return { type: 'application/wasm', body: readFileSync(program) };
    const file = names[/^\/file\/(\d+)$/.exec(path)?.[1]];
    return file && { type: 'application/octet-stream', body: readFileSync(file) };
}

function start(url, profile) {
    return spawn('chromium', ['--headless', '--no-sandbox', '--disable-gpu', '--no-first-run',
        `--user-data-dir=${profile}`, url], { stdio: 'ignore', detached: true });
}

const profile = mkdtempSync(join(tmpdir(), 'voreleffect-'));
const done = await new Promise((resolve) => {
    const server = createServer(async (request, response) => {
        if (request.method !== 'POST') {
            const answer = served(request.url);
            response.writeHead(answer ? 200 : 404, { 'Content-Type': answer?.type ?? 'text/plain' });
            response.end(answer?.body ?? '');
            return;
        }
        let body = '';
        for await (const part of request) body += part;
        response.end();
        finish(JSON.parse(body));
    });
    let browser;
    let finished = false;
    const tooLate = setTimeout(() => finish({ code: 1, text: 'the browser did not answer\n' }), kLongestRun);
    const finish = (answer) => {
        if (finished) return;
        finished = true;
        clearTimeout(tooLate);
        server.closeAllConnections();
        server.close();
        if (browser.pid === undefined || browser.exitCode !== null) {
            resolve(answer);
            return;
        }
        browser.once('exit', () => resolve(answer));
        // The browser and the processes that it started.
        process.kill(-browser.pid, 'SIGKILL');
    };
    server.listen(0, '127.0.0.1', () => {
        browser = start(`http://127.0.0.1:${server.address().port}/`, profile);
        browser.once('error', (error) => finish({ code: 1, text: `chromium: ${error.message}\n` }));
        browser.once('exit', () => finish({ code: 1, text: 'the browser ended without an answer\n' }));
    });
});
rmSync(profile, { recursive: true, force: true, maxRetries: 5 });
process.stdout.write(done.text);
process.exitCode = done.code;
