import assert from 'node:assert/strict';
import { execFileSync } from 'node:child_process';
import { mkdirSync, readdirSync, readFileSync, rmSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { after, before, test } from 'node:test';
import { fileURLToPath } from 'node:url';

import * as esbuild from 'esbuild';
import { build as viteBuild, createServer } from 'vite';
import { publint } from 'publint';
import { formatMessage } from 'publint/utils';
import webpack from 'webpack';

import { browser, resultOf, served } from './served.js';

const own = fileURLToPath(new URL('..', import.meta.url));
const project = join(own, '../../build/js-consumer');
const expected = {
    version: JSON.parse(readFileSync(join(own, 'package.json'))).version,
    sides: [8, 7, 4, 4],
};

const PROGRAM = `
    const { Look, version } = await load();
    const look = new Look().fill('#3366cc').stroke(2, '#fff');
    const { width, height, data } = look.paint({ data: new Uint8Array(12).fill(255), width: 4, height: 3 });
    globalThis.result = { version, sides: [width, height, look.margins.left + 2, data.length / 56] };
`;
const pageOf = (script) =>
    `<!doctype html><link rel="icon" href="data:," /><script type="module" src="${script}"></script>`;

let running;
let files;

function run(command, ...given) {
    return execFileSync(command, given, { cwd: project, encoding: 'utf8', stdio: 'pipe' });
}

before(async () => {
    rmSync(project, { recursive: true, force: true });
    mkdirSync(project, { recursive: true });
    writeFileSync(join(project, 'package.json'), '{ "type": "module", "private": true }');
    const pack = ['pack', '--json', '--pack-destination', project, own];
    const [packed] = Object.values(JSON.parse(run('npm', ...pack)));
    files = packed.files.map(({ path }) => path);
    run('npm', 'install', '--offline', '--no-audit', '--no-fund', packed.filename);
    writeFileSync(join(project, 'app.js'), `import { load } from 'voreleffect';${PROGRAM}`);
    writeFileSync(
        join(project, 'inline.js'),
        `import { load } from 'voreleffect/inline';${PROGRAM}`,
    );
    writeFileSync(join(project, 'index.html'), pageOf('app.js'));
    running = await browser();
});
after(() => running.close());

/** What a page of a folder tells; all that it asked for is there. */
async function told(folder, page = 'index.html') {
    const site = await served(join(project, folder));
    const { value, complaints } = await resultOf(running, `${site.address}/${page}`);
    site.close();
    assert.deepEqual(complaints, []);
    const names = readdirSync(join(project, folder), { recursive: true });
    for (const path of site.requests) assert.ok(names.includes(path.slice(1)), path);
    return value;
}

test('Tarball_HasTheModuleTheTypesAndTheLicence', () => {
    for (const name of [
        'LICENSE',
        'NOTICE',
        'README.md',
        'package.json',
        'dist/voreleffect.wasm',
        'dist/index.d.ts',
    ]) {
        assert.ok(files.includes(name), name);
    }
    assert.ok(files.every((name) => /^(dist\/[\w.-]+|[A-Z]+(\.md)?|package\.json)$/.test(name)));
});

test('Tarball_IsAsPackagesShouldBe', async () => {
    const { messages, pkg } = await publint({ pkgDir: own, strict: true });
    assert.deepEqual(
        messages.map((message) => formatMessage(message, pkg)),
        [],
    );
});

test('Node_ImportsThePackage', () => {
    for (const name of ['app', 'inline']) {
        const program = `await import('./${name}.js'); console.log(JSON.stringify(result))`;
        const said = run(process.execPath, '--input-type=module', '--eval', program);
        assert.deepEqual(JSON.parse(said), expected);
    }
});

test('TypeScript_ChecksProgramsWithAnyLibraries', () => {
    writeFileSync(join(project, 'typed.ts'), readFileSync(join(own, 'tests/typed_use.ts')));
    const compiler = join(own, 'node_modules/typescript/lib/tsc.js');
    for (const [lib, resolution] of [
        ['es2022', 'nodenext'],
        ['es2022,dom', 'bundler'],
        ['esnext,webworker', 'bundler'],
    ]) {
        const module = resolution === 'bundler' ? 'esnext' : resolution;
        const options = [
            '--strict',
            '--exactOptionalPropertyTypes',
            '--skipLibCheck',
            'false',
            '--noEmit',
        ];
        run(
            process.execPath,
            compiler,
            ...options,
            '--target',
            'es2022',
            '--lib',
            lib,
            '--module',
            module,
            '--moduleResolution',
            resolution,
            'typed.ts',
        );
    }
});

test('Page_TakesThePackageWithoutABundler', async () => {
    writeFileSync(
        join(project, 'plain.html'),
        `<!doctype html><link rel="icon" href="data:," />
        <script type="importmap">{ "imports": { "voreleffect": "./node_modules/voreleffect/dist/index.js" } }</script>
        <script type="module" src="app.js"></script>`,
    );
    assert.deepEqual(await told('.', 'plain.html'), expected);
});

test('Vite_CarriesTheModuleAlong', async () => {
    await viteBuild({
        root: project,
        logLevel: 'error',
        build: { target: 'esnext', outDir: 'vite' },
    });
    assert.deepEqual(await told('vite'), expected);
    const names = readdirSync(join(project, 'vite'), { recursive: true });
    assert.equal(names.filter((name) => name.endsWith('.wasm')).length, 1);
});

test('Vite_ServesTheModuleWhileOneDevelops', async () => {
    const server = { host: '127.0.0.1', port: 0, watch: null, hmr: false };
    const developing = await createServer({ root: project, logLevel: 'error', server });
    await developing.listen();
    const { port } = developing.httpServer.address();
    const { value } = await resultOf(running, `http://127.0.0.1:${port}/index.html`);
    await developing.close();
    assert.deepEqual(value, expected);
});

test('Import_FetchesNothing', async () => {
    writeFileSync(
        join(project, 'import.html'),
        `<!doctype html><link rel="icon" href="data:," /><script type="module">
            import * as voreleffect from './node_modules/voreleffect/dist/index.js';
            globalThis.result = Object.keys(voreleffect);
        </script>`,
    );
    const site = await served(project);
    const { value } = await resultOf(running, `${site.address}/import.html`);
    site.close();
    assert.deepEqual(value, ['VorelError', 'VorelMemoryError', 'VorelSizeError', 'load']);
    assert.ok(!site.requests.some((path) => path.endsWith('.wasm')));
});

test('Webpack_CarriesTheModuleAlong', async () => {
    const compiler = webpack({
        mode: 'production',
        context: project,
        entry: './app.js',
        output: { path: join(project, 'webpack'), publicPath: '' },
    });
    const stats = await new Promise((resolve, reject) =>
        compiler.run((error, done) => (error ? reject(error) : resolve(done))),
    );
    assert.equal(stats.hasErrors() || stats.hasWarnings(), false, stats.toString());
    writeFileSync(join(project, 'webpack/index.html'), pageOf('main.js'));
    assert.deepEqual(await told('webpack'), expected);
});

test('Esbuild_TakesTheModuleWithinOrByAnAddress', async () => {
    const options = { absWorkingDir: project, bundle: true, format: 'esm', outdir: 'esbuild' };
    writeFileSync(
        join(project, 'address.js'),
        `import { load as loadFrom } from 'voreleffect';
        import address from 'voreleffect/voreleffect.wasm';
        const load = () => loadFrom(new URL(address, import.meta.url));${PROGRAM}`,
    );
    for (const name of ['inline', 'address']) {
        await esbuild.build({
            ...options,
            entryPoints: [`${name}.js`],
            loader: { '.wasm': 'file' },
        });
        writeFileSync(join(project, `esbuild/${name}.html`), pageOf(`${name}.js`));
        assert.deepEqual(await told('esbuild', `${name}.html`), expected);
    }
});

test('Bundle_LeavesOutWhatIsNotUsed', async () => {
    const options = {
        absWorkingDir: project,
        bundle: true,
        format: 'esm',
        write: false,
        minify: true,
    };
    const source = `import { load, VorelError } from 'voreleffect'; console.log(VorelError);`;
    const { outputFiles } = await esbuild.build({
        ...options,
        stdin: { contents: source, resolveDir: project },
    });
    assert.ok(outputFiles[0].contents.length < 600, `${outputFiles[0].contents.length} bytes`);
});
