// The sizes of what is shipped, in KB of 1000 bytes, as docs/javascript.md has them; a module that is larger than
// it may be fails.
//
//     node sizes.mjs            compares the table of the page
//     node sizes.mjs --update   writes it
import { existsSync, readFileSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import { brotliCompressSync, constants, gzipSync } from 'node:zlib';

import { buildSync } from 'esbuild';

const page = join(import.meta.dirname, '../../docs/javascript.md');
const dist = join(import.meta.dirname, 'dist');
const heading = '| | raw | gzip | brotli |\n|---|---|---|---|\n';

/** Bytes by brotli that a module may have. */
const parts = [
    { name: 'voreleffect.wasm', entry: 'index.js', most: 60_000 },
    { name: 'voreleffect-text.wasm', entry: 'text.js', most: 500_000 },
].filter(({ name }) => existsSync(join(dist, name)));

function bundled(entry) {
    const options = { bundle: true, minify: true, format: 'esm', write: false };
    return buildSync({ ...options, entryPoints: [join(dist, entry)] }).outputFiles[0].contents;
}

function sizesOf(bytes) {
    const best = { params: { [constants.BROTLI_PARAM_QUALITY]: 11 } };
    const brotli = brotliCompressSync(bytes, best);
    return [bytes.length, gzipSync(bytes, { level: 9 }).length, brotli.length];
}

function row(name, sizes) {
    return `| ${[name, ...sizes.map((size) => Math.round(size / 1000))].join(' | ')} |\n`;
}

let table = heading;
for (const { name, entry, most } of parts) {
    const sizes = sizesOf(readFileSync(join(dist, name)));
    if (sizes[2] > most) throw new Error(`${name}: ${sizes[2]} bytes by brotli, more than ${most}`);
    table += row(`\`${name}\``, sizes);
    table += row(`what calls it, bundled`, sizesOf(bundled(entry)));
}
const text = readFileSync(page, 'utf8');
if (process.argv[2] === '--update') {
    const before = text.indexOf(heading);
    const rows = text.slice(before).match(/^(\|.*\n)+/)[0];
    writeFileSync(page, text.replace(rows, table));
} else if (!text.includes(table)) {
    console.error(
        `docs/javascript.md has other sizes; node bindings/js/sizes.mjs --update writes:\n${table}`,
    );
    process.exit(1);
}
console.log(table);
