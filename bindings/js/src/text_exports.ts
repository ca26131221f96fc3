export * from './exports.js';
export { FontError, StyleError, TextError } from './errors.js';
export type { Font, FontClass, FontOptions } from './font.js';
export type {
    CppOptions,
    Explanation,
    PlannedEffect,
    ScaleOptions,
    Style,
    StyleClass,
    StyleOptions,
} from './style.js';
export type { TextPicture } from './text_picture.js';
export type { Anchor, TextOptions } from './text_request.js';
export type { LayerPicture, Text, TextGlyph, TextLayout } from './texts.js';
export type { VoreleffectText } from './voreleffect_text.js';
