import { fetchModule } from './fetch.js';
import { engineOf, LIBRARY, type WasmSource } from './load.js';
import { faceOf, type Voreleffect } from './voreleffect.js';

export * from './exports.js';

/** A fresh instance of the library: of the module beside this file where there is no source. */
export async function load(
    source: WasmSource = new URL('./voreleffect.wasm', import.meta.url),
): Promise<Voreleffect> {
    return faceOf(await engineOf(source, fetchModule, LIBRARY));
}
