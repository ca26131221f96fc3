import type { Scope } from './engine.js';
import { bytesOf, checkRows, strideOf } from './look_state.js';
import { integer, kindOf, object } from './values.js';

/** Coverage of a glyph, or of a whole line, from any rasteriser. */
export interface Mask {
    /** 0 to 255, top row first. */
    readonly data: Uint8Array | Uint8ClampedArray;
    /** 0 to 65535 pixels; of no width or no height it is skipped. */
    readonly width: number;
    /** 0 to 65535 rows. */
    readonly height: number;
    /** Bytes from row to row, at least the width; packed rows without it. */
    readonly stride?: number | undefined;
}

/** A mask and where it stands: its left and top from the origin of the text. */
export interface Glyph {
    readonly x: number;
    readonly y: number;
    readonly mask: Mask;
}

/** Glyphs, one of them, or one mask with its top left corner at the origin. */
export type Glyphs = Mask | Glyph | readonly Glyph[];

/** A glyph that was checked. */
interface Placed {
    readonly x: number;
    readonly y: number;
    readonly data: Uint8Array | Uint8ClampedArray;
    readonly width: number;
    readonly height: number;
    readonly stride: number;
}

/** Sides with numbers that may lie beyond those of a box. */
export interface Sides {
    readonly left: number;
    readonly top: number;
    readonly right: number;
    readonly bottom: number;
}

const LARGEST_SIDE = 65535;
const WORDS_OF_ONE = 6;

/** Glyphs that were read once, and so are the same whatever their objects become. */
export class PlacedGlyphs {
    readonly #glyphs: readonly Placed[];

    /** Throws TypeError or RangeError for what are no glyphs. */
    constructor(given: Glyphs) {
        const list: readonly unknown[] = Array.isArray(given) ? given : [given];
        this.#glyphs = list.map(placed).filter(({ width, height }) => width > 0 && height > 0);
    }

    get count(): number {
        return this.#glyphs.length;
    }

    /** The box around all of them. */
    get sides(): Sides | undefined {
        if (this.count === 0) return undefined;
        return this.#glyphs.reduce(
            ({ left, top, right, bottom }, { x, y, width, height }) => ({
                left: Math.min(left, x),
                top: Math.min(top, y),
                right: Math.max(right, x + width),
                bottom: Math.max(bottom, y + height),
            }),
            { left: Infinity, top: Infinity, right: -Infinity, bottom: -Infinity },
        );
    }

    /** Copies them into a module's memory, as a list of vorel_glyph; returns its address. */
    copiedTo(scope: Scope): number {
        const areas = this.#glyphs.map(({ width, height }) => width * height);
        const list = scope.allocate(4 * WORDS_OF_ONE * this.count);
        let mask = scope.allocate(areas.reduce((sum, area) => sum + area, 0));
        const bytes = scope.engine.bytes();
        const view = scope.engine.view();
        this.#glyphs.forEach((glyph, i) => {
            const { x, y, width, height } = glyph;
            [x, y, mask, width, height, 0].forEach((word, k) =>
                view.setInt32(list + 4 * (WORDS_OF_ONE * i + k), word, true),
            );
            copyRows(glyph, bytes, mask);
            mask += areas[i]!;
        });
        return list;
    }
}

function copyRows({ data, width, height, stride }: Placed, to: Uint8Array, at: number): void {
    if (stride === width) {
        to.set(data.subarray(0, width * height), at);
        return;
    }
    for (let y = 0; y < height; ++y) {
        to.set(data.subarray(y * stride, y * stride + width), at + y * width);
    }
}

function placed(given: unknown): Placed {
    if (typeof given !== 'object' || given === null) {
        throw new TypeError(`a glyph is { x, y, mask }, not ${kindOf(given)}`);
    }
    if (!('mask' in given)) return { x: 0, y: 0, ...rowsOf(given as Mask) };
    const { x, y, mask } = given as Glyph;
    return { x: integer(x, 'x'), y: integer(y, 'y'), ...rowsOf(mask) };
}

function rowsOf(mask: Mask): Omit<Placed, 'x' | 'y'> {
    const { data: bytes, width: w, height: h, stride: given } = object(mask, 'a mask');
    const width = integer(w, 'width', 0, LARGEST_SIDE);
    const height = integer(h, 'height', 0, LARGEST_SIDE);
    const stride = strideOf(given, width);
    const data = bytesOf(bytes, 'a mask');
    checkRows(data, width, height, stride, 'a mask');
    return { data, width, height, stride };
}
