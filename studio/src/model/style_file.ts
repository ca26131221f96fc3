/**
 * The style file of docs/style-files.md as types; style/vorelpaint-style.schema.json is its schema, and the
 * names here are the file's.
 */

/** Pixels, or a string with a unit: '4px', '4%' of the size of the font. */
export type Length = number | string;

/** '#RRGGBB' or '#RGB'. */
export type Colour = string;

/** One colour of a ramp; location and opacity are from 0 to 1. Stops stand in the order of their locations. */
export interface Stop {
    location: number;
    color: Colour;
    opacity?: number;
}

/** Angle in degrees: where the light comes from, 0 the right, 90 above. */
export interface Shadow {
    angle: number;
    distance: Length;
    size: Length;
    color: Colour;
    opacity?: number;
}

/** Has a colour, or a gradient from the edge of the text onwards. */
export interface Glow {
    size: Length;
    color?: Colour;
    opacity?: number;
    gradient?: Stop[];
}

/** Angle in degrees: where the ramp runs to. */
export interface LinearGradient {
    angle: number;
    scale?: number;
    opacity?: number;
    gradient: Stop[];
}

export interface RadialGradient {
    scale?: number;
    opacity?: number;
    gradient: Stop[];
}

export interface Stroke {
    size: Length;
    color: Colour;
    opacity?: number;
    strokeStyle?: number;
    position: 'center' | 'outside' | 'inside';
}

/** `image` names a picture, `width` stands instead of `scale`. */
export interface Pattern {
    image: string;
    scale?: number;
    width?: Length;
    opacity?: number;
}

/** The fill as an effect. */
export interface TextFill {
    color: Colour;
    opacity?: number;
}

/** Carried by the format; the library has no core that paints it. */
export interface Relief {
    style?: number;
    size: Length;
    depth?: number;
    technique?: number;
    direction?: number;
    soften?: number;
    opacity?: number;
    angle: number;
    altitude: number;
    highlightColor: Colour;
    highlightOpacity?: number;
    shadowColor: Colour;
    shadowOpacity?: number;
}

export interface Effects {
    outerShadow?: Shadow;
    innerShadow?: Shadow;
    outerGlow?: Glow;
    innerGlow?: Glow;
    bevel?: Relief;
    emboss?: Relief;
    linearGradient?: LinearGradient;
    radialGradient?: RadialGradient;
    stroke?: Stroke;
    pattern?: Pattern;
    text?: TextFill;
}

export type EffectName = keyof Effects;

export type Span = 'block' | 'line' | 'word' | 'glyph';

/** The order of the keys of effects is the order in which they are added: the last one lies on top. */
export interface LookStyle extends Effects {
    description?: string;
    color?: Colour;
    textOpacity?: number;
    fill?: boolean;
    offset?: { x?: Length; y?: Length };
    span?: Span;
}

/** Version 2 with a list of 1 to 32 looks, the last one on top. */
export interface StyleFile {
    $schema?: string;
    version: 2;
    description?: string;
    looks: LookStyle[];
}

/** Every effect of the format, in the schema's order. */
export const effectNames = [
    'outerShadow',
    'innerShadow',
    'outerGlow',
    'innerGlow',
    'bevel',
    'emboss',
    'linearGradient',
    'radialGradient',
    'stroke',
    'pattern',
    'text',
] as const satisfies readonly EffectName[];

/** The effects that the library paints. */
export const paintedEffects: readonly EffectName[] = effectNames.filter(
    (name) => name !== 'bevel' && name !== 'emboss',
);

export function isEffectName(name: string): name is EffectName {
    return (effectNames as readonly string[]).includes(name);
}

/** The effects of a look in the order of the file: the last one is added last. */
export function effectsOf(look: LookStyle): EffectName[] {
    return Object.keys(look).filter(isEffectName);
}

/** What a look is called: its description, or its number from the lowest. */
export function lookName(look: LookStyle, index: number): string {
    return look.description ?? `Look ${index + 1}`;
}
