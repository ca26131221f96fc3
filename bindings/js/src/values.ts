/** `'#RGB'`, `'#RRGGBB'` or 0xRRGGBB. */
export type Color = string | number;

/** One colour of a ramp: `place` from 0 to 1 ascends from stop to stop, `opacity` is 0 to 1, else 1. */
export type Stop =
    | { readonly color: Color; readonly place: number; readonly opacity?: number }
    | readonly [color: Color, place: number, opacity?: number];

/** A stop as looks keep it; the colour is 0xRRGGBB. */
export interface StopState {
    readonly color: number;
    readonly place: number;
    readonly opacity: number;
}

/** Pixels around glyphs, 0 or more on each side. */
export interface Margins {
    readonly left: number;
    readonly top: number;
    readonly right: number;
    readonly bottom: number;
}

/** A box of whole pixels; right and bottom lie one past the last column and row. Empty when all are 0. */
export interface Box {
    readonly left: number;
    readonly top: number;
    readonly right: number;
    readonly bottom: number;
}

const MOST_STOPS = 256;
const MOST_COLOR = 0xffffff;
const LARGEST_NUMBER = 3e38;
const LARGEST_INTEGER = 2 ** 31 - 1;

/** What a value is, for an error. */
export function kindOf(value: unknown): string {
    if (value === null || value === undefined) return String(value);
    if (Array.isArray(value)) return 'an array';
    return typeof value === 'object' ? 'an object' : `a ${typeof value}`;
}

/** The kind of an object of the platform, also of one from another window or context. */
export function tagOf(value: unknown): string {
    return Object.prototype.toString.call(value).slice('[object '.length, -1);
}

/** A finite number. Throws TypeError, or RangeError for one that is none. */
export function number(value: unknown, name: string): number {
    if (typeof value !== 'number') throw new TypeError(`${name}: a number, not ${kindOf(value)}`);
    if (!(Math.abs(value) <= LARGEST_NUMBER)) {
        throw new RangeError(`${name}: ${value} is no finite number`);
    }
    return value;
}

/** A number that is brought into 0 to 1. */
export function unit(value: unknown, name: string): number {
    return Math.min(Math.max(number(value, name), 0), 1);
}

/** A whole number of a range. Throws TypeError or RangeError. */
export function integer(
    value: unknown,
    name: string,
    least = -LARGEST_INTEGER - 1,
    most = LARGEST_INTEGER,
): number {
    if (typeof value !== 'number') throw new TypeError(`${name}: a number, not ${kindOf(value)}`);
    if (!Number.isInteger(value) || value < least || value > most) {
        throw new RangeError(`${name}: ${value} is no whole number from ${least} to ${most}`);
    }
    return value;
}

/** An object. Throws TypeError. */
export function object<Kind extends object>(value: Kind, name: string): Kind {
    if (typeof value !== 'object' || (value as unknown) === null) {
        throw new TypeError(`${name}: an object, not ${kindOf(value)}`);
    }
    return value;
}

/** The options of a call. Throws TypeError for what is no object, and for names that there are not. */
export function options<Kind extends object>(
    given: Kind,
    names: readonly (keyof Kind & string)[],
): Kind {
    const known: readonly string[] = names;
    for (const name of Object.keys(object(given, 'options'))) {
        if (!known.includes(name)) throw new TypeError(`there is no option '${name}'`);
    }
    return given;
}

/** The colour as 0xRRGGBB. Throws TypeError or RangeError. */
export function color(value: unknown): number {
    if (typeof value === 'string') return colorOfText(value);
    if (typeof value !== 'number') {
        throw new TypeError(`a colour is a string or a number, not ${kindOf(value)}`);
    }
    if (!Number.isInteger(value) || value < 0 || value > MOST_COLOR) {
        throw new RangeError(`${value} is no colour: it is 0 to 0xFFFFFF`);
    }
    return value;
}

function colorOfText(text: string): number {
    if (!/^#([0-9a-f]{3}|[0-9a-f]{6})$/i.test(text) || text.endsWith('\n')) {
        throw new RangeError(`'${text}' is no colour: write '#RRGGBB' or '#RGB'`);
    }
    const digits = text.slice(1);
    return parseInt(digits.length === 3 ? digits.replace(/./g, '$&$&') : digits, 16);
}

/** 0xRRGGBB as style files have it. */
export function spelled(value: number): string {
    return `#${value.toString(16).toUpperCase().padStart(6, '0')}`;
}

/** 1 to 256 stops. Throws TypeError or RangeError. */
export function stops(given: unknown): readonly StopState[] {
    if (!Array.isArray(given)) throw new TypeError(`stops: an array, not ${kindOf(given)}`);
    if (given.length < 1 || given.length > MOST_STOPS) {
        throw new RangeError(`a ramp has 1 to ${MOST_STOPS} stops, not ${given.length}`);
    }
    return Object.freeze(Array.from(given, stop));
}

function stop(given: unknown): StopState {
    const parts: unknown[] = Array.isArray(given) ? given : partsOf(given);
    if (parts.length < 2 || parts.length > 3) throw noStop();
    const [ofColor, place, opacity = 1] = parts;
    return Object.freeze({
        color: color(ofColor),
        place: number(place, 'place'),
        opacity: number(opacity, 'opacity'),
    });
}

function partsOf(given: unknown): unknown[] {
    if (typeof given !== 'object' || given === null) throw noStop();
    const { color, place, opacity } = given as Record<string, unknown>;
    return [color, place, opacity];
}

function noStop(): TypeError {
    return new TypeError('a stop is { color, place, opacity } or [color, place, opacity]');
}
