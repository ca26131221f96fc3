import assert from 'node:assert/strict';
import { test } from 'node:test';

import { load } from 'voreleffect';
import { everything, TILE } from './scenes.js';
import { block } from './support.js';

const ve = await load();
const { Look } = ve;

test('Look_IsAValueThatCallsDoNotChange', () => {
    const plain = new Look().fill('#fff');
    const framed = plain.stroke(3, '#102040');
    assert.ok(plain.equals(new Look().fill(0xffffff)));
    assert.ok(!plain.equals(framed));
    assert.deepEqual(framed.margins, { left: 3, top: 3, right: 3, bottom: 3 });
    assert.deepEqual(plain.margins, { left: 0, top: 0, right: 0, bottom: 0 });
    assert.ok(framed instanceof Look);
});

test('Look_OfAKindThatIsThereIsReplacedInItsPlace', () => {
    const look = new Look().stroke(3, '#fff').outerShadow('#000').stroke(5, '#f00');
    assert.deepEqual(
        look.state.effects.map(({ kind, size }) => [kind, size]),
        [
            ['stroke', 5],
            ['outerShadow', 4],
        ],
    );
});

test('Look_StartsWithTheDefaultsOfTheOtherLanguages', () => {
    const given = new Look()
        .fill('#000', 1)
        .outerShadow('#000', { angle: 135, distance: 4, size: 4, opacity: 1 })
        .linearGradient([['#000', 0]], { angle: 0, scale: 1, opacity: 1 })
        .radialGradient([['#000', 0]], { scale: 1, opacity: 1 })
        .stroke(2, '#fff', { position: 'outside', opacity: 1 })
        .pattern(TILE, { scale: 1, opacity: 1 });
    const ramp = [{ color: 0, place: 0 }];
    const left = new Look()
        .outerShadow('#000', {})
        .linearGradient(ramp)
        .radialGradient(ramp, undefined)
        .stroke(2, '#fff')
        .pattern(TILE);
    assert.deepEqual(left.state, given.state);
    assert.deepEqual(left.key, given.key);
});

test('State_IsPlainDataThatMakesTheSameLook', () => {
    const look = everything(new Look().fill('#123456', 0.5), 5)
        .radialGradient([['#fff', 0]])
        .noFill();
    const posted = structuredClone(look.state);
    assert.deepEqual(posted, look.state);
    const same = Look.from(posted);
    assert.deepEqual(same.state, look.state);
    assert.deepEqual(same.key, look.key);
    assert.ok(same instanceof Look);
    assert.ok(Look.from(JSON.parse(JSON.stringify(new Look().state))).equals(new Look()));
});

test('State_IsACopyWhosePixelsAreNotTheLooks', () => {
    const look = new Look().pattern(TILE);
    const key = look.key;
    look.state.effects[0].data.fill(0);
    assert.deepEqual(new Look().pattern(TILE).key, key);
    assert.deepEqual(look.state.effects[0].data, TILE.data);
});

test('From_RefusesWhatIsNoState', () => {
    const { state } = new Look().stroke(3, '#fff');
    const [stroke] = state.effects;
    const refused = (error, change) => assert.throws(() => Look.from(change), error);
    refused(TypeError, undefined);
    refused(TypeError, {});
    refused(TypeError, { ...state, isFilled: 1 });
    refused(TypeError, { ...state, effects: {} });
    refused(TypeError, { ...state, effects: [{ kind: 'bevel' }] });
    refused(TypeError, { ...state, effects: [null] });
    refused(RangeError, { ...state, effects: [{ ...stroke, size: NaN }] });
    refused(RangeError, { ...state, fill: 0x1000000 });
    const twice = Look.from({ ...state, effects: [stroke, { ...stroke, size: 9 }] });
    assert.deepEqual(twice.margins.left, 9);
});

test('Pattern_CopiesPixelsAndTakesRows', () => {
    const wide = { data: new Uint8ClampedArray(16 * 24), width: 4, height: 4, stride: 24 };
    for (let y = 0; y < 4; ++y) wide.data.set(TILE.data.subarray(16 * y, 16 * y + 16), 24 * y);
    const look = new Look().pattern(wide);
    wide.data.fill(9);
    assert.ok(look.equals(new Look().pattern(TILE)));
});

test('ToString_HasTheCallsThatMakeTheLook', () => {
    const look = new Look()
        .fill('#36c', 0.5)
        .textOpacity(0.25)
        .outerShadow('#000', { opacity: 0.6 })
        .innerGlow(3, '#fff', { stops: [['#f00', 0, 0.5]] })
        .outerGlow(2, '#fff')
        .linearGradient([[0, 1]])
        .radialGradient([[0, 1]], { scale: 2 })
        .stroke(4, '#fff', { position: 'center', opacity: 0.5 });
    // The text is a program.
    assert.deepEqual(new Function('Look', `return ${look}`)(Look).state, look.state);
    assert.equal(
        String(new Look().noFill().pattern(TILE)),
        'new Look().noFill().pattern(<4 x 4 pixels>, { scale: 1 })',
    );
});

test('Colours_AreCheckedAsInTheOtherLanguages', () => {
    const key = (color) => new Look().fill(color).key;
    assert.deepEqual(key('#3af'), key(0x33aaff));
    assert.deepEqual(key('#33AAFF'), key(0x33aaff));
    for (const color of ['red', '', '#12', '#12345g', '#ffff', '#fff\n', -1, 0x1000000, 0.5, NaN]) {
        assert.throws(() => new Look().fill(color), RangeError);
    }
    for (const color of [undefined, null, {}, [1, 2, 3], true, 1n, Symbol('red')]) {
        assert.throws(() => new Look().fill(color), TypeError);
    }
});

test('Numbers_OutOfRangeAreBroughtIntoItAndThoseThatAreNoneRefused', () => {
    assert.ok(new Look().stroke(1e6, 0).equals(new Look().stroke(100, 0)));
    assert.ok(new Look().fill(0, 7).equals(new Look()));
    for (const size of [NaN, Infinity, -Infinity, 1e300]) {
        assert.throws(() => new Look().stroke(size, 0), RangeError);
        assert.throws(() => new Look().outerShadow(0, { angle: size }), RangeError);
        assert.throws(() => new Look().textOpacity(size), RangeError);
    }
    for (const size of [undefined, null, '4', [4], { valueOf: () => 4 }, 4n]) {
        assert.throws(() => new Look().stroke(size, 0), TypeError);
    }
});

test('Stops_AreOneTo256', () => {
    const ramp = (count) => Array.from({ length: count }, (_, i) => [i, i / count]);
    new Look().linearGradient(ramp(256));
    assert.throws(() => new Look().linearGradient(ramp(257)), /a ramp has 1 to 256 stops, not 257/);
    assert.throws(() => new Look().radialGradient([]), RangeError);
    assert.throws(() => new Look().outerGlow(3, 0, { stops: [] }), RangeError);
    for (const stops of ['#fff', null, {}, [1], [[0]], [[0, 0, 0, 0]], [null], [{ color: 0 }]]) {
        assert.throws(() => new Look().linearGradient(stops), TypeError);
    }
});

test('Options_OfAnotherNameAreRefused', () => {
    assert.throws(() => new Look().stroke(2, 0, { widht: 2 }), /there is no option 'widht'/);
    assert.throws(() => new Look().stroke(2, 0, 'inside'), TypeError);
    assert.throws(() => new Look().stroke(2, 0, null), TypeError);
    assert.throws(() => new Look().stroke(2, 0, { position: 'above' }), {
        name: 'RangeError',
        message: "position: 'above' is none of outside, inside, centre",
    });
});

test('Pattern_WithoutItsPixelsIsRefused', () => {
    const data = new Uint8Array(64);
    const refused = (error, pixels) => assert.throws(() => new Look().pattern(pixels), error);
    refused(RangeError, { data, width: 5, height: 4 });
    refused(RangeError, { data, width: 0, height: 4 });
    refused(RangeError, { data, width: 4, height: 4, stride: 15 });
    refused(RangeError, { data, width: 4, height: 4, stride: -16 });
    refused(RangeError, { data, width: 2 ** 20, height: 2 ** 20 });
    refused(TypeError, { data: new Uint16Array(64), width: 4, height: 4 });
    refused(TypeError, { data: [], width: 4, height: 4 });
    refused(TypeError, null);
});

test('Freed_CannotBeUsed', () => {
    const look = new Look().stroke(3, 0);
    const thicker = look.stroke(4, 0);
    assert.equal(look.margins.left, 3);
    look.free();
    look.free();
    const freed = { name: 'VorelError', message: 'this look was freed' };
    for (const use of [
        () => look.margins,
        () => look.key,
        () => look.state,
        () => look.fill(0),
        () => look.stroke(3, 0),
        () => look.equals(thicker),
        () => thicker.equals(look),
        () => String(look),
        () => look.paint(block(2, 2)),
        () => ve.paint([thicker, look], block(2, 2)),
        () => new ve.Painter(look),
    ]) {
        assert.throws(use, freed);
    }
    assert.equal(thicker.margins.left, 4);
    thicker[Symbol.dispose]();
    assert.throws(() => thicker.key, freed);
});

test('Look_OfAnotherInstanceIsTakenByItsState', async () => {
    const other = await load();
    const look = new Look().stroke(3, 0);
    assert.throws(() => new other.Painter(look), /a look of another instance/);
    assert.ok(other.Look.from(look.state).equals(look));
    assert.ok(!(look instanceof other.Look));
});
