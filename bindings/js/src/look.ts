/// <reference lib="esnext.disposable" preserve="true" />
import { disposeByFree, freedError, type Engine, type Handle, type Scope } from './engine.js';
import {
    added,
    callsOf,
    changed,
    copyOf,
    glow,
    linearGradient,
    pattern,
    PLAIN,
    radialGradient,
    shadow,
    stateOf,
    stroke,
    type EffectState,
    type GlowOptions,
    type LinearGradientOptions,
    type LookState,
    type PatternOptions,
    type Pixels,
    type RadialGradientOptions,
    type ShadowOptions,
    type StrokeOptions,
} from './look_state.js';
import type { Glyphs } from './glyphs.js';
import { paint, type PaintTarget, type Place } from './painting.js';
import type { Picture } from './picture.js';
import { color, kindOf, unit, type Box, type Color, type Margins, type Stop } from './values.js';

/** What constructs looks of one instance. */
export interface LookClass {
    /** Filled in black, without effects. */
    new (): Look;
    /** The look of a state, as `look.state` tells it. Throws TypeError or RangeError for what is none. */
    from(state: LookState): Look;
    readonly prototype: Look;
}

/**
 * What text looks like: a fill and effects.
 *
 * At the start the fill is black and there are no effects. A look is a value: it never changes, each call returns
 * another one.
 *
 *     new Look().fill('#3366cc').outerShadow('#000', { size: 8, opacity: 0.6 }).stroke(4, '#fff')
 *
 * Effects lie in three groups, from the top: those inside the glyphs, the fill, those beneath the text. Within a
 * group the one that was added last lies on top. A look has one effect of a kind; another one takes its place. For
 * more of them paint several looks, one over the other.
 *
 * Lengths are pixels, angles degrees: 0 the right, 90 above. Numbers out of their range become what the library
 * makes of them, as in C++. What is no number throws TypeError, one that is not finite RangeError.
 *
 * Memory of the module is taken when a look is painted, compared or asked for its key or margins; it is freed by
 * `free()`, or when the look is collected.
 */
export class Look {
    readonly #engine: Engine;
    readonly #state: LookState;
    #handle: Handle | undefined;
    #isFreed = false;

    /** @internal */
    constructor(engine: Engine, state: LookState) {
        this.#engine = engine;
        this.#state = state;
    }

    /** Fills the glyphs. Through a fill of an opacity (0 to 1) below 1 what lies beneath is seen. */
    fill(of: Color, opacity = 1): Look {
        const fields = { fill: color(of), fillOpacity: unit(opacity, 'opacity'), isFilled: true };
        return this.#changed(fields);
    }

    /** Leaves out the fill. What lies beneath the text is cut out of the glyphs. */
    noFill(): Look {
        return this.#changed({ isFilled: false });
    }

    /** The opacity of the text, 0 to 1; below 1 what lies beneath it is cut out of the glyphs. */
    textOpacity(opacity: number): Look {
        return this.#changed({ textOpacity: unit(opacity, 'opacity') });
    }

    /** A shadow behind the glyphs. */
    outerShadow(of: Color, options?: ShadowOptions): Look {
        return this.#with(shadow('outerShadow', of, options));
    }

    /** A shadow that falls into the glyphs. */
    innerShadow(of: Color, options?: ShadowOptions): Look {
        return this.#with(shadow('innerShadow', of, options));
    }

    /** A halo around the glyphs, 0 to 100 pixels wide. */
    outerGlow(size: number, of: Color, options?: GlowOptions): Look {
        return this.#with(glow('outerGlow', size, of, options));
    }

    /** A glow from the edges of the glyphs inwards, 0 to 100 pixels wide. */
    innerGlow(size: number, of: Color, options?: GlowOptions): Look {
        return this.#with(glow('innerGlow', size, of, options));
    }

    /** A ramp of 1 to 256 stops across the box of the glyphs. */
    linearGradient(stops: readonly Stop[], options?: LinearGradientOptions): Look {
        return this.#with(linearGradient(stops, options));
    }

    /** A ramp of 1 to 256 stops from the centre of the box of the glyphs. */
    radialGradient(stops: readonly Stop[], options?: RadialGradientOptions): Look {
        return this.#with(radialGradient(stops, options));
    }

    /** An outline, 0 to 100 pixels wide: outside, inside, or centred on the edge of the glyphs. */
    stroke(size: number, of: Color, options?: StrokeOptions): Look {
        return this.#with(stroke(size, of, options));
    }

    /** A picture tiled over the glyphs from the top left corner of their box. Its pixels are copied. */
    pattern(pixels: Pixels, options?: PatternOptions): Look {
        return this.#with(pattern(pixels, options));
    }

    /** The look as plain data for `Look.from`, in a worker or at another time. Pixels are copied. */
    get state(): LookState {
        this.#check();
        return copyOf(this.#state);
    }

    /** How far the look paints beyond the glyphs, in pixels; nothing is cut off. */
    get margins(): Margins {
        return marginsBy(this.#engine, 'vorel_look_margins', this.#address);
    }

    /** The look as bytes, for a cache: the same in every process; looks of one key paint the same. */
    get key(): Uint8Array<ArrayBuffer> {
        const engine = this.#engine;
        const look = this.#address;
        return engine.scoped((scope) => {
            const length = scope.words(0);
            engine.check('vorel_look_key', look, 0, 0, length);
            const size = engine.view().getUint32(length, true);
            const key = scope.allocate(size);
            engine.check('vorel_look_key', look, key, size, length);
            return engine.bytes().slice(key, key + size);
        });
    }

    /** Whether both have the same key. */
    equals(other: Look): boolean {
        if (!(other instanceof Look)) return false;
        const [a, b] = [this.key, other.key];
        return a.length === b.length && a.every((byte, i) => byte === b[i]);
    }

    /** The calls that make it. */
    toString(): string {
        this.#check();
        return callsOf(this.#state);
    }

    /** Paints a picture of its own; see the function `paint`. */
    paint(glyphs: Glyphs): Picture;
    /** Paints onto a target; see the function `paint`. */
    paint(glyphs: Glyphs, target: PaintTarget, place?: Place): Box;
    paint(glyphs: Glyphs, target?: PaintTarget, place?: Place): Picture | Box {
        return paint(this.#engine, [this.#address], glyphs, target, place);
    }

    /** Gives back its memory; the look cannot be used any more. A second time it does nothing. */
    free(): void {
        this.#isFreed = true;
        this.#handle?.free();
    }

    /** As `free`, for `using`. */
    declare [Symbol.dispose]: () => void;

    static {
        disposeByFree(this);
    }

    /**
     * Where the look of an instance lies in its memory. Throws TypeError for what is no look, or one of another
     * instance.
     * @internal
     */
    static addressIn(engine: Engine, look: unknown): number {
        if (!(look instanceof Look)) throw new TypeError(`a look, not ${kindOf(look)}`);
        if (look.#engine !== engine) {
            throw new TypeError('a look of another instance: take Look.from(look.state)');
        }
        return look.#address;
    }

    get #address(): number {
        this.#check();
        this.#handle ??= handleOf(this.#engine, this, this.#state);
        return this.#handle.address;
    }

    #check(): void {
        if (this.#isFreed) throw freedError('look');
    }

    #with(effect: EffectState): Look {
        this.#check();
        return this.#of(added(this.#state, effect));
    }

    #changed(fields: Partial<LookState>): Look {
        this.#check();
        return this.#of(changed(this.#state, fields));
    }

    #of(state: LookState): Look {
        known.add(state);
        return new (this.constructor as new (state: LookState) => Look)(state);
    }
}

/** States that looks have made, and so need no check. */
const known = new WeakSet();

/** The class of the looks of an instance. */
export function lookClassOf(engine: Engine): LookClass {
    class LookOfInstance extends Look {
        constructor(state?: LookState) {
            super(engine, state !== undefined && known.has(state) ? state : PLAIN);
        }
        static from(given: LookState): Look {
            const state = stateOf(given);
            known.add(state);
            return new LookOfInstance(state);
        }
    }
    return Object.defineProperty(LookOfInstance, 'name', { value: 'Look' });
}

/** The margins that an export tells of a thing. */
export function marginsBy(engine: Engine, name: string, address: number): Margins {
    return engine.scoped((scope) => {
        const at = scope.words(0, 0, 0, 0);
        engine.check(name, address, at);
        return sidesAt(engine, at);
    });
}

/** Four numbers in memory: a box, or margins. */
export function sidesAt(engine: Engine, at: number): Box {
    const view = engine.view();
    const [left, top, right, bottom] = [0, 4, 8, 12].map((offset) =>
        view.getInt32(at + offset, true),
    ) as [number, number, number, number];
    return Object.freeze({ left, top, right, bottom });
}

function handleOf(engine: Engine, owner: object, state: LookState): Handle {
    return engine.scoped((scope) => {
        const look = scope.made('vorel_look_new');
        try {
            engine.check('vorel_look_fill', look, state.fill, state.fillOpacity);
            if (!state.isFilled) engine.check('vorel_look_no_fill', look);
            engine.check('vorel_look_text_opacity', look, state.textOpacity);
            for (const effect of state.effects) addEffect(scope, look, effect);
        } catch (error) {
            engine.release({ address: look, freeing: 'vorel_look_free' });
            throw error;
        }
        return engine.keep(owner, 'look', look, 'vorel_look_free');
    });
}

const POSITIONS = { centre: 0, outside: 1, inside: 2 } as const;

const SHADOWS = {
    outerShadow: 'vorel_look_outer_shadow',
    innerShadow: 'vorel_look_inner_shadow',
} as const;

const GLOWS = { outerGlow: 'vorel_look_outer_glow', innerGlow: 'vorel_look_inner_glow' } as const;

function addEffect(scope: Scope, look: number, effect: EffectState): void {
    const add = (name: string, ...given: number[]): void => {
        scope.engine.check(name, look, ...given);
    };
    const { opacity } = effect;
    switch (effect.kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const { angle, distance, size } = effect;
            return add(SHADOWS[effect.kind], angle, distance, size, effect.color, opacity);
        }
        case 'outerGlow':
        case 'innerGlow': {
            const { size, stops } = effect;
            const ramp = stopsIn(scope, stops);
            return add(GLOWS[effect.kind], size, effect.color, opacity, ramp, stops.length);
        }
        case 'linearGradient': {
            const { angle, scale, stops } = effect;
            const ramp = stopsIn(scope, stops);
            return add('vorel_look_linear_gradient', angle, scale, opacity, ramp, stops.length);
        }
        case 'radialGradient': {
            const { scale, stops } = effect;
            const ramp = stopsIn(scope, stops);
            return add('vorel_look_radial_gradient', scale, opacity, ramp, stops.length);
        }
        case 'stroke': {
            const { size, position } = effect;
            return add('vorel_look_stroke', size, effect.color, opacity, POSITIONS[position]);
        }
        case 'pattern': {
            const { data, width, height, scale } = effect;
            const pixels = scope.words(scope.copy(data), width, height, 0);
            return add('vorel_look_pattern', pixels, scale, opacity);
        }
    }
}

function stopsIn(
    scope: Scope,
    stops: readonly { color: number; opacity: number; place: number }[],
): number {
    const bytesOfOne = 12;
    const address = scope.allocate(bytesOfOne * stops.length);
    const view = scope.engine.view();
    stops.forEach((stop, i) => {
        const at = address + bytesOfOne * i;
        view.setUint32(at, stop.color, true);
        view.setFloat32(at + 4, stop.opacity, true);
        view.setFloat32(at + 8, stop.place, true);
    });
    return address;
}
