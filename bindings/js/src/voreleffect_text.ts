import { fontClassOf, type FontClass } from './font.js';
import { presetNames, styleClassOf, type StyleClass } from './style.js';
import type { TextEngine } from './text_engine.js';
import { textsOf, type Text } from './texts.js';
import { faceOf, type Voreleffect } from './voreleffect.js';

/** The library with texts, fonts and styles in an instance of its own. */
export interface VoreleffectText extends Voreleffect {
    readonly Font: FontClass;
    readonly Style: StyleClass;
    /** The names of the presets, sorted. */
    readonly presets: readonly string[];
    readonly Text: Text;
}

/** The face of an instance of the module with text. */
export function textFaceOf(engine: TextEngine): VoreleffectText {
    const face = faceOf(engine);
    const Style = styleClassOf(engine, face.Look);
    return Object.freeze({
        ...face,
        Font: fontClassOf(engine),
        Style,
        presets: Object.freeze(presetNames()),
        Text: textsOf(engine, Style),
    });
}
