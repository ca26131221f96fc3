import assert from 'node:assert/strict';
import { test } from 'node:test';

import { load } from 'voreleffect';
import { disc, everything, noise } from './scenes.js';
import { block, page } from './support.js';

const ve = await load();
const { Look, Painter, paint } = ve;
const rich = everything(new Look().fill('#3060a0'), 5);

test('Picture_IsJustLargeEnoughAndFillsWithTheColour', () => {
    const picture = new Look().fill('#112233').paint(block(3, 2));
    const { width, height, left, top } = picture;
    assert.deepEqual({ width, height, left, top }, { width: 3, height: 2, left: 0, top: 0 });
    const pixel = [0x11, 0x22, 0x33, 255];
    assert.deepEqual([...picture.data], Array.from({ length: 6 }, () => pixel).flat());
    const placed = new Look().stroke(2, 0).paint({ x: -7, y: 30, mask: block(3, 2) });
    assert.deepEqual([placed.left, placed.top, placed.width, placed.height], [-9, 28, 7, 6]);
});

test('Picture_OfNothingIsEmpty', () => {
    for (const glyphs of [[], block(0, 4), { width: 3, height: 0, data: new Uint8Array() }]) {
        const picture = rich.paint(glyphs);
        assert.deepEqual([picture.width, picture.height, picture.data.length], [0, 0, 0]);
    }
    assert.deepEqual(paint([], block(4, 4)).data.length, 0);
});

test('Picture_OutlivesItsLookAndTheNextPaintings', () => {
    const look = new Look();
    const picture = look.paint(disc());
    const before = picture.data.slice();
    look.free();
    rich.paint(block(900, 900));
    assert.deepEqual(picture.data, before);
});

test('Straight_DividesAlphaOutToNearest', () => {
    const picture = new Look().fill('#c08040').paint(noise());
    const straight = picture.straight();
    for (let at = 0; at < straight.length; at += 4) {
        const alpha = picture.data[at + 3];
        for (let c = 0; c < 3; ++c) {
            const value = picture.data[at + c];
            const exact = alpha === 0 ? 0 : Math.min(255, (255 * value) / alpha);
            assert.equal(straight[at + c], Math.floor(exact + 0.5));
        }
        assert.equal(straight[at + 3], alpha);
    }
});

test('ImageData_IsToldOfWhereThereIsNone', () => {
    const picture = rich.paint(block(2, 2));
    assert.throws(() => picture.imageData(), { name: 'VorelError' });
});

test('Target_HasTheBytesOfThePictureWhereItWasClear', () => {
    const mask = disc();
    const picture = rich.paint(mask);
    const target = page(200, 150);
    const box = rich.paint(mask, target, { x: 60, y: 50 });
    const [left, top] = [60 + picture.left, 50 + picture.top];
    assert.deepEqual(box, {
        left,
        top,
        right: left + picture.width,
        bottom: top + picture.height,
    });
    const expected = page(200, 150);
    for (let y = 0; y < picture.height; ++y) {
        const row = picture.data.subarray(4 * y * picture.width, 4 * (y + 1) * picture.width);
        expected.data.set(row, 4 * ((top + y) * 200 + left));
    }
    assert.deepEqual(target.data, expected.data);
});

test('Target_IsClippedAtEachSide', () => {
    const mask = noise();
    const whole = page(200, 200, [200, 100, 50, 255]);
    rich.paint(mask, whole, { x: 80, y: 80 });
    for (const [left, top, width, height] of [
        [85, 90, 10, 10],
        [0, 0, 200, 80],
        [0, 0, 84, 200],
        [100, 0, 100, 200],
        [0, 95, 200, 105],
        [0, 0, 20, 20],
    ]) {
        const window = page(width, height, [200, 100, 50, 255]);
        rich.paint(mask, window, { x: 80 - left, y: 80 - top });
        for (let y = 0; y < height; ++y) {
            const at = 4 * ((top + y) * 200 + left);
            const row = window.data.subarray(4 * y * width, 4 * (y + 1) * width);
            assert.deepEqual(row, whole.data.subarray(at, at + 4 * width));
        }
    }
});

test('Target_FarAwayIsNotTouched', () => {
    const target = page(5, 5, [1, 2, 3, 4]);
    const before = target.data.slice();
    const most = 2 ** 31 - 1;
    for (const x of [most, -most - 1, 1000, -1000]) {
        for (const glyphX of [0, most, -most - 1]) {
            const glyph = { x: glyphX, y: 0, mask: block(3, 3) };
            if (Math.abs(x + glyphX) < 100) continue;
            const box = rich.paint(glyph, target, { x, y: 0 });
            assert.deepEqual(box, { left: 0, top: 0, right: 0, bottom: 0 });
        }
    }
    assert.deepEqual(target.data, before);
    const glyph = { x: most, y: 0, mask: block(3, 3) };
    assert.equal(new Look().paint(glyph, target, { x: -most, y: 0 }).right, 3);
});

test('Target_OfAnyStrideAndOrderHasTheSamePixels', () => {
    const mask = disc();
    const packed = page(70, 60, [10, 20, 30, 255]);
    rich.paint(mask, packed, { x: 20, y: 20 });
    const stride = 4 * 70 + 12;
    const buffer = new Uint8Array(7 + 60 * stride).fill(77);
    const wide = { data: buffer.subarray(7), width: 70, height: 60, stride, order: 'bgra' };
    for (let y = 0; y < 60; ++y) {
        for (let x = 0; x < 70; ++x) wide.data.set([30, 20, 10, 255], y * stride + 4 * x);
    }
    rich.paint(mask, wide, { x: 20, y: 20 });
    for (let y = 0; y < 60; ++y) {
        for (let x = 0; x < 70; ++x) {
            const [b, g, r, a] = wide.data.subarray(y * stride + 4 * x);
            const at = 4 * (70 * y + x);
            assert.deepEqual([r, g, b, a], [...packed.data.subarray(at, at + 4)]);
        }
        assert.ok(wide.data.subarray(y * stride + 280, (y + 1) * stride).every((b) => b === 77));
    }
    assert.ok(buffer.subarray(0, 7).every((byte) => byte === 77));
});

/** The formula of the page, in whole numbers of another spelling. */
function laidOnStraight([r, g, b, a], over) {
    const rounded = (n) => Math.floor(n + 0.5);
    const under = [r, g, b].map((c) => rounded((c * a) / 255)).concat(a);
    const sum = under.map((u, i) => Math.min(255, over[i] + rounded((u * (255 - over[3])) / 255)));
    if (sum.every((value, i) => value === under[i])) return [r, g, b, a];
    const alpha = sum[3];
    const divided = (c) => (alpha === 0 ? 0 : Math.min(255, rounded((255 * c) / alpha)));
    return [...sum.slice(0, 3).map(divided), alpha];
}

test('StraightTarget_FollowsItsFormula', () => {
    const mask = noise();
    const look = new Look().fill('#e08030', 0.7).outerShadow('#204060', { opacity: 0.5 });
    const picture = look.paint(mask);
    const [width, height] = [picture.width + 4, picture.height + 4];
    let state = 1;
    const next = () => (state = (state * 48271) % 2147483647) & 255;
    const alphas = [0, 1, 7, 128, 254, 255];
    for (const order of ['rgba', 'bgra']) {
        const target = page(width, height, [0, 0, 0, 0], { alpha: 'straight', order });
        for (let at = 0; at < target.data.length; at += 4) {
            target.data.set([next(), next(), next(), alphas[next() % 6]], at);
        }
        const before = target.data.slice();
        look.paint(mask, target, { x: 2 - picture.left, y: 2 - picture.top });
        for (let y = 0; y < height; ++y) {
            for (let x = 0; x < width; ++x) {
                const isIn = x >= 2 && y >= 2 && x < width - 2 && y < height - 2;
                const from = 4 * ((y - 2) * picture.width + x - 2);
                const over = isIn ? [...picture.data.subarray(from, from + 4)] : [0, 0, 0, 0];
                if (order === 'bgra') [over[0], over[2]] = [over[2], over[0]];
                const at = 4 * (y * width + x);
                const under = [...before.subarray(at, at + 4)];
                const expected = laidOnStraight(under, over);
                assert.deepEqual([...target.data.subarray(at, at + 4)], expected);
            }
        }
    }
});

test('Stack_IsPaintedTheLastOnTop', () => {
    const stack = [new Look().fill('#f00').stroke(6, '#0f0'), new Look().fill('#00f')];
    const picture = paint(stack, block(20, 20));
    const at = 4 * (16 * picture.width + 16);
    assert.deepEqual([...picture.data.subarray(at, at + 4)], [0, 0, 255, 255]);
    assert.deepEqual(new Painter(stack).margins, stack[0].margins);
});

test('Painter_PaintsTheSameEveryTime', () => {
    const painter = new Painter([rich, new Look().noFill().stroke(3, '#fff')]);
    const first = painter.paint(disc());
    painter.paint(block(300, 200));
    assert.deepEqual(painter.paint(disc()).data, first.data);
    assert.deepEqual(paint([rich, new Look().noFill().stroke(3, '#fff')], disc()).data, first.data);
    painter[Symbol.dispose]();
    painter.free();
    assert.throws(() => painter.paint(disc()), /this painter was freed/);
    assert.throws(() => painter.margins, /this painter was freed/);
});

test('Painter_HasCopiesOfItsLooks', () => {
    const look = new Look().stroke(3, 0);
    const painter = new Painter(look);
    look.free();
    assert.equal(painter.paint(block(2, 2)).width, 8);
});

test('Masks_OfAnyStrideBufferAndKindPaintTheSame', () => {
    const { data, width, height } = disc();
    const expected = rich.paint({ data, width, height }).data;
    const painted = (mask) => rich.paint({ width, height, ...mask }).data;
    const wide = new Uint8Array(5 + height * (width + 9)).fill(99);
    for (let y = 0; y < height; ++y) {
        wide.set(data.subarray(y * width, (y + 1) * width), 5 + y * (width + 9));
    }
    assert.deepEqual(painted({ data: wide.subarray(5), stride: width + 9 }), expected);
    const shared = new Uint8Array(new SharedArrayBuffer(data.length));
    shared.set(data);
    assert.deepEqual(painted({ data: shared }), expected);
    assert.deepEqual(painted({ data: Buffer.from(data) }), expected);
    assert.deepEqual(painted({ data: new Uint8ClampedArray(data) }), expected);
    assert.deepEqual(rich.paint(Object.freeze({ data, width, height })).data, expected);
    const frozen = Object.freeze([Object.freeze({ x: 0, y: 0, mask: { data, width, height } })]);
    assert.deepEqual(rich.paint(frozen).data, expected);
});

test('Masks_ThatAreNoneAreRefused', () => {
    const data = new Uint8Array(12);
    const refused = (error, glyphs) => assert.throws(() => rich.paint(glyphs), error);
    refused(RangeError, { data, width: 4, height: 4 });
    refused(RangeError, { data, width: 4, height: 3, stride: 3 });
    refused(RangeError, { data, width: 4, height: 3, stride: -4 });
    refused(RangeError, { data, width: -4, height: 3 });
    refused(RangeError, { data, width: 65536, height: 0 });
    refused(RangeError, { data, width: 1.5, height: 1 });
    refused(RangeError, { x: 0.5, y: 0, mask: { data, width: 4, height: 3 } });
    refused(RangeError, { x: 2 ** 31, y: 0, mask: { data, width: 4, height: 3 } });
    refused(TypeError, { x: '1', y: 0, mask: { data, width: 4, height: 3 } });
    refused(TypeError, { data: new Int8Array(12), width: 4, height: 3 });
    refused(TypeError, { data: [...data], width: 4, height: 3 });
    refused(TypeError, { data: new DataView(data.buffer), width: 4, height: 3 });
    refused(TypeError, undefined);
    refused(TypeError, [null]);
    refused(TypeError, [[0, 0, { data, width: 4, height: 3 }]]);
    refused(TypeError, { x: 0, y: 0, mask: null });
    const gone = new Uint8Array(12);
    structuredClone(gone.buffer, { transfer: [gone.buffer] });
    refused(RangeError, { data: gone, width: 4, height: 3 });
});

test('Targets_ThatAreNoneAreRefused', () => {
    const refused = (error, target, place) =>
        assert.throws(() => rich.paint(block(2, 2), target, place), error);
    const data = new Uint8Array(100);
    refused(TypeError, null);
    refused(TypeError, 'page');
    refused(TypeError, data);
    refused(RangeError, { data, width: 6, height: 5 });
    refused(RangeError, { data, width: 5, height: 5, stride: -20 });
    refused(RangeError, { data, width: 5, height: 5, stride: 19 });
    refused(RangeError, { data, width: 5, height: -5 });
    refused(RangeError, { data, width: 5, height: 5, order: 'argb' });
    refused(RangeError, { data, width: 5, height: 5, alpha: 'none' });
    refused(TypeError, { data: new Float32Array(100), width: 5, height: 5 });
    refused(RangeError, { data, width: 5, height: 5 }, { x: 0.5 });
    refused(RangeError, { data, width: 5, height: 5 }, { x: NaN });
    refused(TypeError, { data, width: 5, height: 5 }, { x: '1' });
    refused(TypeError, { data, width: 5, height: 5 }, { left: 1 });
    assert.ok(data.every((byte) => byte === 0));
    assert.equal(rich.paint(block(2, 2), { data, width: 0, height: 9 }).right, 0);
});

test('Sizes_BeyondMemoryAreErrorsOfTheirOwn', () => {
    const dots = (x) => [0, x].map((left) => ({ x: left, y: 0, mask: block(1, 1) }));
    const plain = new Look();
    assert.throws(() => plain.paint(dots(2 ** 29)), { name: 'VorelSizeError' });
    const lowest = { x: -(2 ** 31), y: 0, mask: block(1, 1) };
    assert.throws(() => new Look().stroke(9, 0).paint(lowest), { name: 'VorelSizeError' });
    // More than addresses of 32 bits hold, by one mask that stands thrice.
    const large = { data: new Uint8Array(16e8), width: 40000, height: 40000 };
    const thrice = [0, 1, 2].map((x) => ({ x, y: 0, mask: large }));
    assert.throws(() => plain.paint(thrice), { name: 'VorelMemoryError' });
    assert.throws(
        () => plain.paint(block(2, 2), { data: large.data, width: 1, height: 4e8 + 1 }),
        RangeError,
    );
    assert.equal(plain.paint(block(65535, 3)).width, 65535);
    assert.equal(plain.paint(block(1, 1)).width, 1);
});
