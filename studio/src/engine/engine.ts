import type { Answer, Ask, CallName, Calls, Painted } from './messages';
import type { Work } from '../model/work';

/**
 * The page's side of the worker. One question is with the worker at a time: the newest work to be painted goes
 * first, works that a newer one has overtaken are dropped, all else waits in its order.
 */

/** What is told of each painting. */
export interface Listener {
    painted(picture: Painted, work: Work): void;
    /** A work could not be painted; `dead` when the worker had to be started anew. */
    failed(reason: string, dead: boolean): void;
    /** A new worker runs, which knows no fonts of the person's own. */
    restarted(): void;
    /** Whether the worker has been at one question for longer than a person waits without asking why. */
    slow(slow: boolean): void;
}

/** A question was overtaken by one of the same kind, or the worker ended before it answered. */
export class Dropped extends Error {}

interface Waiting {
    ask: Ask;
    transfer: Transferable[];
    done(value: unknown): void;
    fail(error: Error): void;
}

/** Milliseconds after which a worker that does not answer is given up. */
const patience = 30_000;

/** Milliseconds after which it is told that the worker is slow. */
const unasked = 1500;

/** Workers that may end before a picture, until what waits is given up instead of asked again. */
const mostDeaths = 3;

export class Engine {
    private worker: Worker;
    private queue: Waiting[] = [];
    private current: Waiting | undefined;
    private ids = 0;
    /** Workers that ended since the last picture. */
    private deaths = 0;
    private timer: ReturnType<typeof setTimeout> | undefined;
    private hint: ReturnType<typeof setTimeout> | undefined;

    constructor(
        private readonly start: () => Worker,
        private readonly listener: Listener,
    ) {
        this.worker = this.started();
    }

    /** Has the work painted, unless a newer one comes before the worker is free. */
    paint(work: Work): void {
        this.newest('paint', { work }).then(
            (picture) => this.listener.painted(picture, work),
            (error: unknown) => {
                if (error instanceof Dropped) return;
                this.listener.failed((error as Error).message, false);
            },
        );
    }

    /** As `call`, and those of the same kind that still wait are dropped. */
    newest<Name extends CallName>(
        call: Name,
        ask: Calls[Name]['ask'],
    ): Promise<Calls[Name]['answer']> {
        const overtaken = this.queue.filter((waiting) => waiting.ask.call === call);
        this.queue = this.queue.filter((waiting) => waiting.ask.call !== call);
        for (const waiting of overtaken) waiting.fail(new Dropped());
        return this.call(call, ask);
    }

    /** Asks the worker. Rejects with the engine's message, or with Dropped. */
    call<Name extends CallName>(
        call: Name,
        ask: Calls[Name]['ask'],
        transfer: Transferable[] = [],
    ): Promise<Calls[Name]['answer']> {
        return new Promise((done, fail) => {
            const id = ++this.ids;
            this.queue.push({
                ask: { id, call, ...ask } as unknown as Ask,
                transfer,
                done: done,
                fail,
            });
            this.next();
        });
    }

    /** Ends the worker and starts another one; what waits is asked again, what was with the worker fails. */
    restart(reason: string): void {
        this.deaths++;
        this.startAnew(reason);
    }

    /** As `restart`, because a person would not wait: the worker did nothing wrong. */
    stop(): void {
        this.startAnew('Stopped');
    }

    private startAnew(reason: string): void {
        this.worker.terminate();
        this.worker = this.started();
        const lost = this.current;
        this.settle();
        lost?.fail(new Dropped(reason));
        this.listener.failed(reason, true);
        if (this.deaths < mostDeaths) this.listener.restarted();
        else for (const waiting of this.queue.splice(0)) waiting.fail(new Dropped(reason));
        this.next();
    }

    private started(): Worker {
        const worker = this.start();
        worker.onmessage = (event: MessageEvent<Answer>) => this.answered(event.data);
        worker.onerror = (event) => {
            event.preventDefault();
            if (worker !== this.worker) return;
            this.restart(event.message || 'the painting worker stopped');
        };
        return worker;
    }

    private next(): void {
        if (this.current) return;
        const at = Math.max(
            0,
            this.queue.findIndex(
                (waiting) => waiting.ask.call === 'paint' || waiting.ask.call === 'font',
            ),
        );
        const [waiting] = this.queue.splice(at, 1);
        if (!waiting) return;
        this.current = waiting;
        this.timer = setTimeout(
            () => this.restart('painting took too long and was given up'),
            patience,
        );
        this.hint = setTimeout(() => this.listener.slow(true), unasked);
        this.worker.postMessage(waiting.ask, waiting.transfer);
    }

    private settle(): void {
        clearTimeout(this.timer);
        clearTimeout(this.hint);
        this.listener.slow(false);
        this.current = undefined;
    }

    private answered(answer: Answer): void {
        const waiting = this.current;
        if (waiting?.ask.id !== answer.id) return;
        if ('error' in answer && answer.dead) {
            this.restart(answer.error);
            return;
        }
        this.settle();
        if ('error' in answer) waiting.fail(new Error(answer.error));
        else {
            if (waiting.ask.call === 'paint') this.deaths = 0;
            waiting.done(answer.value);
        }
        this.next();
    }
}
