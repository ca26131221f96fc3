import { beforeEach, describe, expect, it, vi } from 'vitest';
import { Dropped, Engine, type Listener } from '../../src/engine/engine';
import type { Answer, Ask } from '../../src/engine/messages';
import { firstWork, type Work } from '../../src/model/work';

/** A worker that keeps what it is asked until the test answers. */
class SlowWorker {
    static all: SlowWorker[] = [];
    asked: Ask[] = [];
    ended = false;
    onmessage: ((event: { data: Answer }) => void) | null = null;
    onerror: ((event: { message: string; preventDefault(): void }) => void) | null = null;

    constructor() {
        SlowWorker.all.push(this);
    }
    postMessage(ask: Ask): void {
        this.asked.push(ask);
    }
    terminate(): void {
        this.ended = true;
    }
    answer(value: unknown): void {
        this.onmessage?.({ data: { id: this.asked.at(-1)?.id ?? 0, value } });
    }
    fail(error: string, dead: boolean): void {
        this.onmessage?.({ data: { id: this.asked.at(-1)?.id ?? 0, error, dead } });
    }
}

function sized(size: number): Work {
    return { ...firstWork, size };
}

const settled = () => new Promise((done) => setTimeout(done));

describe('the engine', () => {
    let listener: { [Name in keyof Listener]: ReturnType<typeof vi.fn> };
    let engine: Engine;
    const worker = () => SlowWorker.all.at(-1) as SlowWorker;

    beforeEach(() => {
        SlowWorker.all = [];
        listener = { painted: vi.fn(), failed: vi.fn(), restarted: vi.fn(), slow: vi.fn() };
        engine = new Engine(
            () => new SlowWorker() as unknown as Worker,
            listener as unknown as Listener,
        );
    });

    it('does not mind the end of a worker that it has given up', () => {
        const first = worker();
        first.onerror?.({ message: 'gone', preventDefault: vi.fn() });
        first.onerror?.({ message: 'gone', preventDefault: vi.fn() });
        expect(SlowWorker.all).toHaveLength(2);
        expect(listener.failed.mock.calls).toEqual([['gone', true]]);
    });

    it('paints the newest work and drops those that it overtook', async () => {
        for (const size of [10, 11, 12, 13]) engine.paint(sized(size));
        worker().answer('first');
        await settled();
        worker().answer('last');
        await settled();
        const sizes = worker().asked.map((ask) => (ask as { work: Work }).work.size);
        expect(sizes).toEqual([10, 13]);
        expect(listener.painted.mock.calls.map(([picture]) => picture as unknown)).toEqual([
            'first',
            'last',
        ]);
        expect(listener.failed).not.toHaveBeenCalled();
    });

    it('paints before it tells facts', async () => {
        engine.paint(sized(10));
        const facts = engine.newest('facts', { work: sized(10), measured: true });
        engine.paint(sized(11));
        worker().answer('one');
        await settled();
        expect(worker().asked.at(-1)?.call).toBe('paint');
        worker().answer('two');
        await settled();
        worker().answer('facts');
        expect(await facts).toBe('facts');
    });

    it('tells why a work cannot be painted, and goes on', async () => {
        engine.paint(sized(10));
        worker().fail('too large', false);
        await settled();
        expect(listener.failed).toHaveBeenCalledWith('too large', false);
        engine.paint(sized(11));
        worker().answer('well');
        await settled();
        expect(listener.painted).toHaveBeenCalledTimes(1);
        expect(SlowWorker.all).toHaveLength(1);
    });

    it('starts a new worker when the engine is dead, and asks it what still waits', async () => {
        engine.paint(sized(10));
        engine.paint(sized(11));
        const first = worker();
        first.fail('out of memory', true);
        await settled();
        expect(first.ended).toBe(true);
        expect(listener.failed).toHaveBeenCalledWith('out of memory', true);
        expect(listener.restarted).toHaveBeenCalledTimes(1);
        expect((worker().asked[0] as { work: Work } | undefined)?.work.size).toBe(11);
    });

    it('lets what was with a worker that stopped fail as dropped', async () => {
        const call = engine.call('facts', { work: sized(10), measured: true });
        worker().onerror?.({ message: 'gone', preventDefault: () => undefined });
        await expect(call).rejects.toBeInstanceOf(Dropped);
    });

    it('does not start workers without end', async () => {
        for (let size = 1; size < 20; size++) {
            engine.paint(sized(size));
            worker().fail('cannot begin', true);
            await settled();
        }
        expect(listener.restarted).toHaveBeenCalledTimes(2);
        engine.paint(sized(50));
        worker().answer('well');
        await settled();
        expect(listener.painted).toHaveBeenCalledTimes(1);
    });

    it('says that a picture takes its time, until it is there', async () => {
        vi.useFakeTimers();
        engine.paint(sized(10));
        vi.advanceTimersByTime(1400);
        expect(listener.slow).not.toHaveBeenCalledWith(true);
        vi.advanceTimersByTime(200);
        expect(listener.slow).toHaveBeenLastCalledWith(true);
        worker().answer('well');
        expect(listener.slow).toHaveBeenLastCalledWith(false);
        vi.advanceTimersByTime(2000);
        expect(listener.slow).toHaveBeenLastCalledWith(false);
        vi.useRealTimers();
        await settled();
    });

    it('stops as often as a person likes, and holds the fonts', async () => {
        for (let size = 1; size < 6; size++) {
            engine.paint(sized(size));
            engine.stop();
            await settled();
        }
        expect(listener.restarted).toHaveBeenCalledTimes(5);
        expect(listener.failed).toHaveBeenLastCalledWith('Stopped', true);
    });

    it('gives up a worker that does not answer', () => {
        vi.useFakeTimers();
        engine.paint(sized(10));
        vi.advanceTimersByTime(31_000);
        vi.useRealTimers();
        expect(SlowWorker.all).toHaveLength(2);
    });
});
