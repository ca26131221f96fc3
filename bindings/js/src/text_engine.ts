import { Engine, type Scope } from './engine.js';
import { FontError, StyleError, TextError } from './errors.js';
import type { Wanted } from './load.js';
import type { Box, Margins } from './values.js';

const Status = { style: 16, text: 17, font: 18, request: 19 } as const;

/** What an answer tells, and its bytes. */
export interface Answer<Told> {
    readonly told: Told;
    readonly bytes: Uint8Array<ArrayBuffer>;
}

/** Left, top, right and bottom. */
export type Sides = readonly [number, number, number, number];

/** An instance of the module with text. */
export class TextEngine extends Engine {
    /** The fonts of the instance. */
    readonly fonts: number;

    constructor(exports: Record<string, unknown>) {
        super(exports);
        this.fonts = this.scoped((scope) => scope.made('vorel_fonts_new'));
    }

    /** What a call tells whose last argument is where it writes the address of its answer. */
    answer<Told>(name: string, ...given: number[]): Answer<Told> {
        return this.scoped((scope) => {
            const answer = scope.takes(scope.made(name, ...given), 'vorel_answer_free');
            const text = this.#slice(answer, 'vorel_answer_text', 'vorel_answer_length');
            return {
                told: JSON.parse(new TextDecoder().decode(text)) as Told,
                bytes: this.#slice(answer, 'vorel_answer_data', 'vorel_answer_size'),
            };
        });
    }

    protected override errorOf(status: number): Error {
        if (status < Status.style) return super.errorOf(status);
        const text = this.textAt(this.addressBy('vorel_text_error'));
        if (status === Status.style) return new StyleError(text);
        if (status === Status.font) return new FontError(text);
        return status === Status.request ? new RangeError(text) : new TextError(text);
    }

    #slice(answer: number, data: string, size: string): Uint8Array<ArrayBuffer> {
        const at = this.addressBy(data, answer);
        return this.bytes().slice(at, at + this.addressBy(size, answer));
    }
}

/** What the module with text has. */
export const WITH_TEXT: Wanted<TextEngine> = {
    name: 'voreleffect-text.wasm',
    exports: ['memory', '_initialize', 'malloc', 'free', 'vorel_version', 'vorel_text_picture'],
    engine: TextEngine,
};

/** A request in memory: the two arguments that it is. */
export function requestIn(scope: Scope, request: object): [number, number] {
    const { address, length } = scope.text(JSON.stringify(request));
    return [address, length];
}

/** Four numbers as a box or margins. */
export function sidesOf([left, top, right, bottom]: Sides): Box & Margins {
    return Object.freeze({ left, top, right, bottom });
}

/** Bytes of two hexadecimal digits each. */
export function bytesOfHex(digits: string): Uint8Array<ArrayBuffer> {
    return Uint8Array.from(digits.match(/../g) ?? [], (pair) => parseInt(pair, 16));
}
