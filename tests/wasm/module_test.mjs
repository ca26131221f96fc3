// The modules of the library as they are shipped, each alone in an engine:
//
//     node tests/wasm/module_test.mjs FOLDER_OF_THE_MODULES
import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';

import { Face, Status } from './face.mjs';

const folder = process.argv[2];
const modules = Object.fromEntries(['voreleffect', 'voreleffect-scalar'].map((name) =>
    [name, new WebAssembly.Module(readFileSync(`${folder}/${name}.wasm`))]));

const header = readFileSync(new URL('../../include/voreleffect/voreleffect_c.h', import.meta.url), 'utf8');
const kFunctions = [...header.matchAll(/^VF_API .*?\b(vorel_\w+)\(/gm)].map((found) => found[1]);

const kWidth = 150;
const kHeight = 60;
const kStackBytes = 256 * 1024;

/** Rings and slopes, so that there are edges of every kind. */
function coverage() {
    const bytes = new Uint8Array(kWidth * kHeight);
    for (let y = 0; y < kHeight; ++y)
        for (let x = 0; x < kWidth; ++x)
            bytes[y * kWidth + x] = Math.max(0, Math.min(255, 127 * (1 + 3 * Math.sin(Math.hypot(x - 70, y - 30) / 4))));
    return bytes;
}

/** Every effect at once; `odd` stands for numbers that may be none. */
function everything(face, odd = 0.8) {
    const { calls } = face;
    const look = face.made('vorel_look_new');
    const stops = face.words(0xff0000, { float: odd }, { float: 0 }, 0x00ff80, { float: 1 }, { float: odd });
    const pixels = face.copied(Uint8Array.from({ length: 64 }, (_, i) => (i * 37) & 255));
    const view = face.words(pixels, 4, 4, 0);
    const statuses = [
        calls.vorel_look_outer_shadow(look, 135, 6, 8, 0, odd),
        calls.vorel_look_inner_shadow(look, odd, 4, 5, 0, 0.6),
        calls.vorel_look_outer_glow(look, 16, 0xffc040, 1, stops, 2),
        calls.vorel_look_inner_glow(look, 8, 0xffffff, 0.5, 0, 0),
        calls.vorel_look_linear_gradient(look, 30, 1, 0.5, stops, 2),
        calls.vorel_look_radial_gradient(look, 1, odd, stops, 2),
        calls.vorel_look_stroke(look, 6, 0x102030, 0.9, 0),
        calls.vorel_look_pattern(look, view, 1.5, 0.5),
    ];
    assert.deepEqual(new Set(statuses), new Set([Status.ok]));
    return look;
}

function glyphOf(face, x = 0) {
    return face.words(x, 3, face.copied(coverage()), kWidth, kHeight, 0);
}

function painterOf(face, look) {
    return face.made('vorel_painter_new', face.words(look), 1);
}

function painted(face, look) {
    return face.pictureOf(face.made('vorel_painter_picture', painterOf(face, look), glyphOf(face), 1));
}

function importsNothingAndExportsTheCFace(module) {
    assert.deepEqual(WebAssembly.Module.imports(module), []);
    const names = WebAssembly.Module.exports(module).map((each) => each.name);
    assert.deepEqual(names.sort(), ['_initialize', 'free', 'malloc', 'memory', ...kFunctions].sort());
    const face = new Face(module);
    assert.match(face.textOf(face.calls.vorel_version()), /^\d+\.\d+\.\d+$/);
}

/** What is no number has many spellings, which an engine may change: none of them is seen. */
function numbersThatAreNone_AreOne(module) {
    const spellings = [0x7fc00000, 0xffc00000, 0x7fc00001, 0x7f800001, 0xffffffff];
    const seen = spellings.map((spelling) => {
        const face = new Face(module);
        const look = everything(face);
        const stop = face.words(0xff8040, spelling, spelling, 0x2040ff, { float: 1 }, spelling);
        assert.equal(face.calls.vorel_look_linear_gradient(look, 30, 1, 1, stop, 2), Status.ok);
        return { key: face.keyOf(look), picture: painted(face, look) };
    });
    for (const each of seen) assert.deepEqual(each, seen[0]);
    const face = new Face(module);
    return { key: face.keyOf(everything(face, NaN)), picture: painted(face, everything(face, NaN)), of: seen[0] };
}

/** Takes all memory there is, in blocks; what is given back later is all that is left. */
function exhausted(face) {
    const blocks = [];
    for (let size = 1 << 28; size >= 16; size >>= 1)
        for (let at = face.allocated(size); at !== 0; at = face.allocated(size)) blocks.push({ at, size });
    return blocks;
}

/** Gives back blocks of so many bytes together, the smallest ones. */
function giveBack(face, blocks, bytes) {
    for (let given = 0; given < bytes && blocks.length > 0;) {
        const block = blocks.pop();
        face.calls.free(block.at);
        given += block.size;
    }
}

/** Memory that cannot grow any more: a status says so, whatever is left, and nothing traps. */
function memoryThatRunsOut_IsTold(module) {
    const statuses = new Set();
    const fresh = new Face(module);
    const expected = painted(fresh, everything(fresh));
    for (let left = 0; left < 4e6; left = left * 1.7 + 50) {
        const face = new Face(module);
        const look = everything(face);
        const list = face.words(look);
        const glyph = glyphOf(face);
        const out = face.words(0);
        const pixels = face.allocated(300 * 200 * 4);
        const view = face.words(pixels, 300, 200, 0, 0);
        const blocks = exhausted(face);
        giveBack(face, blocks, left);
        statuses.add(face.calls.vorel_look_copy(look, out));
        statuses.add(face.calls.vorel_look_key(look, 0, 0, out));
        statuses.add(face.calls.vorel_paint(list, 1, glyph, 1, view, 40, 40, 0));
        const made = face.calls.vorel_painter_new(list, 1, out);
        statuses.add(made);
        if (made === Status.ok) statuses.add(face.calls.vorel_painter_picture(face.word(out), glyph, 1, out));
        for (const block of blocks) face.calls.free(block.at);
        assert.deepEqual(painted(face, look), expected);
    }
    assert.deepEqual([...statuses].sort(), [Status.ok, Status.noMemory]);
}

/** Layers and pictures about 2^31 and 2^32 bytes. */
function sizesBeyondMemory_AreRefused(module) {
    const face = new Face(module);
    const { calls } = face;
    const look = face.made('vorel_look_new');
    const painter = painterOf(face, look);
    const dot = face.copied(Uint8Array.of(255));
    const out = face.words(0);
    const across = (columns, rows) => {
        const glyphs = face.words(0, 0, dot, 1, 1, 0, columns - 1, rows - 1, dot, 1, 1, 0);
        return calls.vorel_painter_picture(painter, glyphs, 2, out);
    };
    for (const [columns, rows] of [[2 ** 29 - 1, 1], [1, 2 ** 29 - 1]])
        assert.equal(across(columns, rows), Status.noMemory, `${columns} x ${rows}`);
    for (const [columns, rows] of [[2 ** 29, 1], [2 ** 30, 1], [2 ** 16, 2 ** 16], [2 ** 15, 2 ** 15], [2 ** 31 - 1, 2 ** 31 - 1]])
        assert.equal(across(columns, rows), Status.tooLarge, `${columns} x ${rows}`);
    for (const count of [2 ** 31 - 1, 2 ** 31, 2 ** 32 - 1])
        assert.equal(calls.vorel_painter_picture(painter, dot, count, out), Status.noMemory, `${count} glyphs`);
    for (const bytes of [2 ** 31 - 1, 2 ** 31, 2 ** 32 - 1]) assert.equal(face.allocated(bytes), 0);
}

/** Addresses whose highest bit is set, and buffers that lie across the first of them. */
function addressesBeyondHalfOfMemory_AreAddresses(module, expected) {
    const kHalf = 2 ** 31;
    for (const before of [0, 20e3, 60e3, 150e3]) {
        const face = new Face(module);
        face.allocated(1e9);
        const next = face.allocated(1 << 20) + (1 << 20);
        if (before > 0) face.allocated(kHalf - next - before);
        else while (face.allocated(1e9) < kHalf - 1e9);
        const look = everything(face);
        assert.deepEqual({ key: face.keyOf(look), picture: painted(face, look) }, expected);
        assert.ok(face.bytes.length > kHalf);
    }
}

/** Bytes of the stack that the deepest looks take. */
function stackOf(module) {
    const face = new Face(module);
    const kUntouched = 0xa5;
    face.bytes.fill(kUntouched, 0, kStackBytes);
    const look = everything(face);
    painted(face, look);
    face.calls.vorel_look_stroke(look, 100, 0x102030, 0.9, 0);
    face.calls.vorel_look_outer_shadow(look, 135, 6, 100, 0, 1);
    face.calls.vorel_look_outer_glow(look, 100, 0xffc040, 1, 0, 0);
    face.calls.vorel_look_inner_glow(look, 100, 0xffffff, 0.5, 0, 0);
    face.keyOf(look);
    painted(face, look);
    return kStackBytes - face.bytes.subarray(0, kStackBytes).findIndex((byte) => byte !== kUntouched);
}

const ofNone = [];
for (const [name, module] of Object.entries(modules)) {
    importsNothingAndExportsTheCFace(module);
    ofNone.push(numbersThatAreNone_AreOne(module));
    memoryThatRunsOut_IsTold(module);
    sizesBeyondMemory_AreRefused(module);
    const stack = stackOf(module);
    assert.ok(stack > 1024 && stack < kStackBytes / 4, `${stack} bytes of the stack`);
    console.log(`${name}: no imports, ${kFunctions.length} functions; ${stack} bytes of stack at most`);
}
assert.deepEqual(ofNone[0], ofNone[1]);
const looks = Object.values(modules).map((module) => {
    const face = new Face(module);
    const look = everything(face);
    return { key: face.keyOf(look), picture: painted(face, look) };
});
assert.deepEqual(looks[0], looks[1]);
for (const module of Object.values(modules)) addressesBeyondHalfOfMemory_AreAddresses(module, looks[0]);
assert.ok(looks[0].picture.pixels.some((byte) => byte !== 0));
console.log('both modules paint the same bytes');
