// The C face of a module of the library, as far as its tests need it.

export const Status = { ok: 0, badArgument: 1, tooLarge: 2, noMemory: 3 };

/** An instance with its memory. What asks for an address gets one as a number from 0 on. */
export class Face {
    constructor(module) {
        this.calls = new WebAssembly.Instance(module, {}).exports;
        this.calls._initialize();
    }
    get bytes() {
        return new Uint8Array(this.calls.memory.buffer);
    }
    word(address) {
        return new DataView(this.calls.memory.buffer).getInt32(address, true);
    }
    /** 0 where there is no memory. */
    allocated(bytes) {
        return this.calls.malloc(bytes) >>> 0;
    }
    /** Words in memory, of whole numbers, and of floats that are given as { float }. */
    words(...values) {
        const at = this.allocated(4 * values.length);
        if (at === 0) throw new Error('no memory for the test itself');
        const view = new DataView(this.calls.memory.buffer);
        values.forEach((value, i) => {
            if (typeof value === 'object') view.setFloat32(at + 4 * i, value.float, true);
            else view.setUint32(at + 4 * i, value >>> 0, true);
        });
        return at;
    }
    copied(bytes) {
        const at = this.allocated(bytes.length);
        this.bytes.set(bytes, at);
        return at;
    }
    /** What a call makes, whose address it writes to its last argument; its status must be ok. */
    made(name, ...given) {
        const out = this.words(0);
        const status = this.calls[name](...given, out);
        if (status !== Status.ok) throw new Error(`${name} gives ${status}`);
        const made = this.word(out) >>> 0;
        this.calls.free(out);
        return made;
    }
    textOf(address) {
        const bytes = this.bytes;
        return new TextDecoder().decode(bytes.slice(address, bytes.indexOf(0, address)));
    }
    keyOf(look) {
        const length = this.words(0);
        this.calls.vorel_look_key(look, 0, 0, length);
        const size = this.word(length);
        const buffer = this.allocated(size);
        this.calls.vorel_look_key(look, buffer, size, length);
        return Buffer.from(this.bytes.slice(buffer, buffer + size)).toString('latin1');
    }
    /** A painted picture: its numbers and its pixels. */
    pictureOf(picture) {
        const part = (name) => this.calls[`vorel_picture_${name}`](picture);
        const data = part('data') >>> 0;
        const [width, height, left, top] = ['width', 'height', 'left', 'top'].map(part);
        return { width, height, left, top, pixels: this.bytes.slice(data, data + 4 * width * height) };
    }
}
