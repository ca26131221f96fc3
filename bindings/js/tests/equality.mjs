// The pictures of the module with text beside those of vorelpaint, byte for byte: all presets in three scripts, and
// what else can be asked of a text.
//
//     node tests/equality.mjs VORELPAINT
import assert from 'node:assert/strict';
import { execFileSync } from 'node:child_process';
import { mkdtempSync, readFileSync, rmSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { join } from 'node:path';

import { decode } from 'fast-png';

import { load } from '../dist/text.node.js';

const FONTS = {
    latin: '/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf',
    arabic: '/usr/share/fonts/opentype/fonts-hosny-amiri/Amiri-Regular.ttf',
    devanagari: '/usr/share/fonts/truetype/lohit-devanagari/Lohit-Devanagari.ttf',
    variable: '/usr/share/fonts/truetype/inter-vf/Inter.var.ttf',
    cff: '/usr/share/fonts/opentype/bebas-neue/BebasNeue-Bold.otf',
};

const TEXTS = {
    latin: 'Office, AVA & fjord',
    arabic: 'السلام عليكم ١٢٣',
    devanagari: 'क्षत्रिय किताब द्वार',
};

const SENTENCE = 'The quick brown fox – “well-known” – jumps, e.g. over 1,000 lazy dogs.';
const MIXED = 'Hello سلام and क्षि (123)';
const ALL = ['latin', 'arabic', 'devanagari'];

/** What is asked of a text beside its presets: the text, its fonts and options. */
const VARIATIONS = [
    [SENTENCE, ['latin'], { width: 300, fit: 'wrap', align: 'center' }],
    [SENTENCE, ['latin'], { width: 300, fit: 'wrap', align: 'end', lineHeight: 1.3, box: 'line' }],
    [SENTENCE, ['latin'], { width: 320, height: 90, fit: 'shrink', anchor: 'bottom-right' }],
    [SENTENCE, ['cff'], { width: 300, fit: 'wrap', margin: 12, background: 'checkerboard' }],
    [`${TEXTS.arabic}\n${TEXTS.arabic}`, ['arabic'], { align: 'start', width: 500 }],
    [MIXED, ALL, { look: 'sticker' }],
    [MIXED, ALL, { look: 'comic', width: 150, fit: 'wrap' }],
    ['AVA To', ['latin'], { letterSpacing: 5 }],
    ['AVA To', ['latin'], { letterSpacing: '-4%', look: 'neon' }],
    ['office', ['latin'], { features: ['liga=0', '-kern'] }],
    [
        'a <c #f00>red</c> &lt;b&gt; <c #00FF80>green</c>',
        ['latin'],
        { markup: true, look: 'candy' },
    ],
    ['Weight', ['variable'], { variations: { wght: 900 }, look: 'outline' }],
    ['Weight', ['variable'], { variations: { wght: 250 }, size: 31 }],
    ['Amount', ['cff'], { color: '#123456', opacity: 0.5, effectScale: 2.5, look: 'gold' }],
    ['Tiny', ['latin'], { size: 7, look: 'sticker', padding: 0 }],
    ['Huge', ['cff'], { size: 400, look: 'chrome' }],
    ['e\u0301 ﬁ \u200dx\u00adyz ½', ['latin'], { background: '#336699' }],
    ['tab\tand\u2028line', ['latin'], { box: 'line' }],
];

/** As a job of vorelpaint has it. */
function jobOf([text, fonts, { look, features, variations, ...options }], output) {
    const more = Object.entries(options).map(([name, value]) => [
        name.replace(/[A-Z]/g, (letter) => `-${letter.toLowerCase()}`),
        value,
    ]);
    const listed = (given) => Object.entries(given).map(([axis, value]) => `${axis}=${value}`);
    return {
        text,
        output,
        font: fonts.map((font) => FONTS[font]),
        ...(look === undefined ? {} : { preset: look }),
        ...(features === undefined ? {} : { 'font-features': features.join() }),
        ...(variations === undefined ? {} : { 'font-variations': listed(variations).join() }),
        ...Object.fromEntries(more),
    };
}

/** Which of the values of a pixel are its R, G, B and A, by how many there are; 255 where there is none. */
const CHANNELS = { 1: [0, 0, 0], 2: [0, 0, 0, 1], 3: [0, 1, 2], 4: [0, 1, 2, 3] };

/** The straight R, G, B, A of a PNG file, which has a palette or as few channels as will do. */
function pixelsOf(file) {
    const { width, height, data, channels, palette } = decode(readFileSync(file));
    const pixels = new Uint8Array(4 * width * height).fill(255);
    for (let at = 0; at < width * height; ++at) {
        const pixel = palette ? palette[data[at]] : data.subarray(channels * at);
        const places = palette ? CHANNELS[pixel.length] : CHANNELS[channels];
        places.forEach((place, i) => (pixels[4 * at + i] = pixel[place]));
    }
    return { width, height, data: pixels };
}

/** The place of the first byte that differs, or undefined. */
function firstDifference(a, b) {
    const at = a.findIndex((byte, i) => byte !== b[i]);
    return at < 0 ? undefined : at;
}

const ve = await load();
const fonts = Object.fromEntries(
    Object.entries(FONTS).map(([name, file]) => [name, new ve.Font(readFileSync(file), { name })]),
);
const presets = ve.presets.flatMap((look) =>
    ALL.map((script) => [TEXTS[script], [script], { look, size: 56 }]),
);
const cases = [...presets, ...VARIATIONS];

const folder = mkdtempSync(join(tmpdir(), 'equality-'));
try {
    const outputs = cases.map((_, i) => join(folder, `${i}.png`));
    const jobs = cases.map((each, i) => JSON.stringify(jobOf(each, outputs[i])));
    const started = performance.now();
    execFileSync(process.argv[2], ['--batch', '-', '--png', 'fast'], { input: jobs.join('\n') });
    const native = performance.now() - started;
    let painting = 0;
    cases.forEach(([text, names, options], i) => {
        const start = performance.now();
        const picture = ve.Text.picture(text, {
            fonts: names.map((name) => fonts[name]),
            ...options,
        });
        painting += performance.now() - start;
        const { width, height, data } = pixelsOf(outputs[i]);
        const what = `${names.join()} ${JSON.stringify(options)} ${text}`;
        assert.deepEqual([picture.width, picture.height], [width, height], what);
        assert.equal(firstDifference(picture.data, data), undefined, what);
        assert.deepEqual(picture.missing, [], what);
    });
    const seconds = (time) => `${(time / 1000).toFixed(1)} s`;
    console.log(
        `${cases.length} pictures are those of vorelpaint (${seconds(painting)}, there ${seconds(native)})`,
    );
} finally {
    rmSync(folder, { recursive: true });
}
