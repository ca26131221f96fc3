import type { Length } from './style_file';

export type Unit = 'px' | '%';

/** A length in its parts: 4 is 4 px, '4%' is 4 percent of the size of the font. */
export function readLength(length: Length): { value: number; unit: Unit } {
    if (typeof length === 'number') return { value: length, unit: 'px' };
    const unit = length.endsWith('%') ? '%' : 'px';
    const value = Number.parseFloat(length);
    return { value: Number.isFinite(value) ? value : 0, unit };
}

/** As the format writes it: at most three digits behind the point. */
export function writeLength(value: number, unit: Unit): Length {
    const rounded = Math.round(value * 1000) / 1000 + 0;
    return unit === 'px' ? rounded : `${rounded}%`;
}

/** The same length on text of `size` pixels in the other unit. */
export function inUnit(length: Length, unit: Unit, size: number): Length {
    const from = readLength(length);
    if (from.unit === unit) return length;
    const value = unit === '%' ? (from.value * 100) / size : (from.value * size) / 100;
    return writeLength(Math.round(value * 10) / 10, unit);
}
