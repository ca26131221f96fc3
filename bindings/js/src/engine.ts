import { VorelError, VorelMemoryError, VorelSizeError } from './errors.js';

/** An export of a module that is called: addresses and numbers in, one of them out. */
type Call = (...given: number[]) => number;

/** A thing in a module's memory, as it is known when its owner has gone. */
interface Kept {
    readonly address: number;
    readonly freeing: string;
}

const Status = { ok: 0, tooLarge: 2, noMemory: 3 } as const;

/** More than a module can ever hand out: sizes beyond would wrap around in its 32 bits. */
const MOST_BYTES = 0xffff0000;

const DEAD =
    'this instance of voreleffect has failed and cannot be used any more; load() gives a fresh one';

/** Lets `using` free what a class makes; where the platform has no Symbol.dispose, what stands for it there. */
export function disposeByFree({ prototype }: { prototype: { free(): void } }): void {
    const name = (Symbol.dispose as symbol | undefined) ?? Symbol.for('Symbol.dispose');
    const value = function (this: { free(): void }): void {
        this.free();
    };
    Object.defineProperty(prototype, name, { value, writable: true, configurable: true });
}

/**
 * One instance of a module with the face in C: its calls, its memory, and what lives in it.
 *
 * Addresses are numbers from 0 on. A view of the memory is good until the next allocation, which may move it:
 * `bytes()` and `view()` give fresh ones. After a trap the instance is dead, and each call throws VorelError.
 */
export class Engine {
    /** What the library says of itself, as "0.9.0". */
    readonly version: string;

    readonly #calls: Record<string, unknown>;
    readonly #memory: { readonly buffer: ArrayBuffer };
    #failure: { readonly cause: unknown } | undefined;
    readonly #forgotten = new FinalizationRegistry<Kept>((kept) => this.release(kept));

    /** Of the exports of an instance. */
    constructor(exports: Record<string, unknown>) {
        this.#calls = exports;
        this.#memory = exports.memory as { readonly buffer: ArrayBuffer };
        this.call('_initialize');
        this.version = this.textAt(this.call('vorel_version'));
    }

    /** Whether a trap has ended it. */
    get isDead(): boolean {
        return this.#failure !== undefined;
    }

    /** All of the memory; good until the next allocation. */
    bytes(): Uint8Array<ArrayBuffer> {
        return new Uint8Array(this.#memory.buffer);
    }

    /** The same for numbers of several bytes, which lie there little end first. */
    view(): DataView<ArrayBuffer> {
        return new DataView(this.#memory.buffer);
    }

    /** Calls an export. What it throws leaves the instance in a state that nobody knows, so it ends it. */
    call(name: string, ...given: number[]): number {
        if (this.#failure !== undefined) throw new VorelError(DEAD, this.#failure);
        const call = this.#calls[name] as Call;
        try {
            return call(...given);
        } catch (cause) {
            this.#failure = { cause };
            throw new VorelError(DEAD, this.#failure);
        }
    }

    /** An export that gives an address. */
    addressBy(name: string, ...given: number[]): number {
        return this.call(name, ...given) >>> 0;
    }

    /** Calls an export that gives a status, and throws what is not VOREL_OK. */
    check(name: string, ...given: number[]): void {
        const status = this.call(name, ...given);
        if (status !== Status.ok) throw this.errorOf(status);
    }

    /** The text at an address, up to its zero. */
    textAt(address: number): string {
        const bytes = this.bytes();
        return new TextDecoder().decode(bytes.slice(address, bytes.indexOf(0, address)));
    }

    /** Runs `work` with memory that is freed behind it, whatever it throws. */
    scoped<Result>(work: (scope: Scope) => Result): Result {
        const scope = new Scope(this);
        try {
            return work(scope);
        } finally {
            scope.free();
        }
    }

    /**
     * Takes a thing that `freeing`, an export, frees. It is freed with the handle, or when `owner`, who has the
     * handle, is collected. `what` is its name in errors.
     */
    keep(owner: object, what: string, address: number, freeing: string): Handle {
        const kept = { address, freeing };
        const handle = new Handle(this, what, kept, () => this.#forgotten.unregister(kept));
        this.#forgotten.register(owner, kept, kept);
        return handle;
    }

    /** Frees a thing; of a dead instance there is nothing to free. */
    release({ freeing, address }: Kept): void {
        if (!this.isDead) this.call(freeing, address);
    }

    /** What a status other than VOREL_OK is thrown as. */
    protected errorOf(status: number): Error {
        const text = this.textAt(this.addressBy('vorel_status_text', status));
        if (status === Status.noMemory) return new VorelMemoryError(text);
        if (status === Status.tooLarge) return new VorelSizeError(text);
        return new VorelError(text);
    }
}

/** A thing in a module's memory that somebody owns. */
export class Handle {
    #isFreed = false;

    constructor(
        readonly engine: Engine,
        private readonly what: string,
        private readonly kept: Kept,
        private readonly forget: () => void,
    ) {}

    /** Where it lies. Throws VorelError when it was freed. */
    get address(): number {
        if (this.#isFreed) throw freedError(this.what);
        return this.kept.address;
    }

    /** Frees it; a second time it does nothing. */
    free(): void {
        if (this.#isFreed) return;
        this.#isFreed = true;
        this.forget();
        this.engine.release(this.kept);
    }
}

/** The error of what is used after it was freed. */
export function freedError(what: string): VorelError {
    return new VorelError(`this ${what} was freed`);
}

/** Memory that is freed at the end of `Engine.scoped`. */
export class Scope {
    readonly #kept: Kept[] = [];
    readonly #works: (() => void)[] = [];

    constructor(readonly engine: Engine) {}

    /** So many bytes, 0 or more, of any content. Throws VorelMemoryError. */
    allocate(bytes: number): number {
        const address =
            bytes > MOST_BYTES ? 0 : this.engine.addressBy('malloc', Math.max(bytes, 1));
        if (address === 0) throw new VorelMemoryError(`no memory for ${bytes} bytes`);
        return this.takes(address, 'free');
    }

    /** A copy of bytes. */
    copy(bytes: Uint8Array | Uint8ClampedArray): number {
        const address = this.allocate(bytes.length);
        this.engine.bytes().set(bytes, address);
        return address;
    }

    /** Whole numbers of 32 bits, signed or not. */
    words(...values: number[]): number {
        const address = this.allocate(4 * values.length);
        const view = this.engine.view();
        values.forEach((value, i) => view.setInt32(address + 4 * i, value, true));
        return address;
    }

    /** A text in UTF-8 and a zero behind it. Throws RangeError for halves of surrogate pairs. */
    text(text: string): { address: number; length: number } {
        if (/[\uD800-\uDFFF]/u.test(text))
            throw new RangeError('a text with half a surrogate pair');
        const bytes = new TextEncoder().encode(`${text}\0`);
        return { address: this.copy(bytes), length: bytes.length - 1 };
    }

    /** What a call makes: an export whose last argument is where it writes the address of it. */
    made(name: string, ...given: number[]): number {
        const at = this.words(0);
        this.engine.check(name, ...given, at);
        return this.engine.view().getUint32(at, true);
    }

    /** Frees a thing at the end by `freeing`, an export. Returns its address. */
    takes(address: number, freeing: string): number {
        this.#kept.push({ address, freeing });
        return address;
    }

    /** Runs `work` at the end, before anything is freed. */
    runs(work: () => void): void {
        this.#works.push(work);
    }

    /** Frees all, what came last first. */
    free(): void {
        for (const work of this.#works) work();
        for (let kept = this.#kept.pop(); kept !== undefined; kept = this.#kept.pop()) {
            this.engine.release(kept);
        }
    }
}
