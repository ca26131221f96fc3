import assert from 'node:assert/strict';
import { test } from 'node:test';
import { setImmediate } from 'node:timers/promises';
import v8 from 'node:v8';
import vm from 'node:vm';

import { load, VorelError, VorelMemoryError } from 'voreleffect';
import { disc, everything, STOPS, TILE } from './scenes.js';
import { block, Counted, exhausted, page } from './support.js';

v8.setFlagsFromString('--expose-gc');
const collect = vm.runInNewContext('gc');

test('Errors_LeaveNothingAllocated', () => {
    const counted = new Counted();
    const look = everything(new counted.ve.Look(), 3);
    const painter = new counted.ve.Painter(look);
    const start = counted.live.sort();
    assert.deepEqual(start, ['look', 'painter']);
    const mask = disc();
    const target = page(9, 9);
    const throwing = {
        get data() {
            throw new Error('of the caller');
        },
    };
    const canvas = (context) => ({ width: 9, height: 9, getContext: () => context });
    for (const fault of [
        () => painter.paint({ ...mask, width: 1e5 }),
        () => painter.paint([{ x: 0, y: 0, mask }, null]),
        () => painter.paint({ x: 0, y: 0, mask: throwing }),
        () => painter.paint(mask, throwing),
        () => painter.paint(mask, { ...target, order: 'x' }),
        () => painter.paint(mask, target, { x: 1e10 }),
        () => painter.paint([0, 2 ** 29].map((x) => ({ x, y: 0, mask }))),
        () => painter.paint(mask, canvas(null)),
        () => painter.paint(mask, canvas({})),
        () => painter.paint(mask, canvas({ getImageData: () => ({}) })),
        () => painter.paint(mask, canvas({ getImageData: () => target })),
        () => new counted.ve.Painter([look, null]),
        () => new counted.ve.Painter(new new Counted().ve.Look()),
        () =>
            counted.ve.paint(
                look,
                [0, 2 ** 29].map((x) => ({ x, y: 0, mask })),
            ),
    ]) {
        assert.throws(fault);
        assert.deepEqual(counted.live.sort(), start);
    }
    painter.paint(mask);
    painter.paint(mask, target);
    counted.ve.paint([look, look], mask);
    assert.ok(look.key.length > 0 && look.margins.left > 0 && look.equals(look));
    assert.deepEqual(counted.live.sort(), start);
    painter.free();
    look.free();
    assert.deepEqual(counted.live, []);
});

test('Arguments_ThatFreeWhatPaintsAreHarmless', () => {
    const { engine, ve } = new Counted();
    const painter = new ve.Painter(new ve.Look());
    const mask = block(4, 4);
    const evil = {
        get mask() {
            painter.free();
            return mask;
        },
        x: 0,
        y: 0,
    };
    assert.throws(() => painter.paint(evil), /this painter was freed/);
    const look = new ve.Look();
    const looks = [look];
    Object.defineProperty(looks, 1, {
        enumerable: true,
        get: () => {
            look.free();
            return new ve.Look();
        },
    });
    assert.throws(() => ve.paint(looks, mask), /this look was freed/);
    assert.equal(engine.isDead, false);
});

test('Memory_GrowsWhileItPaintsAndViewsAreMadeAnew', () => {
    const grown = new Counted();
    const look = (ve) => everything(new ve.Look(), 4);
    const mask = {
        ...block(1500, 700, 0),
        data: Uint8Array.from({ length: 1500 * 700 }, (_, i) => i % 251),
    };
    const target = () => page(1600, 800, [9, 99, 199, 128], { alpha: 'straight' });
    const [first, second] = [target(), target()];
    const before = grown.engine.bytes().length;
    const view = grown.engine.bytes();
    look(grown.ve).paint(mask, first, { x: 50, y: 50 });
    const after = grown.engine.bytes().length;
    assert.ok(after > before && view.length === 0);
    look(grown.ve).paint(mask, second, { x: 50, y: 50 });
    assert.equal(grown.engine.bytes().length, after);
    assert.deepEqual(first.data, second.data);
});

test('Memory_ThatRunsOutIsAnErrorAndTheInstanceGoesOn', () => {
    const { engine, ve } = new Counted();
    const look = everything(new ve.Look(), 4);
    const mask = block(100, 80);
    const target = page(300, 200);
    const expected = look.paint(mask);
    const giveBack = exhausted(engine);
    const outOfMemory = { name: 'VorelMemoryError' };
    assert.throws(() => look.paint(mask), outOfMemory);
    assert.throws(() => look.paint(mask, target), outOfMemory);
    assert.throws(() => new ve.Look().pattern(TILE).key, outOfMemory);
    assert.throws(() => new ve.Painter(look), outOfMemory);
    assert.ok(target.data.every((byte) => byte === 0));
    giveBack();
    assert.deepEqual(look.paint(mask), expected);
    assert.ok(new VorelMemoryError() instanceof VorelError);
});

test('Trap_EndsTheInstanceAndNoOther', async () => {
    const { engine, ve } = new Counted();
    const other = await load();
    const look = new ve.Look().linearGradient(STOPS);
    const painter = new ve.Painter(look);
    assert.throws(() => engine.call('vorel_look_fill', 0xfffffff0, 0, 1), {
        name: 'VorelError',
        message: /has failed and cannot be used any more; load\(\) gives a fresh one/,
    });
    assert.ok(engine.isDead);
    for (const use of [
        () => look.key,
        () => look.paint(block(2, 2)),
        () => painter.paint(block(2, 2)),
        () => new ve.Look().margins,
        () => new ve.Painter([]),
    ]) {
        assert.throws(use, (error) => {
            assert.ok(error instanceof VorelError);
            assert.ok(error.cause instanceof WebAssembly.RuntimeError);
            return true;
        });
    }
    look.free();
    painter.free();
    assert.ok(other.Look.from(new other.Look().linearGradient(STOPS).state).key.length > 0);
});

test('Collected_IsFreed', async () => {
    const counted = new Counted();
    const { ve } = counted;
    (() => {
        for (let i = 0; i < 50; ++i) new ve.Painter(new ve.Look().stroke(i, 0));
    })();
    assert.equal(counted.live.length, 100);
    const kept = new ve.Look();
    assert.ok(kept.key.length > 0);
    for (let i = 0; i < 50 && counted.live.length > 1; ++i) {
        collect();
        await setImmediate();
    }
    assert.deepEqual(counted.live, ['look']);
    assert.ok(kept.key.length > 0);
});

test('Looks_TakeNoMemoryBeforeTheyArePainted', () => {
    const counted = new Counted();
    everything(new counted.ve.Look(), 5).free();
    assert.deepEqual(counted.live, []);
});

test('Instances_AreIndependent', async () => {
    const [a, b] = await Promise.all([load(), load()]);
    const [first, second] = [a, b].map((ve) => new ve.Painter(everything(new ve.Look(), 4)));
    const expected = first.paint(disc());
    first.paint(block(500, 500));
    assert.deepEqual(second.paint(disc()), expected);
    first.free();
    assert.deepEqual(second.paint(disc()), expected);
});
