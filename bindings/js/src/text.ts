import { fetchModule } from './fetch.js';
import { engineOf, type WasmSource } from './load.js';
import { WITH_TEXT } from './text_engine.js';
import { textFaceOf, type VoreleffectText } from './voreleffect_text.js';

export * from './text_exports.js';

/** A fresh instance of the library with text: of the module beside this file where there is no source. */
export async function load(
    source: WasmSource = new URL('./voreleffect-text.wasm', import.meta.url),
): Promise<VoreleffectText> {
    return textFaceOf(await engineOf(source, fetchModule, WITH_TEXT));
}
