// What a program of the tests, compiled for WebAssembly, asks of its system: arguments, surroundings, a
// clock, text that it prints, and files that it reads. In an engine that knows nothing else; for tests
// alone, the library itself imports nothing.

const kSuccess = 0;
const kBadDescriptor = 8;
const kNoEntry = 44;
const kNotDirectory = 54;
const kFirstDescriptor = 3;
const kDirectory = 3;
const kFile = 4;

/** What proc_exit throws. */
class Exit {
    constructor(code) {
        this.code = code;
    }
}

/**
 * Files are read through `files`: `bytesOf(path)` gives a Uint8Array, `namesIn(path)` the names of a
 * directory, either undefined where there is no such thing.
 */
class System {
    constructor({ args, environment = {}, files, print }) {
        this.args = args.map((text) => new TextEncoder().encode(`${text}\0`));
        this.environment = Object.entries(environment).map(([name, value]) =>
            new TextEncoder().encode(`${name}=${value}\0`));
        this.files = files;
        this.print = print;
        // By descriptor from kFirstDescriptor on; the root is the only directory that is given.
        this.open = [{ path: '', names: [] }];
        this.decoders = [null, new TextDecoder(), new TextDecoder()];
    }

    attach(memory) {
        this.memory = memory;
    }
    get view() {
        return new DataView(this.memory.buffer);
    }
    bytesAt(address, length) {
        return new Uint8Array(this.memory.buffer, address, length);
    }
    textAt(address, length) {
        return new TextDecoder().decode(this.bytesAt(address, length));
    }
    entry(descriptor) {
        return this.open[descriptor - kFirstDescriptor];
    }

    sizesOf(list, countAt, bytesAt) {
        this.view.setUint32(countAt, list.length, true);
        this.view.setUint32(bytesAt, list.reduce((sum, text) => sum + text.length, 0), true);
        return kSuccess;
    }
    copy(list, addressesAt, at) {
        for (const text of list) {
            this.view.setUint32(addressesAt, at, true);
            this.bytesAt(at, text.length).set(text);
            addressesAt += 4;
            at += text.length;
        }
        return kSuccess;
    }

    write(descriptor, vectors, count, writtenAt) {
        if (descriptor !== 1 && descriptor !== 2) return kBadDescriptor;
        let written = 0;
        for (let i = 0; i < count; ++i) {
            const length = this.view.getUint32(vectors + 8 * i + 4, true);
            const bytes = this.bytesAt(this.view.getUint32(vectors + 8 * i, true), length);
            this.print(descriptor, this.decoders[descriptor].decode(bytes, { stream: true }));
            written += length;
        }
        this.view.setUint32(writtenAt, written, true);
        return kSuccess;
    }
    read(descriptor, vectors, count, readAt) {
        const file = this.entry(descriptor);
        if (file?.bytes === undefined) return kBadDescriptor;
        let read = 0;
        for (let i = 0; i < count; ++i) {
            const length = this.view.getUint32(vectors + 8 * i + 4, true);
            const part = file.bytes.subarray(file.at, file.at + length);
            this.bytesAt(this.view.getUint32(vectors + 8 * i, true), part.length).set(part);
            file.at += part.length;
            read += part.length;
        }
        this.view.setUint32(readAt, read, true);
        return kSuccess;
    }
    seek(descriptor, offset, whence, placeAt) {
        const file = this.entry(descriptor);
        if (file?.bytes === undefined) return kBadDescriptor;
        file.at = Number(offset) + [0, file.at, file.bytes.length][whence];
        this.view.setBigUint64(placeAt, BigInt(file.at), true);
        return kSuccess;
    }
    openPath(directory, pathAt, length, wantsDirectory, descriptorAt) {
        if (this.entry(directory)?.names === undefined) return kBadDescriptor;
        const path = `${this.entry(directory).path}/${this.textAt(pathAt, length)}`;
        const names = this.files.namesIn(path);
        const bytes = names === undefined ? this.files.bytesOf(path) : undefined;
        if (names === undefined && bytes === undefined) return kNoEntry;
        if (wantsDirectory && names === undefined) return kNotDirectory;
        this.view.setUint32(descriptorAt, kFirstDescriptor + this.open.length, true);
        this.open.push({ path, names, bytes, at: 0 });
        return kSuccess;
    }
    list(descriptor, buffer, size, cookie, usedAt) {
        const names = this.entry(descriptor)?.names;
        if (names === undefined) return kBadDescriptor;
        let used = 0;
        for (let i = Number(cookie); i < names.length && used < size; ++i) {
            const name = new TextEncoder().encode(names[i]);
            const record = new Uint8Array(24 + name.length);
            const head = new DataView(record.buffer);
            head.setBigUint64(0, BigInt(i + 1), true);
            head.setUint32(16, name.length, true);
            record.set(name, 24);
            const part = record.subarray(0, Math.min(record.length, size - used));
            this.bytesAt(buffer + used, part.length).set(part);
            used += part.length;
        }
        this.view.setUint32(usedAt, used, true);
        return kSuccess;
    }
    state(descriptor, at) {
        const entry = this.entry(descriptor);
        if (descriptor > 2 && entry === undefined) return kBadDescriptor;
        const kCharacterDevice = 2;
        const kind = descriptor <= 2 ? kCharacterDevice : entry.names === undefined ? kFile : kDirectory;
        this.bytesAt(at, 24).fill(0);
        this.view.setUint8(at, kind);
        const kEveryRight = 0xffffffffffffffffn;
        this.view.setBigUint64(at + 8, kEveryRight, true);
        this.view.setBigUint64(at + 16, kEveryRight, true);
        return kSuccess;
    }
    preopened(descriptor, at) {
        if (descriptor !== kFirstDescriptor) return kBadDescriptor;
        this.view.setUint32(at, 0, true);
        this.view.setUint32(at + 4, 1, true);
        return kSuccess;
    }

    imports() {
        return {
            args_sizes_get: (count, bytes) => this.sizesOf(this.args, count, bytes),
            args_get: (addresses, at) => this.copy(this.args, addresses, at),
            environ_sizes_get: (count, bytes) => this.sizesOf(this.environment, count, bytes),
            environ_get: (addresses, at) => this.copy(this.environment, addresses, at),
            clock_time_get: (clock, precision, at) => {
                this.view.setBigUint64(at, BigInt(Math.round(performance.now() * 1e6)), true);
                return kSuccess;
            },
            fd_write: (fd, vectors, count, at) => this.write(fd, vectors, count, at),
            fd_read: (fd, vectors, count, at) => this.read(fd, vectors, count, at),
            fd_seek: (fd, offset, whence, at) => this.seek(fd, offset, whence, at),
            fd_readdir: (fd, buffer, size, cookie, at) => this.list(fd, buffer, size, cookie, at),
            fd_close: () => kSuccess,
            fd_fdstat_get: (fd, at) => this.state(fd, at),
            fd_fdstat_set_flags: () => kSuccess,
            fd_prestat_get: (fd, at) => this.preopened(fd, at),
            fd_prestat_dir_name: (fd, at) => {
                this.bytesAt(at, 1)[0] = '/'.charCodeAt(0);
                return kSuccess;
            },
            path_open: (fd, follow, path, length, flags, rights, inherited, state, at) =>
                this.openPath(fd, path, length, (flags & 2) !== 0, at),
            proc_exit: (code) => {
                throw new Exit(code);
            },
        };
    }
}

/** What a program asks for and nobody needs fails. */
function completed(module, imports) {
    const kNotSupported = 58;
    for (const { name } of WebAssembly.Module.imports(module))
        imports[name] ??= () => kNotSupported;
    return { wasi_snapshot_preview1: imports };
}

/** Runs a program to its end; gives its exit code. */
export function run(module, options) {
    const system = new System(options);
    const instance = new WebAssembly.Instance(module, completed(module, system.imports()));
    system.attach(instance.exports.memory);
    try {
        instance.exports._start();
    } catch (thrown) {
        if (thrown instanceof Exit) return thrown.code;
        throw thrown;
    }
    return 0;
}
