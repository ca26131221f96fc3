// Builds the package into dist: the compiled sources, the modules, and the modules in base64.
//
//     node build.mjs [FOLDER_OF_THE_MODULES]
import { spawnSync } from 'node:child_process';
import {
    copyFileSync,
    existsSync,
    readdirSync,
    readFileSync,
    rmSync,
    writeFileSync,
} from 'node:fs';
import { createRequire } from 'node:module';
import { dirname, join } from 'node:path';

import { decode } from 'fast-png';

process.chdir(import.meta.dirname);
const root = '../..';
const folder = process.argv[2] ?? join(root, 'build/wasm32-module/bindings/js/module');

/** A module and the entry of the package that takes it. */
const modules = [
    { name: 'voreleffect', entry: 'index' },
    { name: 'voreleffect-text', entry: 'text' },
];

/** The module as a source file, which engines parse as one string. */
function inlined(file) {
    return `export const base64 = '${readFileSync(file).toString('base64')}';\n`;
}

/** The presets with the pictures of their patterns, as a source file. */
function presetFiles() {
    const folder = join(root, 'style/presets');
    const files = readdirSync(folder).sort();
    const of = (ending) => files.filter((file) => file.endsWith(ending));
    const presets = of('.json').map((file) => [
        file.slice(0, -'.json'.length),
        readFileSync(join(folder, file), 'utf8'),
    ]);
    const patterns = of('.png').map((file) => {
        const { width, height, channels, depth, data } = decode(readFileSync(join(folder, file)));
        if (channels !== 4 || depth !== 8) throw new Error(`${file} is not of R, G, B, A`);
        return [file, { width, height, base64: Buffer.from(data).toString('base64') }];
    });
    const written = (list) => JSON.stringify(Object.fromEntries(list));
    return `export const PRESETS = ${written(presets)};\nexport const PRESET_PATTERNS = ${written(patterns)};\n`;
}

rmSync('dist', { recursive: true, force: true });
const compiler = join(dirname(createRequire(import.meta.url).resolve('typescript')), 'tsc.js');
const { status } = spawnSync(process.execPath, [compiler, '--project', '.'], { stdio: 'inherit' });
if (status !== 0) process.exit(1);
for (const { name } of modules.filter(({ entry }) => existsSync(`src/${entry}.ts`))) {
    const file = join(folder, `${name}.wasm`);
    copyFileSync(file, `dist/${name}.wasm`);
    writeFileSync(`dist/${name.replaceAll('-', '_')}_bytes.js`, inlined(file));
}
writeFileSync('dist/preset_files.js', presetFiles());
copyFileSync(join(root, 'LICENSE'), 'LICENSE');
const notices = ['NOTICE', 'build/wasm_sources/NOTICE'].map((file) =>
    readFileSync(join(root, file)),
);
writeFileSync('NOTICE', Buffer.concat(notices));
