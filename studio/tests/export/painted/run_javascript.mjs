// Paints every case of FOLDER/cases.json by its export for JavaScript: run_javascript.mjs FOLDER FONT
//
// Of each case it writes NAME.javascript.rgba, straight.
import { Buffer } from 'node:buffer';
import { readFileSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import process from 'node:process';
import { pathToFileURL } from 'node:url';

const [folder, font] = process.argv.slice(2);

/** By the names of the files that lie beside the export; a style asks for them by its own names. */
function patternsOf(files, patterns) {
    return Object.fromEntries(
        Object.entries(files).map(([image, file]) => {
            const { width, height, data } = patterns[image];
            return [
                file,
                { width, height, data: new Uint8ClampedArray(Buffer.from(data, 'base64')) },
            ];
        }),
    );
}

const cases = JSON.parse(readFileSync(join(folder, 'cases.json'), 'utf8'));
const files = JSON.parse(readFileSync(join(folder, 'patterns.json'), 'utf8'));
const bytes = new Uint8Array(readFileSync(font));
for (const [name, work] of Object.entries(cases)) {
    const { paintTitle } = await import(pathToFileURL(join(folder, name, 'title.mjs')).href);
    const { data } = paintTitle(bytes, patternsOf(files[name], work.patterns));
    writeFileSync(join(folder, `${name}.javascript.rgba`), data);
}
