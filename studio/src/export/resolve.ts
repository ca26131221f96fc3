import type { Length, LookStyle, StyleFile } from '../model/style_file';

const mostPixels = 100;
const farthestOffset = 32767;

/** To the nearest whole number, halves away from zero. */
function rounded(value: number): number {
    return Math.sign(value) * Math.round(Math.abs(value));
}

interface Measure {
    value: number;
    isShare: boolean;
}

function measureOf(length: Length): Measure {
    const value = Math.fround(typeof length === 'number' ? length : parseFloat(length));
    return { value, isShare: typeof length === 'string' && length.endsWith('%') };
}

/** The pixels of a share: of the thousandths that the file spells, to 1/65536. */
function pixelsOfShare(value: number, size: number): number {
    const pixels = (rounded(value * 1000) * size) / (1000.0 * 100.0);
    return rounded(pixels * 65536) / 65536;
}

function lengthInPixels(length: Length, size: number): number {
    const { value, isShare } = measureOf(length);
    return isShare ? Math.min(mostPixels, rounded(pixelsOfShare(value, size))) : value;
}

function offsetInPixels(length: Length | undefined, size: number): number {
    const { value, isShare } = measureOf(length ?? 0);
    const whole = rounded(isShare ? pixelsOfShare(value, size) : value);
    return Math.min(farthestOffset, Math.max(-farthestOffset, whole)) + 0;
}

/** What is drawn that wide: its pixels, and the part of its opacity that it keeps below one of them. */
function drawnInPixels(length: Length, size: number): { pixels: number; kept: number } {
    const { value, isShare } = measureOf(length);
    const pixels = isShare ? pixelsOfShare(value, size) : 0;
    if (pixels > 0 && pixels < 1) return { pixels: 1, kept: Math.fround(pixels) };
    return { pixels: lengthInPixels(length, size), kept: 1 };
}

interface Faded {
    opacity?: number;
}

/** The opacity that is left, a product of floats; an effect that is not faded keeps what it says. */
function faded(effect: Faded, kept: number): Faded {
    if (kept === 1) return {};
    return { opacity: Math.fround(Math.fround(effect.opacity ?? 1) * kept) };
}

function resolvedEffect(effect: object, size: number): object {
    const result: Record<string, unknown> = { ...effect };
    if ('width' in effect) {
        const { value, isShare } = measureOf(effect.width as Length);
        const tile = isShare ? Math.max(1, rounded(pixelsOfShare(value, size))) : value;
        return { ...result, width: tile };
    }
    if (!('size' in effect)) return result;
    // The width of what is drawn fades; of a shadow that is its distance, its size is a blur.
    const drawn = 'distance' in effect ? 'distance' : 'size';
    const { pixels, kept } = drawnInPixels(result[drawn] as Length, size);
    const blur = drawn === 'distance' ? { size: lengthInPixels(effect.size as Length, size) } : {};
    return { ...result, ...blur, [drawn]: pixels, ...faded(effect as Faded, kept) };
}

function resolvedLook(look: LookStyle, size: number): LookStyle {
    const entries = Object.entries(look).map(([key, value]: [string, unknown]) => {
        if (key === 'offset') {
            const { x, y } = look.offset ?? {};
            return [key, { x: offsetInPixels(x, size), y: offsetInPixels(y, size) }];
        }
        const isEffect = typeof value === 'object' && value !== null;
        return [key, isEffect ? resolvedEffect(value, size) : value];
    });
    return Object.fromEntries(entries) as LookStyle;
}

/**
 * The style with its lengths as numbers of pixels, for a font of `size` pixels: what docs/style-files.md
 * tells of lengths, to the last bit, for effects that are not scaled. Shares below a pixel have become one
 * of a fainter effect.
 */
export function resolved(style: StyleFile, size: number): StyleFile {
    return { ...style, looks: style.looks.map((look) => resolvedLook(look, size)) };
}
