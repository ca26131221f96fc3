import type { ExportEngine } from './exported';
import type { Work } from '../model/work';

/** What of a work is told to whoever sets and paints its text, where it is not the usual. */
export interface TextOptions {
    align?: string;
    lineHeight?: number;
    /** A number of pixels, or a string such as '5%'. */
    letterSpacing?: number | string;
    markup?: true;
    padding?: number;
    background?: string;
}

/** The options that are not what they are without being told. */
export function textOptions(work: Work): TextOptions {
    const spacing = work.letterSpacing;
    const isPixels = /^-?\d+(\.\d+)?$/.test(spacing);
    const isNone = /^-?0*(\.0*)?(px|%)?$/.test(spacing);
    return {
        ...(work.align === 'left' ? {} : { align: work.align }),
        ...(work.lineHeight === 1 ? {} : { lineHeight: work.lineHeight }),
        ...(isNone ? {} : { letterSpacing: isPixels ? Number(spacing) : spacing }),
        ...(work.markup ? { markup: true as const } : {}),
        ...(work.padding === 8 ? {} : { padding: work.padding }),
        ...(work.background.startsWith('#') ? { background: work.background } : {}),
    };
}

/** What --font and the package of Python take for the fonts of the work: each has what those before it lack. */
export function fontNames(work: Work, engine: ExportEngine): readonly string[] {
    return engine.fontNames?.(work) ?? [work.font];
}
