import type { Scope } from './engine.js';
import { bytesOf, checkRows, strideOf } from './look_state.js';
import { premultiplied, straightened } from './picture.js';
import { integer, kindOf, object, tagOf, type Box } from './values.js';

/** A buffer of pixels of 4 bytes to paint onto. */
export interface Target {
    /** Top row first. */
    readonly data: Uint8Array | Uint8ClampedArray;
    /** Pixels of a row, 0 or more. */
    readonly width: number;
    /** Rows, 0 or more. */
    readonly height: number;
    /** Bytes from row to row, at least 4 * width; packed rows without it. */
    readonly stride?: number | undefined;
    /** How the bytes of a pixel stand in memory; rgba without it. */
    readonly order?: 'rgba' | 'bgra' | undefined;
    /** Whether colours are multiplied with alpha; premultiplied without it. */
    readonly alpha?: 'premultiplied' | 'straight' | undefined;
}

const ORDERS = { rgba: 0, bgra: 1 } as const;
const MOST_BYTES = 2 ** 31 - 1;

/** A part of a target that was copied into a module's memory and is to be copied back. */
export interface Part {
    /** Of the vorel_view. */
    readonly view: number;
    /** Copies what was painted back. */
    readonly finish: () => void;
}

/** A target that was read once and checked. */
export class Rows {
    readonly width: number;
    readonly height: number;
    readonly #data: Uint8Array | Uint8ClampedArray;
    readonly #stride: number;
    readonly #order: keyof typeof ORDERS;
    readonly #isStraight: boolean;

    /** Throws TypeError or RangeError for what is no target. */
    constructor(target: Target) {
        const { data, width, height, stride, order = 'rgba' } = object(target, 'a target');
        const { alpha = tagOf(target) === 'ImageData' ? 'straight' : 'premultiplied' } = target;
        this.width = integer(width, 'width', 0);
        this.height = integer(height, 'height', 0);
        this.#data = bytesOf(data, 'a target');
        this.#stride = strideOf(stride, 4 * this.width);
        checkRows(this.#data, 4 * this.width, this.height, this.#stride, 'a target');
        this.#order = oneOf(order, 'order', ['rgba', 'bgra']);
        this.#isStraight = oneOf(alpha, 'alpha', ['premultiplied', 'straight']) === 'straight';
    }

    /** Copies a box of it, premultiplied, into a module's memory. */
    part(scope: Scope, box: Box): Part {
        const width = box.right - box.left;
        const height = box.bottom - box.top;
        const size = 4 * width * height;
        const address = scope.allocate(size > MOST_BYTES ? Infinity : size);
        const view = scope.words(address, width, height, 0, ORDERS[this.#order]);
        const memory = scope.engine.bytes();
        const before = this.#isStraight ? new Uint8Array(size) : undefined;
        for (let y = 0; y < height; ++y) {
            const row = this.#row(box.left, box.top + y, width);
            memory.set(row, address + 4 * width * y);
        }
        if (before !== undefined) {
            const copy = memory.subarray(address, address + size);
            premultiply(copy);
            before.set(copy);
        }
        const finish = (): void => {
            const painted = scope.engine.bytes().subarray(address, address + size);
            for (let y = 0; y < height; ++y) {
                const row = this.#row(box.left, box.top + y, width);
                const [from, to] = [4 * width * y, 4 * width * (y + 1)];
                if (before === undefined) row.set(painted.subarray(from, to));
                else takeStraight(row, painted.subarray(from, to), before.subarray(from, to));
            }
        };
        return { view, finish };
    }

    #row(x: number, y: number, width: number): Uint8Array | Uint8ClampedArray {
        const at = y * this.#stride + 4 * x;
        return this.#data.subarray(at, at + 4 * width);
    }
}

function oneOf<Name extends string>(value: unknown, what: string, names: readonly Name[]): Name {
    const found = names.find((name) => name === value);
    if (found !== undefined) return found;
    const told = typeof value === 'string' ? `'${value}'` : kindOf(value);
    throw new RangeError(`${what}: ${told} is none of ${names.join(', ')}`);
}

function premultiply(pixels: Uint8Array): void {
    for (let at = 0; at < pixels.length; at += 4) {
        const alpha = pixels[at + 3]!;
        if (alpha === 255) continue;
        for (let i = at; i < at + 3; ++i) pixels[i] = premultiplied(pixels[i]!, alpha);
    }
}

/** Takes the pixels that painting has changed, alpha divided out; the others keep their bytes. */
function takeStraight(
    row: Uint8Array | Uint8ClampedArray,
    painted: Uint8Array,
    before: Uint8Array,
): void {
    for (let at = 0; at < painted.length; at += 4) {
        const alpha = painted[at + 3]!;
        let isChanged = alpha !== before[at + 3];
        for (let i = at; i < at + 3; ++i) isChanged ||= painted[i] !== before[i];
        if (!isChanged) continue;
        for (let i = at; i < at + 3; ++i) row[i] = straightened(painted[i]!, alpha);
        row[at + 3] = alpha;
    }
}
