import {
    color,
    integer,
    kindOf,
    number,
    object,
    options,
    spelled,
    stops,
    tagOf,
    unit,
    type Color,
    type Stop,
    type StopState,
} from './values.js';

/** Straight pixels R, G, B, A; an ImageData is one. */
export interface Pixels {
    /** Top row first. */
    readonly data: Uint8Array | Uint8ClampedArray;
    /** Pixels of a row, 1 or more. */
    readonly width: number;
    /** Rows, 1 or more. */
    readonly height: number;
    /** Bytes from row to row, at least 4 * width; packed rows without it. */
    readonly stride?: number;
}

/** Where a stroke lies on the edge of the glyphs. */
export type Position = 'outside' | 'inside' | 'centre';

export interface ShadowState {
    readonly kind: 'outerShadow' | 'innerShadow';
    readonly color: number;
    readonly angle: number;
    readonly distance: number;
    readonly size: number;
    readonly opacity: number;
}
export interface GlowState {
    readonly kind: 'outerGlow' | 'innerGlow';
    readonly size: number;
    readonly color: number;
    /** None where the glow is of the one colour. */
    readonly stops: readonly StopState[];
    readonly opacity: number;
}
export interface LinearGradientState {
    readonly kind: 'linearGradient';
    readonly stops: readonly StopState[];
    readonly angle: number;
    readonly scale: number;
    readonly opacity: number;
}
export interface RadialGradientState {
    readonly kind: 'radialGradient';
    readonly stops: readonly StopState[];
    readonly scale: number;
    readonly opacity: number;
}
export interface StrokeState {
    readonly kind: 'stroke';
    readonly size: number;
    readonly color: number;
    readonly position: Position;
    readonly opacity: number;
}
export interface PatternState {
    readonly kind: 'pattern';
    readonly width: number;
    readonly height: number;
    /** Straight R, G, B, A in packed rows. */
    readonly data: Uint8Array<ArrayBuffer>;
    readonly scale: number;
    readonly opacity: number;
}

/** One effect, its colours 0xRRGGBB. */
export type EffectState =
    | ShadowState
    | GlowState
    | LinearGradientState
    | RadialGradientState
    | StrokeState
    | PatternState;

/** A look as plain data, which can be posted to workers and stored. */
export interface LookState {
    readonly fill: number;
    readonly fillOpacity: number;
    readonly isFilled: boolean;
    readonly textOpacity: number;
    /** In the order in which they were added. */
    readonly effects: readonly EffectState[];
}

export interface ShadowOptions {
    /** Where the light comes from, in degrees: 0 the right, 90 above; else 135. */
    readonly angle?: number | undefined;
    /** How far it is moved, away from the light: 0 to 100 pixels, else 4. */
    readonly distance?: number | undefined;
    /** Radius of the blur: 0 to 100 pixels, else 4. */
    readonly size?: number | undefined;
    /** 0 to 1, else 1. */
    readonly opacity?: number | undefined;
}
export interface GlowOptions {
    /** 1 to 256 colours from the edge of the glyphs onwards, instead of the one colour. */
    readonly stops?: readonly Stop[] | undefined;
    /** 0 to 1, else 1; multiplied with that of each stop. */
    readonly opacity?: number | undefined;
}
export interface LinearGradientOptions {
    /** In degrees: 0 runs to the right, 90 upwards; else 0. */
    readonly angle?: number | undefined;
    /** Its length in lengths of the box: 0.1 to 2, else 1; less paints nothing. */
    readonly scale?: number | undefined;
    /** 0 to 1, else 1; multiplied with that of each stop. */
    readonly opacity?: number | undefined;
}
export interface RadialGradientOptions {
    /** Its length in half widths of the box: 0.1 to 2, else 1; less paints nothing. */
    readonly scale?: number | undefined;
    /** 0 to 1, else 1; multiplied with that of each stop. */
    readonly opacity?: number | undefined;
}
export interface StrokeOptions {
    /** Where it lies, else outside. */
    readonly position?: Position | 'center' | undefined;
    /** 0 to 1, else 1. */
    readonly opacity?: number | undefined;
}
export interface PatternOptions {
    /** Pixels that are painted for one of the pattern: 0.1 to 10, else 1; less paints nothing. */
    readonly scale?: number | undefined;
    /** 0 to 1, else 1. */
    readonly opacity?: number | undefined;
}

const MOST_BYTES = 2 ** 31 - 1;

/** Filled in black, without effects. */
export const PLAIN: LookState = Object.freeze({
    fill: 0,
    fillOpacity: 1,
    isFilled: true,
    textOpacity: 1,
    effects: Object.freeze([]),
});

export function shadow(
    kind: ShadowState['kind'],
    of: Color,
    given: ShadowOptions = {},
): ShadowState {
    const told = options(given, ['angle', 'distance', 'size', 'opacity']);
    const { angle = 135, distance = 4, size = 4, opacity = 1 } = told;
    return {
        kind,
        color: color(of),
        angle: number(angle, 'angle'),
        distance: number(distance, 'distance'),
        size: number(size, 'size'),
        opacity: number(opacity, 'opacity'),
    };
}

export function glow(
    kind: GlowState['kind'],
    size: number,
    of: Color,
    given: GlowOptions = {},
): GlowState {
    const { stops: list, opacity = 1 } = options(given, ['stops', 'opacity']);
    return {
        kind,
        size: number(size, 'size'),
        color: color(of),
        stops: list === undefined ? Object.freeze([]) : stops(list),
        opacity: number(opacity, 'opacity'),
    };
}

export function linearGradient(
    list: readonly Stop[],
    given: LinearGradientOptions = {},
): LinearGradientState {
    const { angle = 0, scale = 1, opacity = 1 } = options(given, ['angle', 'scale', 'opacity']);
    return {
        kind: 'linearGradient',
        stops: stops(list),
        angle: number(angle, 'angle'),
        scale: number(scale, 'scale'),
        opacity: number(opacity, 'opacity'),
    };
}

export function radialGradient(
    list: readonly Stop[],
    given: RadialGradientOptions = {},
): RadialGradientState {
    const { scale = 1, opacity = 1 } = options(given, ['scale', 'opacity']);
    return {
        kind: 'radialGradient',
        stops: stops(list),
        scale: number(scale, 'scale'),
        opacity: number(opacity, 'opacity'),
    };
}

export function stroke(size: number, of: Color, given: StrokeOptions = {}): StrokeState {
    const { position = 'outside', opacity = 1 } = options(given, ['position', 'opacity']);
    return {
        kind: 'stroke',
        size: number(size, 'size'),
        color: color(of),
        position: positionOf(position),
        opacity: number(opacity, 'opacity'),
    };
}

function positionOf(value: unknown): Position {
    if (value === 'center') return 'centre';
    if (value === 'outside' || value === 'inside' || value === 'centre') return value;
    const told = typeof value === 'string' ? `'${value}'` : kindOf(value);
    throw new RangeError(`position: ${told} is none of outside, inside, centre`);
}

export function pattern(pixels: Pixels, given: PatternOptions = {}): PatternState {
    const { scale = 1, opacity = 1 } = options(given, ['scale', 'opacity']);
    return {
        kind: 'pattern',
        ...packed(pixels),
        scale: number(scale, 'scale'),
        opacity: number(opacity, 'opacity'),
    };
}

/** A copy of the pixels in packed rows. Throws TypeError or RangeError. */
export function packed(pixels: Pixels): Pick<PatternState, 'width' | 'height' | 'data'> {
    const { data: from, width: w, height: h, stride: given } = object(pixels, 'pixels');
    const bytes = bytesOf(from, 'the pixels of a pattern');
    const width = integer(w, 'width', 1);
    const height = integer(h, 'height', 1);
    if (width * height * 4 > MOST_BYTES) {
        throw new RangeError(`a pattern of ${width} x ${height} pixels has 2^31 bytes and more`);
    }
    const stride = strideOf(given, 4 * width);
    checkRows(bytes, 4 * width, height, stride, 'the pixels of a pattern');
    const data = new Uint8Array(4 * width * height);
    for (let y = 0; y < height; ++y) {
        data.set(bytes.subarray(y * stride, y * stride + 4 * width), 4 * width * y);
    }
    return { width, height, data };
}

/** An array of bytes. Throws TypeError. */
export function bytesOf<Kind extends Uint8Array | Uint8ClampedArray>(
    data: Kind,
    what: string,
): Kind {
    const tag = tagOf(data);
    const isOfBytes = tag === 'Uint8Array' || tag === 'Uint8ClampedArray';
    if (ArrayBuffer.isView(data) && isOfBytes) return data;
    throw new TypeError(`${what}: a Uint8Array or a Uint8ClampedArray, not ${kindOf(data)}`);
}

/** The bytes from row to row. Throws TypeError or RangeError. */
export function strideOf(stride: unknown, rowBytes: number): number {
    if (stride === undefined) return rowBytes;
    return integer(stride, 'stride', rowBytes, Number.MAX_SAFE_INTEGER);
}

/** Throws RangeError where there are fewer bytes than the rows have. */
export function checkRows(
    data: { readonly length: number },
    rowBytes: number,
    rows: number,
    stride: number,
    what: string,
): void {
    if (rows === 0 || rowBytes === 0) return;
    const needed = (rows - 1) * stride + rowBytes;
    if (data.length < needed) {
        throw new RangeError(`${what}: ${data.length} bytes where ${needed} are needed`);
    }
}

/** Adds an effect; one of its kind that is there already is replaced, at its place in the order. */
export function added(state: LookState, effect: EffectState): LookState {
    const effects = [...state.effects];
    const same = effects.findIndex((other) => other.kind === effect.kind);
    effects.splice(same < 0 ? effects.length : same, same < 0 ? 0 : 1, Object.freeze(effect));
    return changed(state, { effects: Object.freeze(effects) });
}

/** A state in which some fields are others. */
export function changed(state: LookState, fields: Partial<LookState>): LookState {
    return Object.freeze({ ...state, ...fields });
}

/** The state that a plain object tells, checked as the calls check theirs. Throws TypeError or RangeError. */
export function stateOf(given: LookState): LookState {
    const { fill, fillOpacity, isFilled, textOpacity, effects } = object(given, 'state');
    if (typeof isFilled !== 'boolean') {
        throw new TypeError(`isFilled: a boolean, not ${kindOf(isFilled)}`);
    }
    if (!Array.isArray(effects)) throw new TypeError(`effects: an array, not ${kindOf(effects)}`);
    const start = changed(PLAIN, {
        fill: color(fill),
        fillOpacity: unit(fillOpacity, 'fillOpacity'),
        isFilled,
        textOpacity: unit(textOpacity, 'textOpacity'),
    });
    return effects.map(effectOf).reduce(added, start);
}

function effectOf(given: EffectState): EffectState {
    const effect = object(given, 'an effect');
    switch (effect.kind) {
        case 'outerShadow':
        case 'innerShadow':
            return shadow(
                effect.kind,
                effect.color,
                picked(effect, ['angle', 'distance', 'size', 'opacity']),
            );
        case 'outerGlow':
        case 'innerGlow':
            return glow(effect.kind, effect.size, effect.color, {
                ...picked(effect, ['opacity']),
                ...(isEmpty(effect.stops) ? {} : { stops: effect.stops }),
            });
        case 'linearGradient':
            return linearGradient(effect.stops, picked(effect, ['angle', 'scale', 'opacity']));
        case 'radialGradient':
            return radialGradient(effect.stops, picked(effect, ['scale', 'opacity']));
        case 'stroke':
            return stroke(effect.size, effect.color, picked(effect, ['position', 'opacity']));
        case 'pattern':
            return pattern(effect, picked(effect, ['scale', 'opacity']));
        default:
            throw new TypeError(
                `there is no effect '${String((effect as { kind: unknown }).kind)}'`,
            );
    }
}

function isEmpty(list: unknown): boolean {
    return Array.isArray(list) && list.length === 0;
}

function picked<Kind extends object, Name extends keyof Kind>(
    from: Kind,
    names: readonly Name[],
): Pick<Kind, Name> {
    return Object.fromEntries(names.map((name) => [name, from[name]])) as Pick<Kind, Name>;
}

/** A state whose pixels are a copy, for those who are given it. */
export function copyOf(state: LookState): LookState {
    const copied = (effect: EffectState): EffectState =>
        effect.kind === 'pattern' ? { ...effect, data: effect.data.slice() } : effect;
    return { ...state, effects: state.effects.map(copied) };
}

/** The calls that make the look. */
export function callsOf(state: LookState): string {
    const { fill, fillOpacity, isFilled, textOpacity } = state;
    const opacity = fillOpacity === 1 ? '' : `, ${fillOpacity}`;
    const calls = isFilled ? [`.fill('${spelled(fill)}'${opacity})`] : ['.noFill()'];
    if (textOpacity !== 1) calls.push(`.textOpacity(${textOpacity})`);
    return `new Look()${[...calls, ...state.effects.map(callOf)].join('')}`;
}

function callOf(effect: EffectState): string {
    const opacity = effect.opacity === 1 ? '' : `, opacity: ${effect.opacity}`;
    switch (effect.kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const { angle, distance, size } = effect;
            const numbers = `angle: ${angle}, distance: ${distance}, size: ${size}${opacity}`;
            return `.${effect.kind}('${spelled(effect.color)}', { ${numbers} })`;
        }
        case 'outerGlow':
        case 'innerGlow': {
            const ramp = effect.stops.length === 0 ? '' : `, stops: ${listOf(effect.stops)}`;
            const more = `${ramp}${opacity}`.slice(2);
            return `.${effect.kind}(${effect.size}, '${spelled(effect.color)}'${more && `, { ${more} }`})`;
        }
        case 'linearGradient': {
            const numbers = `angle: ${effect.angle}, scale: ${effect.scale}${opacity}`;
            return `.linearGradient(${listOf(effect.stops)}, { ${numbers} })`;
        }
        case 'radialGradient':
            return `.radialGradient(${listOf(effect.stops)}, { scale: ${effect.scale}${opacity} })`;
        case 'stroke': {
            const { size, position } = effect;
            return `.stroke(${size}, '${spelled(effect.color)}', { position: '${position}'${opacity} })`;
        }
        case 'pattern': {
            const { width, height, scale } = effect;
            return `.pattern(<${width} x ${height} pixels>, { scale: ${scale}${opacity} })`;
        }
    }
}

function listOf(ramp: readonly StopState[]): string {
    const each = ramp.map(({ color: of, place, opacity }) => {
        const last = opacity === 1 ? '' : `, ${opacity}`;
        return `['${spelled(of)}', ${place}${last}]`;
    });
    return `[${each.join(', ')}]`;
}
