import type {
    EffectName,
    Glow,
    LookStyle,
    Pattern,
    Shadow,
    Span,
    Stop,
    Stroke,
} from '../model/style_file';
import type { Work } from '../model/work';
import { effectsOf, paintedEffects } from '../model/style_file';
import { sixDigits } from './numbers';
import { imagesOf } from './patterns';
import { resolved } from './resolve';

/** A colour of a ramp: 'RRGGBB', its opacity and its place, 0 to 1. */
export interface RampStop {
    color: string;
    opacity: number;
    place: number;
}

/** One call that adds an effect, its lengths in pixels, its colours as 'RRGGBB'. */
export type EffectCall =
    | {
          kind: 'outerShadow' | 'innerShadow';
          angle: number;
          distance: number;
          size: number;
          color: string;
          opacity: number;
      }
    | {
          kind: 'outerGlow' | 'innerGlow';
          size: number;
          color: string;
          opacity: number;
          stops: RampStop[];
      }
    | {
          kind: 'linearGradient';
          angle: number;
          scale: number;
          opacity: number;
          stops: RampStop[];
      }
    | { kind: 'radialGradient'; scale: number; opacity: number; stops: RampStop[] }
    | {
          kind: 'stroke';
          size: number;
          color: string;
          opacity: number;
          position: 'centre' | 'outside' | 'inside';
      }
    | { kind: 'pattern'; image: string; scale: number; opacity: number };

/** A look as the library's faces take it, and its place. */
export interface PlacedLook {
    description: string;
    /** Nothing for a look that is not filled. */
    fill?: { color: string; opacity: number };
    textOpacity: number;
    calls: EffectCall[];
    /** Effects that the library has no core for. */
    unpainted: EffectName[];
    x: number;
    y: number;
    span: Span;
}

function rampOf(stops: Stop[] | undefined): RampStop[] {
    return (stops ?? []).map(({ color, opacity = 1, location }) => ({
        color: sixDigits(color),
        opacity,
        place: location,
    }));
}

/** The next float above one that is finite and above zero. */
function nextFloat(value: number): number {
    const bits = new Uint32Array(new Float32Array([value]).buffer);
    bits[0] = (bits[0] ?? 0) + 1;
    return new Float32Array(bits.buffer)[0] ?? value;
}

/**
 * The scale at which so many columns make a tile of this width, within the library's 0.1 to 10. The
 * product is cut to whole pixels there, so a quotient that was rounded down becomes the next one.
 */
function patternScale(pattern: Pattern, columns: number): number {
    if (pattern.width === undefined) return pattern.scale ?? 1;
    if (columns === 0) return 1;
    const width = Math.fround(Number(pattern.width));
    const quotient = Math.fround(width / columns);
    const scale = Math.fround(quotient * columns) < width ? nextFloat(quotient) : quotient;
    return Math.min(10, Math.max(Math.fround(0.1), scale));
}

function shadowCall(kind: 'outerShadow' | 'innerShadow', effect: Shadow): EffectCall {
    return {
        kind,
        angle: effect.angle,
        distance: Number(effect.distance),
        size: Number(effect.size),
        color: sixDigits(effect.color),
        opacity: effect.opacity ?? 1,
    };
}

/** A glow of stops has no colour of its own. */
function glowCall(kind: 'outerGlow' | 'innerGlow', effect: Glow): EffectCall {
    const color = effect.gradient ? '000000' : sixDigits(effect.color ?? '#000');
    const stops = rampOf(effect.gradient);
    return { kind, size: Number(effect.size), color, opacity: effect.opacity ?? 1, stops };
}

function strokeCall({ size, color, opacity = 1, position }: Stroke): EffectCall {
    const where = position === 'center' ? 'centre' : position;
    const drawn = { size: Number(size), color: sixDigits(color) };
    return { kind: 'stroke', ...drawn, opacity, position: where };
}

/** The call of one effect; nothing for the fill, and for what the library has no core for. */
function callOf(look: LookStyle, name: EffectName, work: Work): EffectCall | undefined {
    const { linearGradient, radialGradient, stroke, pattern } = look;
    if (name === 'outerShadow' || name === 'innerShadow') {
        const shadow = look[name];
        return shadow && shadowCall(name, shadow);
    }
    if (name === 'outerGlow' || name === 'innerGlow') {
        const glow = look[name];
        return glow && glowCall(name, glow);
    }
    if (name === 'linearGradient' && linearGradient) {
        const { angle, scale = 1, opacity = 1, gradient } = linearGradient;
        return { kind: name, angle, scale, opacity, stops: rampOf(gradient) };
    }
    if (name === 'radialGradient' && radialGradient) {
        const { scale = 1, opacity = 1, gradient } = radialGradient;
        return { kind: name, scale, opacity, stops: rampOf(gradient) };
    }
    if (name === 'stroke' && stroke) {
        return strokeCall(stroke);
    }
    if (name === 'pattern' && pattern) {
        const { image, opacity = 1 } = pattern;
        const picture = Object.hasOwn(work.patterns, image) ? work.patterns[image] : undefined;
        const scale = patternScale(pattern, picture?.width ?? 0);
        return { kind: name, image, scale, opacity };
    }
    return undefined;
}

/** The position of the topmost look that is filled, whose opacity that of the work overrules; else -1. */
export function topFill(looks: readonly LookStyle[]): number {
    return looks.findLastIndex((look) => look.fill !== false);
}

function placed(look: LookStyle, work: Work, isTopFill: boolean): PlacedLook {
    const names = effectsOf(look);
    const color = sixDigits(look.text?.color ?? look.color ?? '#000');
    const own = isTopFill && work.opacity !== 1 ? work.opacity : look.textOpacity;
    return {
        description: look.description ?? '',
        ...(look.fill === false ? {} : { fill: { color, opacity: look.text?.opacity ?? 1 } }),
        textOpacity: own ?? 1,
        calls: names.flatMap((name) => callOf(look, name, work) ?? []),
        unpainted: names.filter((name) => !paintedEffects.includes(name)),
        x: Number(look.offset?.x ?? 0),
        y: Number(look.offset?.y ?? 0),
        span: look.span ?? 'block',
    };
}

/** The looks of the work in the order of painting: the last one lies on top. */
export function placedLooks(work: Work): PlacedLook[] {
    const { looks } = resolved(work.style, work.size);
    const top = topFill(looks);
    return looks.map((look, i) => placed(look, work, i === top));
}

/** Whether none is moved and all are of the whole block: then they are a stack of the library's own. */
export function isPlainStack(looks: readonly PlacedLook[]): boolean {
    return looks.every(({ x, y, span }) => x === 0 && y === 0 && span === 'block');
}

/** The spans of the looks beside the whole block, each once, in the format's order. */
export function spansOf(looks: readonly PlacedLook[]): Exclude<Span, 'block'>[] {
    const spans = ['line', 'word', 'glyph'] as const;
    return spans.filter((span) => looks.some((look) => look.span === span));
}

/** The names of parameters that hand over the pixels of patterns, by the names of their pictures. */
export function patternNames(work: Work): Map<string, string> {
    const images = imagesOf(work.style);
    const name = (i: number): string => (images.length === 1 ? 'pattern' : `pattern${i + 1}`);
    return new Map(images.map((image, i) => [image, name(i)]));
}

/** Of these parameters those that the look takes. */
export function patternsOf(look: PlacedLook, names: ReadonlyMap<string, string>): string[] {
    return look.calls.flatMap((call) =>
        call.kind === 'pattern' ? [names.get(call.image) ?? 'pattern'] : [],
    );
}
