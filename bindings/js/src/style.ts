/// <reference lib="esnext.disposable" preserve="true" />
import { disposeByFree, type Handle, type Scope } from './engine.js';
import { StyleError } from './errors.js';
import { bytesFrom } from './load.js';
import type { Look, LookClass } from './look.js';
import { packed, type LookState, type Pixels } from './look_state.js';
import { PRESETS, PRESET_PATTERNS } from './preset_files.js';
import { bytesOfHex, requestIn, sidesOf, type Sides, type TextEngine } from './text_engine.js';
import {
    color,
    integer,
    kindOf,
    number,
    object,
    options,
    spelled,
    type Color,
    type Margins,
} from './values.js';

/** One step of painting a look. */
export interface PlannedEffect {
    /** Its name in a style file, as "outerShadow". */
    readonly effect: string;
    /** Where it lies relative to the glyphs: "outside the text". */
    readonly place: string;
    /** One sentence: why it lies there, and over what. */
    readonly reason: string;
    /** How long it took to paint, where it was painted. */
    readonly milliseconds?: number;
}

/** How a style is painted. */
export interface Explanation {
    readonly margins: Margins;
    /** The lowest look first. */
    readonly looks: readonly {
        /** Whether what lies outside the glyphs has a layer of its own, and why. */
        readonly layered: boolean;
        readonly reason: string;
        /** How the look is moved and what is painted as one, in the words of the key, and what that does. */
        readonly place: string;
        readonly placeReason: string;
        /** The topmost effect first. */
        readonly order: readonly PlannedEffect[];
    }[];
    /** What the parts of the key say, in their order. */
    readonly key: readonly { readonly name: string; readonly meaning: string }[];
    readonly keyBytes: Uint8Array<ArrayBuffer>;
}

/** How a style is read. */
export interface StyleOptions {
    /** Under which messages speak of it. */
    readonly name?: string | undefined;
    /** The straight pixels of its patterns, by the names that it has for them. */
    readonly images?: Readonly<Record<string, Pixels>> | undefined;
}

/** How lengths of a style are made pixels. */
export interface ScaleOptions {
    /** Multiplies the effects' sizes: 0.05 to 20, else 1. */
    readonly effectScale?: number | undefined;
}

/** What is written as C++. */
export interface CppOptions extends ScaleOptions {
    /** The fill of the topmost look that has one, instead of the look's. */
    readonly color?: Color | undefined;
    /** The opacity of that text, 0 to 1. */
    readonly opacity?: number | undefined;
}

/** What makes styles of one instance. */
export interface StyleClass {
    /**
     * The style of the text of a style file (docs/style-files.md), or of what JSON.parse makes of one. Throws
     * StyleError, which tells the path of the key that is wrong.
     */
    fromJSON(style: string | object, options?: StyleOptions): Style;
    /** The preset of a name, of its own. Throws StyleError, which lists the presets, when there is none. */
    preset(name: string): Style;
    readonly prototype: Style;
}

/** A style file: one look or several, moved or of lines, words and glyphs. It never changes. */
export class Style {
    readonly #engine: TextEngine;
    readonly #Look: LookClass;
    readonly #text: string;
    readonly #handle: Handle;

    /** @internal */
    constructor(engine: TextEngine, Look: LookClass, text: string, given: StyleOptions) {
        const { name = '', images = {} } = options(given, ['name', 'images']);
        if (typeof name !== 'string') throw new TypeError(`name: a string, not ${kindOf(name)}`);
        this.#engine = engine;
        this.#Look = Look;
        this.#text = text;
        const address = engine.scoped((scope) => {
            const { address: at, length } = scope.text(text);
            const named = scope.text(name).address;
            return scope.made('vorel_style_new', at, length, named, ...imagesIn(scope, images));
        });
        this.#handle = engine.keep(this, 'style', address, 'vorel_style_free');
    }

    /** What it was made of, parsed. */
    toJSON(): object {
        return JSON.parse(this.#text.replace(/^\uFEFF/, '')) as object;
    }

    /** What the file says that it shows; may be empty. */
    get description(): string {
        return this.#facts(1, {}).description;
    }

    /**
     * Its looks for a font of `size` pixels, 1 to 1000, the lowest first. Throws StyleError when one is moved or of
     * lines, words or glyphs: these `Text` paints.
     */
    looks(size: number, scale: ScaleOptions = {}): Look[] {
        const { told, bytes } = this.#engine.answer<ToldState[]>(
            'vorel_style_looks',
            ...this.#sized(size, scale),
        );
        return told.map((state) => this.#Look.from(withPixels(state, bytes)));
    }

    /** Its key for a cache, with a font of `size` pixels; it does not tell the pixels of patterns. */
    key(size: number, scale: ScaleOptions = {}): Uint8Array<ArrayBuffer> {
        return bytesOfHex(this.#facts(size, scale).key);
    }

    /**
     * How far it paints beyond the glyphs of a font of `size` pixels. The faint end of a glow may be a few pixels
     * farther; the `margins` of a look have room for it.
     */
    margins(size: number, scale: ScaleOptions = {}): Margins {
        return sidesOf(this.#facts(size, scale).margins);
    }

    /**
     * C++17 that makes the calls of the library; its function is called `name`, and several looks have one each, with
     * numbers behind it. Throws RangeError for what is no name of a function.
     */
    toCpp(name: string, size: number, given: CppOptions = {}): string {
        const {
            color: fill,
            opacity,
            effectScale,
        } = options(given, ['color', 'opacity', 'effectScale']);
        if (typeof name !== 'string') throw new TypeError(`name: a string, not ${kindOf(name)}`);
        const request = {
            name,
            size: integer(size, 'size', 1, 1000),
            color: fill === undefined ? undefined : spelled(color(fill)),
            opacity: opacity === undefined ? undefined : number(opacity, 'opacity'),
            effectScale: effectScale === undefined ? undefined : number(effectScale, 'effectScale'),
        };
        return this.#engine.scoped((scope) => {
            const given = [this.#handle.address, ...requestIn(scope, request)];
            return this.#engine.answer<{ source: string }>('vorel_style_cpp', ...given).told.source;
        });
    }

    /** How it is painted for a font of `size` pixels. */
    explain(size: number, scale: ScaleOptions = {}): Explanation {
        const plan = this.#engine.answer<Plan>('vorel_style_plan', ...this.#sized(size, scale));
        return explanationOf(plan.told);
    }

    /** Gives back its memory; the style cannot be used any more. A second time it does nothing. */
    free(): void {
        this.#handle.free();
    }

    /** As `free`, for `using`. */
    declare [Symbol.dispose]: () => void;

    static {
        disposeByFree(this);
    }

    /**
     * Where a style of an instance lies in its memory. Throws TypeError for one of another instance.
     * @internal
     */
    static addressIn(engine: TextEngine, style: Style): number {
        if (style.#engine !== engine) throw new TypeError('a style of another instance');
        return style.#handle.address;
    }

    #sized(size: number, scale: ScaleOptions): [number, number, number] {
        const { effectScale = 1 } = options(scale, ['effectScale']);
        return [
            this.#handle.address,
            integer(size, 'size', 1, 1000),
            number(effectScale, 'effectScale'),
        ];
    }

    #facts(size: number, scale: ScaleOptions): Facts {
        return this.#engine.answer<Facts>('vorel_style_facts', ...this.#sized(size, scale)).told;
    }
}

interface Facts {
    readonly description: string;
    readonly margins: Sides;
    readonly key: string;
}

/** An explanation as the module tells it. */
export type Plan = Omit<Explanation, 'margins' | 'keyBytes'> & {
    readonly margins: Sides;
    readonly keyBytes: string;
};

/** The explanation of a plan. */
export function explanationOf(plan: Plan): Explanation {
    return { ...plan, margins: sidesOf(plan.margins), keyBytes: bytesOfHex(plan.keyBytes) };
}

/** A state whose pattern tells where its pixels are. */
interface ToldState {
    readonly effects: readonly { kind: string; width?: number; height?: number; at?: number }[];
}

function withPixels(state: ToldState, bytes: Uint8Array<ArrayBuffer>): LookState {
    const effects = state.effects.map(({ at, ...effect }) => {
        if (at === undefined) return effect;
        return { ...effect, data: bytes.slice(at, at + 4 * effect.width! * effect.height!) };
    });
    return { ...state, effects } as unknown as LookState;
}

/** Named pictures in memory: the two arguments that they are. */
export function imagesIn(scope: Scope, images: Readonly<Record<string, Pixels>>): [number, number] {
    const entries = Object.entries(object(images, 'images'));
    const words = entries.flatMap(([name, pixels]) => {
        const { data, width, height } = packed(pixels);
        return [scope.text(name).address, scope.copy(data), width, height, 0];
    });
    return [scope.words(...words), entries.length];
}

/** The class of the styles of an instance. */
export function styleClassOf(engine: TextEngine, Look: LookClass): StyleClass {
    class StyleOfInstance extends Style {
        static fromJSON(style: string | object, given: StyleOptions = {}): Style {
            const text = typeof style === 'string' ? style : JSON.stringify(object(style, 'style'));
            return new StyleOfInstance(engine, Look, text, given);
        }
        static preset(name: string): Style {
            const text = Object.hasOwn(PRESETS, name) ? PRESETS[name] : undefined;
            if (text === undefined) {
                throw new StyleError(`no preset '${name}'; there are ${presetNames().join(', ')}`);
            }
            return new StyleOfInstance(engine, Look, text, { name, images: patternsOf(text) });
        }
    }
    return Object.defineProperty(StyleOfInstance, 'name', { value: 'Style' });
}

/** The names of the presets, sorted. */
export function presetNames(): readonly string[] {
    return Object.keys(PRESETS);
}

/** The pictures that the text of a preset names. */
function patternsOf(text: string): Record<string, Pixels> {
    const named = Object.entries(PRESET_PATTERNS).filter(([name]) => text.includes(`"${name}"`));
    return Object.fromEntries(
        named.map(([name, { width, height, base64 }]) => [
            name,
            { width, height, data: bytesFrom(base64) },
        ]),
    );
}
