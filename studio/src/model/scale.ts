import { readLength, writeLength } from './lengths';
import type { Length, LookStyle, StyleFile } from './style_file';
import type { Work } from './work';

/**
 * A work as large again: size, padding and every length in pixels, so that it is painted anew instead of
 * stretched. Percent follow the size by themselves.
 */

/** The longest length of an effect in pixels, of an offset and of a tile. */
const most = { effect: 100, offset: 1000, tile: 1000 };

function scaled(length: Length, factor: number, limit: number): Length {
    const { value, unit } = readLength(length);
    if (unit === '%') return length;
    return writeLength(Math.max(-limit, Math.min(limit, value * factor)), 'px');
}

const lengthKeys = new Set(['size', 'distance']);

function scaledEffect(effect: object, factor: number): object {
    return Object.fromEntries(
        Object.entries(effect).map(([key, value]) => [
            key,
            lengthKeys.has(key) ? scaled(value as Length, factor, most.effect) : (value as unknown),
        ]),
    );
}

function scaledPattern(pattern: NonNullable<LookStyle['pattern']>, factor: number) {
    if (pattern.width !== undefined) {
        return { ...pattern, width: scaled(pattern.width, factor, most.tile) };
    }
    return { ...pattern, scale: Math.min(10, (pattern.scale ?? 1) * factor) };
}

function scaledLook(look: LookStyle, factor: number): LookStyle {
    const entries = Object.entries(look).map(([key, value]: [string, unknown]) => {
        if (key === 'pattern') return [key, scaledPattern(value as never, factor)];
        if (key === 'offset') return [key, scaledOffset(value as never, factor)];
        if (typeof value === 'object' && value) return [key, scaledEffect(value, factor)];
        return [key, value];
    });
    return Object.fromEntries(entries) as LookStyle;
}

function scaledOffset(offset: NonNullable<LookStyle['offset']>, factor: number) {
    return Object.fromEntries(
        Object.entries(offset).map(([key, value]) => [key, scaled(value, factor, most.offset)]),
    );
}

export function scaledStyle(style: StyleFile, factor: number): StyleFile {
    return { ...style, looks: style.looks.map((look) => scaledLook(look, factor)) };
}

/** The work at `factor` times its size; text beyond 1000 pixels is not painted, so the size stays within. */
export function scaledWork(work: Work, factor: number): Work {
    const { value, unit } = readLength(work.letterSpacing);
    const inPixels = !work.letterSpacing.endsWith('%');
    return {
        ...work,
        size: Math.round(work.size * factor),
        padding: Math.round(work.padding * factor),
        letterSpacing: inPixels && unit === 'px' ? String(value * factor) : work.letterSpacing,
        style: scaledStyle(work.style, factor),
    };
}
