import assert from 'node:assert/strict';
import { readFileSync } from 'node:fs';
import { test } from 'node:test';
import { setImmediate } from 'node:timers/promises';

import {
    FontError,
    load,
    StyleError,
    TextError,
    VorelError,
    VorelMemoryError,
} from 'voreleffect/text';
import { TextEngine } from '../dist/text_engine.js';
import { textFaceOf } from '../dist/voreleffect_text.js';
import { collect, exhausted } from './support.js';

const FONT = readFileSync('/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf');
const MODULE = new WebAssembly.Module(
    readFileSync(new URL('../dist/voreleffect-text.wasm', import.meta.url)),
);
const ve = await load(MODULE);
const { Look, Style, Text } = ve;
const font = new ve.Font(FONT, { name: 'sans' });
const HIGH = { fonts: font, size: 40 };

/** An instance of its own, its engine, and a font in it. */
function fresh() {
    const { exports } = new WebAssembly.Instance(MODULE, {});
    const engine = new TextEngine(exports);
    const face = textFaceOf(engine);
    return { engine, face, exports, font: new face.Font(FONT) };
}

test('Module_ImportsNothing', () => {
    assert.deepEqual(WebAssembly.Module.imports(MODULE), []);
});

test('Font_TellsItsFamilyAndItsName', () => {
    assert.deepEqual([font.family, font.name], ['DejaVu Sans', 'sans']);
});

test('Font_OfOtherBytesIsRefused', () => {
    assert.throws(() => new ve.Font(new Uint8Array(9), { name: 'none' }), {
        name: 'FontError',
        message: "font 'none': the bytes are no font that can be read",
    });
    assert.throws(() => new ve.Font(FONT, { name: 'sans' }), FontError);
    assert.throws(() => new ve.Font('sans.ttf'), TypeError);
    assert.throws(() => new ve.Font(FONT, { index: 7 }), FontError);
    assert.throws(() => new ve.Font(FONT, { index: -1 }), RangeError);
});

test('Font_ThatWasFreedSetsNoTextAndItsNameIsFree', () => {
    const own = new ve.Font(FONT, { name: 'own' });
    Text.picture('a', { ...HIGH, fonts: own });
    own.free();
    own.free();
    assert.throws(() => Text.picture('a', { ...HIGH, fonts: own }), VorelError);
    new ve.Font(FONT, { name: 'own' }).free();
});

test('Font_IsFreedWhereMemoryHasRunOut', () => {
    const { engine, face } = fresh();
    const name = 'a name that is longer than those that need no memory of their own';
    const own = new face.Font(FONT, { name });
    const giveBack = exhausted(engine);
    own.free();
    giveBack();
    assert.equal(new face.Font(FONT, { name }).family, 'DejaVu Sans');
});

test('Font_DoesNotHoldTheBytesThatItIsMadeOf', async () => {
    const { face } = fresh();
    const made = () => {
        const { buffer } = Uint8Array.from(FONT);
        return { own: new face.Font(buffer), buffer: new WeakRef(buffer) };
    };
    const { own, buffer } = made();
    for (let i = 0; i < 50 && buffer.deref() !== undefined; ++i) {
        await setImmediate();
        collect();
    }
    assert.equal(buffer.deref(), undefined);
    own.free();
});

test('Memory_IsSteadyHoweverManyTextsArePainted', () => {
    const { face, exports, font: own } = fresh();
    const work = (i) => {
        const options = { fonts: own, size: 20 + (i % 60), look: face.presets[i % 18] };
        face.Text.picture(`Text ${i}`, options);
        if (i % 40 > 0) return;
        face.Text.layout('Hello', { fonts: own });
        face.Text.layers('Hello', { ...options, look: 'comic' });
        assert.throws(() => face.Text.picture(' ', options), TextError);
        assert.throws(() => face.Style.fromJSON('{"stroke": {"size": 300}}'), StyleError);
        const other = new face.Font(FONT);
        face.Text.picture('Hi', { fonts: other, size: 30 });
        other.free();
    };
    for (let i = 0; i < 1000; ++i) work(i);
    const before = exports.memory.buffer.byteLength;
    for (let i = 1000; i < 3000; ++i) work(i);
    assert.equal(exports.memory.buffer.byteLength, before);
});

test('Picture_IsAsLargeAsItsTextWithEffectsAndPadding', () => {
    const picture = Text.picture('Hi', { ...HIGH, look: new Look().stroke(3, '#fff'), padding: 5 });
    const { ink, margins, width, height } = picture;
    assert.deepEqual(margins, { left: 3, top: 3, right: 3, bottom: 3 });
    assert.deepEqual([ink.left, ink.top], [8, 8]);
    assert.deepEqual([width, height], [ink.right + 8, ink.bottom + 8]);
    assert.equal(picture.data.length, 4 * width * height);
    assert.deepEqual([picture.fonts, picture.missing], [['DejaVu Sans Book'], []]);
});

test('Picture_StandsOnItsBackgroundOrStaysPremultiplied', () => {
    const red = Text.picture('a', { ...HIGH, background: '#f00' });
    assert.deepEqual([...red.data.subarray(0, 4)], [255, 0, 0, 255]);
    const open = Text.picture('a', { ...HIGH, premultiplied: true, color: '#fff' });
    assert.ok(open.premultiplied && !red.premultiplied);
    for (let at = 0; at < open.data.length; at += 4) assert.equal(open.data[at], open.data[at + 3]);
    const both = { ...HIGH, premultiplied: true, background: '#f00' };
    assert.throws(() => Text.picture('a', both), RangeError);
});

test('Picture_OfLooksIsThatOfTheStyleWithTheSameLooks', () => {
    const names = ve.presets.filter((name) => {
        try {
            return Style.preset(name).looks(40).length > 0;
        } catch (error) {
            assert.ok(error instanceof StyleError);
            return false;
        }
    });
    assert.ok(names.length > 10);
    for (const name of names) {
        const whole = Text.picture('Ag', { ...HIGH, look: name });
        const looks = Text.picture('Ag', { ...HIGH, look: Style.preset(name).looks(40) });
        assert.deepEqual(looks.data, whole.data, name);
    }
});

test('Picture_OfMasksOfTheLayoutIsThatOfTheText', () => {
    const look = new Look().fill('#36c').outerShadow('#000').stroke(4, '#fff');
    const picture = Text.picture('Two\nlines', { ...HIGH, look, premultiplied: true, padding: 0 });
    const masks = look.paint(Text.layout('Two\nlines', HIGH).glyphs);
    assert.deepEqual(masks.data, picture.data);
});

test('Layout_TellsLinesWordsAndClusters', () => {
    const { glyphs, lines } = Text.layout('a bc\nd', HIGH);
    assert.deepEqual(
        glyphs.map(({ line, word, cluster }) => [line, word, cluster]),
        [
            [0, 0, 0],
            [0, 1, 2],
            [0, 1, 3],
            [1, 2, 5],
        ],
    );
    assert.equal(lines[0].baseline, 0);
    assert.equal(lines[1].box.top, lines[0].box.bottom);
});

test('Text_WithoutAFontForACharacterTellsIt', () => {
    assert.deepEqual(Text.picture('a\u{10ffff}', HIGH).missing, ['\u{10ffff}']);
    assert.throws(() => Text.picture('a\u{10ffff}', { ...HIGH, strict: true }), TextError);
});

test('Text_ThatCannotBeIsRefused', () => {
    const refused = (options, kind, message, text = 'a') =>
        assert.throws(
            () => Text.picture(text, { ...HIGH, ...options }),
            (error) => error instanceof kind && message.test(error.message),
        );
    refused({ size: 1001 }, RangeError, /^size: 1001 is out of range, 1 to 1000$/);
    refused({ size: '9' }, TypeError, /^size: a number, not a string$/);
    refused({ colour: '#fff' }, TypeError, /no option 'colour'/);
    refused({ letterSpacing: '5em' }, RangeError, /^letterSpacing: /);
    refused({ variations: { weight: 1 } }, RangeError, /'weight' is no axis of four letters/);
    refused({ variations: { wght: 1 } }, FontError, /^font 'sans': /);
    refused({ features: 'a b c' }, TextError, /is no feature/);
    refused({ fit: 'wrap' }, TextError, /^fit: wrap breaks lines at a width/);
    refused({ look: 'golden' }, StyleError, /^no preset 'golden'; there are aurora, /);
    refused({ fonts: [] }, RangeError, /^fonts: /);
    refused({ fonts: 'sans' }, TypeError, /^fonts: a Font, not a string$/);
    refused({ markup: true }, StyleError, /line 1, character 1/, '<c>');
    refused({}, TextError, /no visible character/, ' ');
    refused({}, RangeError, /surrogate/, '\ud800');
    refused({}, RangeError, /^text: longer than 65536 bytes/, 'x'.repeat(65537));
    assert.throws(() => Text.layout('a', { ...HIGH, look: 3 }), TypeError);
});

test('Style_TellsThePathOfWhatIsWrong', () => {
    assert.throws(() => Style.fromJSON('{"stroke": {"size": 300}}', { name: 'mine' }), {
        name: 'StyleError',
        message: /^style 'mine': stroke\.size: 300 is out of range, 0 to 100$/,
    });
    assert.throws(() => Style.fromJSON('{'), StyleError);
});

test('Style_KeepsWhatItWasMadeOf', () => {
    const file = {
        version: 2,
        description: 'Blue',
        color: '#0000FF',
        stroke: { size: '5%', color: '#FFFFFF', position: 'outside' },
    };
    const style = Style.fromJSON(file);
    assert.deepEqual(style.toJSON(), file);
    assert.equal(style.description, 'Blue');
    assert.deepEqual(style.margins(100), { left: 5, top: 5, right: 5, bottom: 5 });
    assert.ok(style.looks(100)[0].equals(new Look().fill('#00f').stroke(5, '#fff')));
    assert.deepEqual(style.key(100), new Look().fill('#00f').stroke(5, '#fff').key);
    assert.match(style.toCpp('blue', 100), /void blue\(VFontEffect::VFEffect&/);
    assert.notEqual(style.toCpp('blue', 100, { color: '#123456' }), style.toCpp('blue', 100));
});

test('Style_IsWrittenAsAFunctionOfANameOfOne', () => {
    const style = Style.preset('comic');
    assert.match(style.toCpp('_a1', 100), /\nvoid _a1\(/);
    for (const name of ['', '1a', 'a b', 'a\n', 'a;b', 'ä']) {
        assert.throws(() => style.toCpp(name, 100), RangeError, name);
    }
});

test('Margins_OfAGlowLeaveOutItsFaintEnd', () => {
    const look = new Look().outerGlow(50, '#0f0');
    const options = { ...HIGH, look, padding: 200, premultiplied: true };
    const { width, data, ink, margins } = Text.picture('a', options);
    const row = Math.floor(data.findIndex((byte) => byte > 0) / 4 / width);
    assert.equal(margins.top, 50);
    assert.ok(ink.top - row > margins.top && ink.top - row <= look.margins.top);
});

test('Key_DoesNotTellThePixelsOfPatterns', () => {
    const of = (red) => {
        const pattern = { width: 1, height: 1, data: Uint8Array.of(red, 0, 0, 255) };
        return Text.picture('a', { ...HIGH, look: new Look().pattern(pattern) });
    };
    assert.notDeepEqual(of(1).data, of(200).data);
    assert.deepEqual(of(1).key, of(200).key);
});

test('Text_InPicturesThatArePngIsNotSeen', () => {
    const emoji = new ve.Font(readFileSync('/usr/share/fonts/truetype/noto/NotoColorEmoji.ttf'));
    assert.throws(() => Text.picture('\u{1f600}', { ...HIGH, fonts: emoji }), TextError);
    emoji.free();
});

test('Text_InColourFontsOfOutlinesIsInTheirColours', () => {
    const file = '/usr/share/fonts/opentype/fonts-hosny-amiri/AmiriQuranColored.ttf';
    const coloured = new ve.Font(readFileSync(file));
    const { data } = Text.picture('بِسْمِ', { ...HIGH, fonts: coloured });
    assert.ok(data.some((byte, i) => i % 4 < 3 && byte > 0));
    coloured.free();
});

test('Style_TakesThePicturesOfItsPatterns', () => {
    const file = { pattern: { image: 'dot.png', scale: 1 } };
    const data = Uint8Array.of(255, 0, 0, 255);
    const style = Style.fromJSON(file, { images: { 'dot.png': { width: 1, height: 1, data } } });
    const [look] = style.looks(40);
    assert.deepEqual([...look.state.effects[0].data], [255, 0, 0, 255]);
    const without = Style.fromJSON(file);
    assert.throws(
        () => Text.picture('a', { ...HIGH, look: without }),
        /'dot\.png' is not among the images/,
    );
});

test('Explain_TellsTheOrderOfPaintingWithTimes', () => {
    const look = new Look().outerShadow('#000').stroke(4, '#fff');
    const { looks, key, keyBytes, margins } = Text.explain('Hi', { ...HIGH, look });
    assert.deepEqual(
        looks[0].order.map(({ effect }) => effect),
        ['text', 'stroke', 'outerShadow'],
    );
    assert.ok(looks[0].order.every(({ milliseconds }) => milliseconds >= 0));
    assert.deepEqual([keyBytes, margins], [look.key, look.margins]);
    assert.equal(key.length, 3);
});

test('Layers_AreOneOfEachEffect', () => {
    const look = new Look().outerShadow('#000').stroke(4, '#fff');
    const picture = Text.picture('Hi', { ...HIGH, look });
    const layers = Text.layers('Hi', { ...HIGH, look });
    assert.deepEqual(
        layers.map(({ effect }) => effect),
        ['outerShadow', 'stroke', 'text'],
    );
    for (const { width, height, data } of layers) {
        assert.deepEqual([width, height], [picture.width, picture.height]);
        assert.ok(data.some((byte) => byte !== 0));
    }
});

test('Memory_ThatRunsOutIsTold', () => {
    const { engine, face, font: own } = fresh();
    const wanted = face.Text.picture('Hello', { fonts: own, size: 90, look: 'comic' });
    const giveBack = exhausted(engine);
    assert.throws(
        () => face.Text.picture('World', { fonts: own, size: 91, look: 'comic' }),
        VorelMemoryError,
    );
    assert.throws(() => new face.Font(FONT), VorelMemoryError);
    assert.throws(() => face.Style.preset('gold'), VorelMemoryError);
    giveBack();
    assert.deepEqual(
        face.Text.picture('Hello', { fonts: own, size: 90, look: 'comic' }).data,
        wanted.data,
    );
});

test('Memory_ThatRunsOutAnywhereEndsNothing', () => {
    const { engine, face, font: own } = fresh();
    const paint = () => face.Text.picture('Hello سلام', { fonts: own, size: 60, look: 'comic' });
    const wanted = paint();
    face.Text.picture('else', { fonts: own, size: 61 });
    const blocks = [];
    for (let size = 2 ** 28; size >= 2 ** 13; size /= 2) {
        for (let at = 1; at !== 0; at = engine.addressBy('malloc', size)) {
            if (at > 1) blocks.push(at);
        }
    }
    const outcomes = { memory: 0, picture: 0 };
    while (outcomes.picture === 0) {
        try {
            assert.deepEqual(paint().data.length, wanted.data.length);
            ++outcomes.picture;
        } catch (error) {
            assert.ok(error instanceof VorelMemoryError, error.message);
            ++outcomes.memory;
        }
        engine.call('free', blocks.pop());
    }
    assert.ok(outcomes.memory > 3, JSON.stringify(outcomes));
    blocks.forEach((at) => engine.call('free', at));
    assert.deepEqual(paint().data, wanted.data);
});

test('Stack_IsUsedToAQuarterAtMost', () => {
    const STACK = 2 ** 20;
    const UNTOUCHED = 0xa5;
    const { engine, face, font: own } = fresh();
    engine.bytes().fill(UNTOUCHED, 0, STACK);
    for (const look of face.presets) face.Text.picture('Ágfi & 12', { fonts: own, look });
    face.Text.picture('many words '.repeat(200), { fonts: own, width: 200, fit: 'wrap', size: 10 });
    const lowest = engine.bytes().findIndex((byte) => byte !== UNTOUCHED);
    assert.ok(STACK - lowest < STACK / 4, `${STACK - lowest} bytes`);
});

/** Numbers below `n` by a rule, the same every time. */
function numbers(seed) {
    let state = seed;
    return (n) => {
        state = (Math.imul(state, 1664525) + 1013904223) >>> 0;
        return Math.floor((state / 2 ** 32) * n);
    };
}

/** Of a font its table directory, the beginning of a table or any of its bytes otherwise, or an end too soon. */
function damaged(bytes, below) {
    const copy = Uint8Array.from(bytes);
    const view = new DataView(copy.buffer);
    const tables = view.getUint16(4);
    const places = [
        () => below(12 + 16 * tables),
        () => (view.getUint32(20 + 16 * below(tables)) % copy.length) + below(200),
        () => below(copy.length),
    ];
    const place = places[below(places.length)];
    for (let count = 1 + below(20); count > 0; --count) {
        copy[Math.min(place(), copy.length - 1)] = below(256);
    }
    return below(5) === 0 ? copy.subarray(0, below(copy.length)) : copy;
}

test('Font_ThatIsDamagedIsRefusedOrPainted', () => {
    const below = numbers(16);
    const counts = { picture: 0, error: 0 };
    const { face } = fresh();
    for (let i = 0; i < 400; ++i) {
        try {
            const broken = new face.Font(damaged(FONT, below));
            face.Text.picture('Office ÁV', { fonts: broken, size: 30 });
            broken.free();
            ++counts.picture;
        } catch (error) {
            assert.ok(error instanceof TextError, error.message);
            ++counts.error;
        }
    }
    assert.ok(counts.picture > 20 && counts.error > 20, JSON.stringify(counts));
});
