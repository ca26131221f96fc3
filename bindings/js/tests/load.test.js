import assert from 'node:assert/strict';
import { once } from 'node:events';
import { readFileSync } from 'node:fs';
import { createServer } from 'node:http';
import { after, test } from 'node:test';
import { fileURLToPath } from 'node:url';
import { Worker } from 'node:worker_threads';

import { load, VorelError } from 'voreleffect';
import { load as loadInline } from 'voreleffect/inline';
import { load as loadInPage } from '../dist/index.js';
import { disc, everything } from './scenes.js';
import { MODULE } from './support.js';

const address = new URL('../dist/voreleffect.wasm', import.meta.url);
const bytes = readFileSync(address);
const { version } = JSON.parse(readFileSync(new URL('../package.json', import.meta.url)));

const server = createServer((request, response) => {
    const [path, type] = request.url.split('?');
    const isThere = path === '/voreleffect.wasm';
    const kind = type ? decodeURIComponent(type) : 'application/wasm';
    response.writeHead(isThere ? 200 : 404, { 'Content-Type': kind });
    response.end(isThere ? bytes : 'not here');
}).listen(0, '127.0.0.1');
await once(server, 'listening');
const site = `http://127.0.0.1:${server.address().port}`;
after(() => server.close());

const refused = (source, message) => assert.rejects(load(source), { name: 'VorelError', message });

test('Version_IsThatOfThePackageAndOfTheHeader', async () => {
    const header = readFileSync(
        new URL('../../../include/voreleffect/VFVersion.h', import.meta.url),
        'utf8',
    );
    const parts = ['MAJOR', 'MINOR', 'PATCH'].map(
        (part) => header.match(`VOREL_VERSION_${part} (\\d+)`)[1],
    );
    assert.equal(parts.join('.'), version);
    assert.equal((await load()).version, version);
});

test('Sources_OfEveryKindAreTaken', async () => {
    const shifted = new Uint8Array(bytes.length + 3);
    shifted.set(bytes, 3);
    const shared = new Uint8Array(new SharedArrayBuffer(bytes.length));
    shared.set(bytes);
    const sources = {
        nothing: undefined,
        'a URL of a file': address,
        'the address of a file': address.href,
        'a path': fileURLToPath(address),
        'an address': `${site}/voreleffect.wasm`,
        'a response': await fetch(`${site}/voreleffect.wasm`),
        'a response that is to come': fetch(`${site}/voreleffect.wasm`),
        'a response of another kind': fetch(`${site}/voreleffect.wasm?text/plain`),
        'a response with a charset': fetch(`${site}/voreleffect.wasm?application/wasm;charset=x`),
        'a buffer': Uint8Array.from(bytes).buffer,
        'a part of one': shifted.subarray(3),
        'a view of one': new DataView(shifted.buffer, 3),
        'a shared one': shared,
        'a module': MODULE,
    };
    for (const [kind, source] of Object.entries(sources)) {
        const ve = await load(source);
        assert.equal(ve.version, version, kind);
        assert.equal(new ve.Look().stroke(3, 0).margins.left, 3);
    }
});

test('Entries_PaintTheSame', async () => {
    const pictures = [];
    for (const ve of [await load(), await loadInline(), await loadInPage(bytes)]) {
        pictures.push(everything(new ve.Look(), 3).paint(disc()));
    }
    assert.deepEqual(pictures[1], pictures[0]);
    assert.deepEqual(pictures[2], pictures[0]);
});

test('Load_SaysWhatIsWrong', async () => {
    await refused(`${site}/none.wasm`, `no module: 404 for ${site}/none.wasm`);
    await refused(fetch(`${site}/none.wasm`), /^no module: 404 for /);
    await refused(
        new TextEncoder().encode('<!doctype html>'),
        'no module: it begins with "<!doctype"',
    );
    await refused(new Uint8Array(), 'no module: it begins with ""');
    await refused(bytes.subarray(0, 999), /^no module that can be compiled here: /);
    const empty = Uint8Array.of(0, 0x61, 0x73, 0x6d, 1, 0, 0, 0);
    await refused(empty, 'this module is not voreleffect.wasm: it has no memory');
    await assert.rejects(load('/no/such.wasm'), { code: 'ENOENT' });
    for (const source of [null, 5, {}, [], true]) await assert.rejects(load(source), TypeError);
    await assert.rejects(load(Promise.reject(new Error('offline'))), { message: 'offline' });
});

test('Load_RefusesTheModuleOfAnotherVersion', async () => {
    const other = Buffer.from(bytes);
    const at = other.indexOf(`${version}\0`);
    assert.ok(at > 0);
    other.write('0.0.0', at);
    const versions = `the module is of version 0.0.0, the package of ${version}`;
    await refused(other, `${versions}: take voreleffect.wasm of the package`);
});

/** Runs with a WebAssembly that refuses modules whose binary has one of the bytes of an instruction. */
async function without(opcode, work) {
    const { compile, validate } = WebAssembly;
    WebAssembly.compile = () => Promise.reject(new WebAssembly.CompileError('unknown instruction'));
    WebAssembly.validate = (probe) => !probe.includes(opcode) && validate(probe);
    try {
        await work();
    } finally {
        Object.assign(WebAssembly, { compile, validate });
    }
}

test('Load_SaysWhichPartOfWebAssemblyThereIsNot', async () => {
    const [ofVectors, ofCatching] = [0xfd, 0x19];
    await without(ofVectors, () => refused(bytes, 'WebAssembly has no vectors (simd128) here'));
    await without(ofCatching, () => refused(bytes, 'WebAssembly has no exceptions here'));
});

test('Instances_OfOneModuleLoadAtOnce', async () => {
    const all = await Promise.all(Array.from({ length: 8 }, () => load(MODULE)));
    const keys = all.map((ve) => String(everything(new ve.Look(), 2).key));
    assert.equal(new Set(keys).size, 1);
});

test('Looks_ArePostedToWorkers', async () => {
    const ve = await load();
    const look = everything(new ve.Look(), 4);
    const worker = new Worker(
        `import { parentPort } from 'node:worker_threads';
         import { load } from '${new URL('../dist/index.node.js', import.meta.url)}';
         parentPort.once('message', async ({ module, state, mask }) => {
             const ve = await load(module);
             parentPort.postMessage(ve.Look.from(state).paint(mask).data);
         });`,
        { eval: true, execArgv: ['--input-type=module'] },
    );
    worker.postMessage({ module: MODULE, state: look.state, mask: disc() });
    const [data] = await once(worker, 'message');
    await worker.terminate();
    assert.deepEqual(data, look.paint(disc()).data);
});

test('Face_HasItsNamesAndIsFrozen', async () => {
    const ve = await load();
    assert.deepEqual(Object.keys(ve), ['version', 'Look', 'Painter', 'Picture', 'paint']);
    assert.ok(Object.isFrozen(ve));
    assert.equal(ve.Look.name, 'Look');
    assert.ok(new ve.Look().paint(disc()) instanceof ve.Picture);
    assert.ok(new VorelError('x') instanceof Error);
});
