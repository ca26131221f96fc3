import { Engine } from './engine.js';
import { VorelError } from './errors.js';
import { kindOf, tagOf } from './values.js';
import { VERSION } from './version.js';

/** The platform's WebAssembly.Module; where its types are not known, nothing. */
export type CompiledModule = typeof globalThis extends {
    WebAssembly: { Module: { prototype: infer Kind } };
}
    ? Kind
    : never;

/** An answer of `fetch`, as far as it is read. */
export interface ResponseLike {
    readonly ok: boolean;
    readonly status: number;
    readonly url: string;
    readonly headers: { get(name: string): string | null };
    arrayBuffer(): Promise<ArrayBuffer>;
}

/** Where a module comes from: an address, an answer of `fetch`, its bytes, or the compiled module. */
export type WasmSource =
    | string
    | { readonly href: string }
    | ResponseLike
    | Promise<ResponseLike>
    | ArrayBuffer
    | ArrayBufferView
    | CompiledModule;

/** What gets the bytes of an address. */
export type Fetch = (address: string) => Promise<ResponseLike | Uint8Array<ArrayBuffer>>;

/** What of a module is asked for. */
export interface Wanted<Kind extends Engine = Engine> {
    /** Of the file, for errors. */
    readonly name: string;
    /** Exports, one of each part. */
    readonly exports: readonly string[];
    /** Makes the engine of an instance. */
    readonly engine: new (exports: Record<string, unknown>) => Kind;
}

/** What the library's own module has. */
export const LIBRARY: Wanted = {
    name: 'voreleffect.wasm',
    exports: ['memory', '_initialize', 'malloc', 'free', 'vorel_version', 'vorel_painter_picture'],
    engine: Engine,
};

/** The smallest modules with an instruction of vectors, and one that catches. */
const WITH_VECTORS = 'AGFzbQEAAAABBQFgAAF7AwIBAAoKAQgAQQD9D/1iCw==';
const WITH_EXCEPTIONS = 'AGFzbQEAAAABBAFgAAADAgEACggBBgAGQBkLCw==';

const MAGIC = [0x00, 0x61, 0x73, 0x6d];

/** Bytes from base64. */
export function bytesFrom(base64: string): Uint8Array<ArrayBuffer> {
    return Uint8Array.from(atob(base64), (letter) => letter.charCodeAt(0));
}

/**
 * A fresh instance. Throws TypeError for what is no source, VorelError for what is no module of this version, and
 * where the platform has not what it takes.
 */
export async function engineOf<Kind extends Engine>(
    source: WasmSource,
    fetch: Fetch,
    wanted: Wanted<Kind>,
): Promise<Kind> {
    const module = await moduleOf(source, fetch);
    const names = new Set(WebAssembly.Module.exports(module).map(({ name }) => name));
    const missing = wanted.exports.find((name) => !names.has(name));
    if (missing !== undefined || WebAssembly.Module.imports(module).length > 0) {
        const reason = missing === undefined ? 'it imports' : `it has no ${missing}`;
        throw new VorelError(`this module is not ${wanted.name}: ${reason}`);
    }
    const { exports } = await WebAssembly.instantiate(module, {});
    const engine = new wanted.engine(exports);
    if (engine.version !== VERSION) {
        const versions = `the module is of version ${engine.version}, the package of ${VERSION}`;
        throw new VorelError(`${versions}: take ${wanted.name} of the package`);
    }
    return engine;
}

async function moduleOf(given: WasmSource, fetch: Fetch): Promise<WebAssembly.Module> {
    const source = await given;
    if (tagOf(source) === 'WebAssembly.Module') return source as WebAssembly.Module;
    if (ArrayBuffer.isView(source)) return compiled(source);
    if (tagOf(source) === 'ArrayBuffer') return compiled(new Uint8Array(source as ArrayBuffer));
    if (isResponse(source)) return compiledAnswer(source);
    const address = addressOf(source);
    const answer = await fetch(address);
    return answer instanceof Uint8Array ? compiled(answer) : compiledAnswer(answer);
}

function addressOf(source: unknown): string {
    if (typeof source === 'string') return source;
    const href = typeof source === 'object' && source !== null && 'href' in source && source.href;
    if (typeof href === 'string') return href;
    throw new TypeError(
        `a module comes from an address, a Response or bytes, not ${kindOf(source)}`,
    );
}

function isResponse(source: unknown): source is ResponseLike {
    return typeof source === 'object' && source !== null && 'arrayBuffer' in source;
}

/** While it is still coming where the server names its kind, which compiling meanwhile asks for. */
async function compiledAnswer(answer: ResponseLike): Promise<WebAssembly.Module> {
    if (!answer.ok) throw new VorelError(`no module: ${answer.status} for ${answer.url}`);
    const isTold = answer.headers.get('Content-Type') === 'application/wasm';
    if (isTold && answer instanceof Response && 'compileStreaming' in WebAssembly) {
        return refused(() => WebAssembly.compileStreaming(answer));
    }
    return compiled(new Uint8Array(await answer.arrayBuffer()));
}

async function compiled(view: ArrayBufferView): Promise<WebAssembly.Module> {
    // A copy: memory that is shared is not compiled.
    const bytes = Uint8Array.from(new Uint8Array(view.buffer, view.byteOffset, view.byteLength));
    if (MAGIC.some((byte, i) => bytes[i] !== byte)) {
        const start = new TextDecoder('latin1').decode(bytes.subarray(0, 9));
        throw new VorelError(`no module: it begins with ${JSON.stringify(start)}`);
    }
    return refused(() => WebAssembly.compile(bytes));
}

/** Says why a module was not compiled. */
async function refused(compile: () => Promise<WebAssembly.Module>): Promise<WebAssembly.Module> {
    try {
        return await compile();
    } catch (cause) {
        if (!(cause instanceof WebAssembly.CompileError)) throw cause;
        throw new VorelError(reasonOf(cause), { cause });
    }
}

function reasonOf(cause: WebAssembly.CompileError): string {
    const has = (probe: string): boolean => WebAssembly.validate(bytesFrom(probe));
    try {
        if (!has(WITH_VECTORS)) return 'WebAssembly has no vectors (simd128) here';
        if (!has(WITH_EXCEPTIONS)) return 'WebAssembly has no exceptions here';
    } catch {
        return cause.message;
    }
    return `no module that can be compiled here: ${cause.message}`;
}
