export { VorelError, VorelMemoryError, VorelSizeError } from './errors.js';
export type { Glyph, Glyphs, Mask } from './glyphs.js';
export type { CompiledModule, ResponseLike, WasmSource } from './load.js';
export type { Look, LookClass } from './look.js';
export type {
    EffectState,
    GlowOptions,
    LinearGradientOptions,
    LookState,
    PatternOptions,
    Pixels,
    Position,
    RadialGradientOptions,
    ShadowOptions,
    StrokeOptions,
} from './look_state.js';
export type { CanvasLike, Painter, PainterClass, PaintTarget, Place } from './painting.js';
export type { Picture, PlatformImageData } from './picture.js';
export type { Target } from './targets.js';
export type { Box, Color, Margins, Stop, StopState } from './values.js';
export type { Paint, Voreleffect } from './voreleffect.js';
