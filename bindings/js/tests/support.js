// What the tests share.
import { readFileSync } from 'node:fs';

import { Engine } from '../dist/engine.js';
import { faceOf } from '../dist/voreleffect.js';

export const MODULE = new WebAssembly.Module(
    readFileSync(new URL('../dist/voreleffect.wasm', import.meta.url)),
);

/** A mask of full coverage. */
export function block(width, height, coverage = 255) {
    return { width, height, data: new Uint8Array(width * height).fill(coverage) };
}

/** A page in one colour, premultiplied where nothing else is told. */
export function page(width, height, pixel = [0, 0, 0, 0], more = {}) {
    const data = Uint8Array.from({ length: 4 * width * height }, (_, i) => pixel[i % 4]);
    return { width, height, data, ...more };
}

/** An instance whose allocations and things are counted. */
export class Counted {
    #live = new Set();
    constructor() {
        const { exports } = new WebAssembly.Instance(MODULE, {});
        const calls = { ...exports };
        calls.malloc = (bytes) => this.#came('malloc', exports.malloc(bytes));
        calls.free = (address) => this.#went('malloc', address, exports.free);
        for (const thing of ['look', 'painter', 'picture']) {
            const makes = thing === 'picture' ? 'vorel_painter_picture' : `vorel_${thing}_new`;
            const frees = `vorel_${thing}_free`;
            calls[makes] = (...given) => {
                const status = exports[makes](...given);
                const at = given.at(-1) >>> 0;
                const made = new DataView(exports.memory.buffer).getUint32(at, true);
                if (status === 0) this.#came(thing, made);
                return status;
            };
            calls[frees] = (address) => this.#went(thing, address, exports[frees]);
        }
        this.engine = new Engine(calls);
        this.ve = faceOf(this.engine);
    }
    /** What is not freed yet. */
    get live() {
        return [...this.#live].map((each) => each.split(' ')[0]);
    }
    #came(kind, address) {
        if (address !== 0) this.#live.add(`${kind} ${address >>> 0}`);
        return address;
    }
    #went(kind, address, free) {
        if (!this.#live.delete(`${kind} ${address >>> 0}`)) throw new Error(`no ${kind} to free`);
        free(address);
    }
}

/** Takes all memory that an instance can get; returns what gives it back. */
export function exhausted(engine) {
    const blocks = [];
    for (let size = 2 ** 28; size >= 16; size /= 2) {
        for (let at = 1; at !== 0;) {
            at = engine.addressBy('malloc', size);
            if (at !== 0) blocks.push(at);
        }
    }
    return () => blocks.forEach((at) => engine.call('free', at));
}
