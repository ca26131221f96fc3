import type { Scope } from './engine.js';
import { Font } from './font.js';
import { Look } from './look.js';
import type { LookState, Pixels } from './look_state.js';
import { imagesIn, Style, type StyleClass } from './style.js';
import { TextEngine } from './text_engine.js';
import { color, integer, kindOf, number, object, options, spelled, type Color } from './values.js';

/** Where the text stands in a width or height that is asked for. */
export type Anchor =
    | 'top-left'
    | 'top'
    | 'top-right'
    | 'left'
    | 'center'
    | 'right'
    | 'bottom-left'
    | 'bottom'
    | 'bottom-right';

/** What is asked of a text and its picture. */
export interface TextOptions {
    /** Up to 16; each has what those before it lack, and what none has is missing. */
    readonly fonts: Font | readonly Font[];
    /** Of the font: 1 to 1000 pixels, else 96. */
    readonly size?: number | undefined;
    /** A look, a stack of looks with the last on top, a style, or the name of a preset; else a black fill. */
    readonly look?: Look | readonly Look[] | Style | string | undefined;
    /** Reads `<c #RRGGBB>...</c>` in the text as a colour; `&lt;`, `&gt;` and `&amp;` stand for <, > and &. */
    readonly markup?: boolean | undefined;
    /** Where short lines stand; start and end go by the text's direction. Else left. */
    readonly align?: 'left' | 'center' | 'right' | 'start' | 'end' | undefined;
    /** 0.5 to 10 line heights of the font, else 1. */
    readonly lineHeight?: number | undefined;
    /** -200 to 200 pixels, or percent of the size as in '5%'; else 0. */
    readonly letterSpacing?: number | string | undefined;
    /** Of OpenType: 'liga=0,ss01' or a list. */
    readonly features?: string | readonly string[] | undefined;
    /** Axes of the first font: { wght: 700 }. */
    readonly variations?: Readonly<Record<string, number>> | undefined;
    /** The fill of the topmost look that has one, instead of the look's. */
    readonly color?: Color | undefined;
    /** The opacity of that text, 0 to 1. */
    readonly opacity?: number | undefined;
    /** Multiplies the effects' sizes: 0.05 to 20, else 1. */
    readonly effectScale?: number | undefined;
    /** Of the picture, 1 to 16384 pixels; else what the text needs. */
    readonly width?: number | undefined;
    readonly height?: number | undefined;
    /** Where the text stands in these, else center, and 0 to 8000 pixels between it and their edges. */
    readonly anchor?: Anchor | undefined;
    readonly margin?: number | undefined;
    /** What is done with a text that is larger: nothing, a smaller font, broken lines. */
    readonly fit?: 'none' | 'shrink' | 'wrap' | undefined;
    /** What counts as the text's box: its ink, or its lines. */
    readonly box?: 'ink' | 'line' | undefined;
    /** Pixels around the text and its effects where no width or height is given: 0 to 1000, else 8. */
    readonly padding?: number | undefined;
    /** A colour, 'checkerboard' or 'transparent', which is usual. */
    readonly background?: Color | undefined;
    /** Leaves the pixels premultiplied; there is no background then. */
    readonly premultiplied?: boolean | undefined;
    /** Takes every note for an error. */
    readonly strict?: boolean | undefined;
}

/** Checks one option and makes of it what a request has. */
type Check = (value: unknown, name: string) => unknown;

const checkedNumber: Check = (value, name) => number(value, name);
const checkedInteger: Check = (value, name) => integer(value, name);
const checkedColor: Check = (value) => spelled(color(value));

const CHECKS: Readonly<Record<Exclude<keyof TextOptions, 'fonts' | 'look'>, Check>> = {
    size: checkedInteger,
    markup: truth,
    align: string,
    lineHeight: checkedNumber,
    letterSpacing: spacing,
    features: (value, name) => featuresOf(value, name),
    variations: (value, name) => variationsOf(value, name),
    color: checkedColor,
    opacity: checkedNumber,
    effectScale: checkedNumber,
    width: checkedInteger,
    height: checkedInteger,
    anchor: string,
    margin: checkedInteger,
    fit: string,
    box: string,
    padding: checkedInteger,
    background,
    premultiplied: truth,
    strict: truth,
};

const NAMES = ['fonts', 'look', ...Object.keys(CHECKS)] as (keyof TextOptions)[];

/** What the module is asked for. Throws TypeError or RangeError. */
export function requestOf(engine: TextEngine, text: string, given: TextOptions): object {
    const { fonts } = options(given, NAMES);
    const list: readonly unknown[] = Array.isArray(fonts) ? fonts : [fonts];
    const checked = Object.entries(CHECKS).map(([name, check]) => {
        const value = given[name as keyof TextOptions];
        return [name, value === undefined ? undefined : check(value, name)];
    });
    return {
        ...(Object.fromEntries(checked) as object),
        text: string(text, 'text'),
        fonts: list.map((font) => Font.nameIn(engine, font)),
    };
}

/** Where the style of a look lies in memory, 0 without one; what is made for that is freed with the scope. */
export function styleIn(
    engine: TextEngine,
    scope: Scope,
    look: TextOptions['look'],
    styles: StyleClass,
): number {
    if (look === undefined) return 0;
    if (look instanceof Style) return Style.addressIn(engine, look);
    if (typeof look === 'string') {
        const style = styles.preset(look);
        scope.runs(() => style.free());
        return Style.addressIn(engine, style);
    }
    const looks: readonly unknown[] = Array.isArray(look) ? look : [look];
    return styleOfLooks(scope, looks.map(stateIn));
}

function stateIn(look: unknown): LookState {
    if (look instanceof Look) return look.state;
    throw new TypeError(`look: looks, a style or the name of a preset, not ${kindOf(look)}`);
}

function styleOfLooks(scope: Scope, looks: readonly LookState[]): number {
    const images: Record<string, Pixels> = {};
    const states = looks.map((look, i) => {
        const effects = look.effects.map((effect) => {
            if (effect.kind !== 'pattern') return effect;
            images[i] = effect;
            const { kind, scale, opacity } = effect;
            return { kind, scale, opacity, image: String(i) };
        });
        return { ...look, effects };
    });
    const { address, length } = scope.text(JSON.stringify(states));
    const style = scope.made('vorel_style_of_looks', address, length, ...imagesIn(scope, images));
    return scope.takes(style, 'vorel_style_free');
}

function string(value: unknown, name: string): string {
    if (typeof value !== 'string') throw new TypeError(`${name}: a string, not ${kindOf(value)}`);
    return value;
}

function truth(value: unknown, name: string): boolean {
    if (typeof value !== 'boolean') {
        throw new TypeError(`${name}: a boolean, not ${kindOf(value)}`);
    }
    return value;
}

function spacing(value: unknown, name: string): number | string {
    if (typeof value !== 'string') return number(value, name);
    return /^-?[\d.]+$/.test(value) ? `${value}px` : value;
}

function background(value: unknown): string {
    const isName = value === 'transparent' || value === 'checkerboard';
    return isName ? value : spelled(color(value));
}

function featuresOf(value: unknown, name: string): string[] {
    if (typeof value === 'string') return value === '' ? [] : value.split(',');
    if (!Array.isArray(value)) throw new TypeError(`${name}: a list, not ${kindOf(value)}`);
    return value.map((feature) => string(feature, name));
}

function variationsOf(value: unknown, name: string): object[] {
    const axes = Object.entries(object(value as Record<string, unknown>, name));
    return axes.map(([axis, place]) => ({ axis, value: number(place, name) }));
}
