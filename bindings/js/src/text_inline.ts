import { fetchModule } from './fetch.js';
import { bytesFrom, engineOf, type WasmSource } from './load.js';
import { WITH_TEXT } from './text_engine.js';
import { base64 } from './voreleffect_text_bytes.js';
import { textFaceOf, type VoreleffectText } from './voreleffect_text.js';

export * from './text_exports.js';

/** A fresh instance of the library with text: of the module within this file where there is no source. */
export async function load(source: WasmSource = bytesFrom(base64)): Promise<VoreleffectText> {
    return textFaceOf(await engineOf(source, fetchModule, WITH_TEXT));
}
