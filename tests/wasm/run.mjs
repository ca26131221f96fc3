// Runs a program of the tests that was compiled for WebAssembly:
//
//     node tests/wasm/run.mjs PROGRAM.wasm [ARGUMENT...]
import { existsSync, readFileSync, readdirSync, statSync } from 'node:fs';

import { run } from './wasi.mjs';

/** Of the machine, read only. The program knows its paths from the root alone. */
const place = (path) => (existsSync(path) ? path : `.${path}`);
const about = (path) => statSync(place(path), { throwIfNoEntry: false });
const files = {
    namesIn: (path) => (about(path)?.isDirectory() ? readdirSync(place(path)) : undefined),
    bytesOf: (path) => (about(path)?.isFile() ? readFileSync(place(path)) : undefined),
};

const [program, ...rest] = process.argv.slice(2);
process.exitCode = run(new WebAssembly.Module(readFileSync(program)), {
    args: [program, ...rest],
    environment: process.env,
    files,
    print: (descriptor, text) => (descriptor === 1 ? process.stdout : process.stderr).write(text),
});
