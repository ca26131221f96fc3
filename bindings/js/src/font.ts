/// <reference lib="esnext.disposable" preserve="true" />
import { disposeByFree, freedError } from './engine.js';
import type { TextEngine } from './text_engine.js';
import { integer, kindOf, options } from './values.js';

/** How a font is known. */
export interface FontOptions {
    /** Under which messages speak of it; no two fonts of an instance have the same. */
    readonly name?: string | undefined;
    /** Which of the file's fonts, 0 the first. */
    readonly index?: number | undefined;
}

/** What constructs fonts of one instance. */
export interface FontClass {
    /**
     * Of the bytes of a file: TrueType, OpenType, a collection of them, or WOFF, but not WOFF2. They are copied.
     * Throws FontError for what is no font and for a name that is taken.
     */
    new (bytes: Uint8Array | ArrayBuffer, options?: FontOptions): Font;
    readonly prototype: Font;
}

const NAMES = ['name', 'index'] as const;

/** Fonts that were collected without having been freed. */
const forgotten = new FinalizationRegistry<() => void>((remove) => remove());

/** A font in the memory of an instance, as long as it is not freed. */
export class Font {
    /** Under which messages speak of it. */
    readonly name: string;
    /** As the font has it, "DejaVu Sans". */
    readonly family: string;
    readonly #engine: TextEngine;
    readonly #remove: () => void;
    #isFreed = false;

    /** @internal */
    constructor(engine: TextEngine, bytes: Uint8Array, name: string, index: number) {
        this.#engine = engine;
        this.name = name;
        this.family = engine.scoped((scope) => {
            const named = scope.text(name).address;
            const at = scope.copy(bytes);
            const given = [engine.fonts, named, at, bytes.length, index];
            return engine.answer<{ family: string }>('vorel_fonts_add', ...given).told.family;
        });
        this.#remove = () => {
            if (engine.isDead) return;
            engine.scoped((scope) =>
                engine.call('vorel_fonts_remove', engine.fonts, scope.text(name).address),
            );
        };
        forgotten.register(this, this.#remove, this);
    }

    /** Gives back its memory; the font cannot be used any more. A second time it does nothing. */
    free(): void {
        if (this.#isFreed) return;
        this.#isFreed = true;
        forgotten.unregister(this);
        this.#remove();
    }

    /** As `free`, for `using`. */
    declare [Symbol.dispose]: () => void;

    static {
        disposeByFree(this);
    }

    /**
     * The name of a font of an instance. Throws TypeError for what is none.
     * @internal
     */
    static nameIn(engine: TextEngine, font: unknown): string {
        if (!(font instanceof Font)) throw new TypeError(`fonts: a Font, not ${kindOf(font)}`);
        if (font.#engine !== engine) throw new TypeError('fonts: a font of another instance');
        if (font.#isFreed) throw freedError('font');
        return font.name;
    }
}

/** The class of the fonts of an instance. */
export function fontClassOf(engine: TextEngine): FontClass {
    let count = 0;
    class FontOfInstance extends Font {
        constructor(bytes: Uint8Array | ArrayBuffer, given: FontOptions = {}) {
            const { name = `font ${++count}`, index = 0 } = options(given, NAMES);
            if (typeof name !== 'string')
                throw new TypeError(`name: a string, not ${kindOf(name)}`);
            if (name.includes('\0')) throw new RangeError('name: has a NUL character');
            super(engine, bytesOf(bytes), name, integer(index, 'index', 0));
        }
    }
    return Object.defineProperty(FontOfInstance, 'name', { value: 'Font' });
}

function bytesOf(given: unknown): Uint8Array {
    if (ArrayBuffer.isView(given)) {
        return new Uint8Array(given.buffer, given.byteOffset, given.byteLength);
    }
    if (Object.prototype.toString.call(given) === '[object ArrayBuffer]') {
        return new Uint8Array(given as ArrayBuffer);
    }
    throw new TypeError(`a font comes from bytes, not ${kindOf(given)}`);
}
