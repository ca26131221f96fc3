/* Copies what lies beside the page: fonts from Debian's packages, and the licences of all that it is made of. */

import { copyFileSync, mkdirSync, readFileSync, writeFileSync } from 'node:fs';

const share = '/usr/share';
const here = new URL('../', import.meta.url);
const into = new URL('public/fonts/', here);

/** Package, file below /usr/share/fonts, name beside the page. */
const fonts = [
    ['fonts-dejavu-core', 'truetype/dejavu/DejaVuSans-Bold.ttf', 'DejaVuSans-Bold.ttf'],
    ['fonts-lobster', 'opentype/lobster/lobster.otf', 'Lobster.otf'],
    ['fonts-bebas-neue', 'opentype/bebas-neue/BebasNeue-Bold.otf', 'BebasNeue-Bold.otf'],
    ['fonts-lohit-deva', 'truetype/lohit-devanagari/Lohit-Devanagari.ttf', 'Lohit-Devanagari.ttf'],
];

mkdirSync(into, { recursive: true });
for (const [name, file, as] of fonts) {
    copyFileSync(`${share}/fonts/${file}`, new URL(as, into));
    copyFileSync(`${share}/doc/${name}/copyright`, new URL(`${name}.txt`, into));
}

/** Title, and the file with its licence from this folder on. */
const parts = [
    ['voreleffect', '../LICENSE'],
    ['What voreleffect has in it', '../NOTICE'],
    ...['preact', '@preact/signals', '@preact/signals-core', 'fast-png', 'fflate', 'iobuffer'].map(
        (name) => [name, `node_modules/${name}/LICENSE`],
    ),
];
const texts = parts.map(
    ([title, file]) => `${title}\n\n${readFileSync(new URL(file, here), 'utf8')}`,
);
writeFileSync(new URL('public/licences.txt', here), texts.join(`\n${'='.repeat(78)}\n\n`));
