import { fetchModule } from './fetch.js';
import { bytesFrom, engineOf, LIBRARY, type WasmSource } from './load.js';
import { faceOf, type Voreleffect } from './voreleffect.js';
import { base64 } from './voreleffect_bytes.js';

export * from './exports.js';

/** A fresh instance of the library: of the module within this file where there is no source. */
export async function load(source: WasmSource = bytesFrom(base64)): Promise<Voreleffect> {
    return faceOf(await engineOf(source, fetchModule, LIBRARY));
}
