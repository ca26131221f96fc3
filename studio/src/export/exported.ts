import type { StyleFile } from '../model/style_file';
import type { PatternPixels, Work } from '../model/work';

/** A small source, ready to be copied. */
export interface Exported {
    /** Of the file to save it in. */
    name: string;
    /** Of its source, as highlighters call it: 'json', 'cpp', 'c', 'java', 'python', 'javascript', 'sh'. */
    language: string;
    text: string;
    /** What a person should know: files that lie beside it, what it leaves out. */
    note?: string;
}

/** What the style is written with as C++. */
export interface CppOptions {
    /** Of the function that is written. */
    name: string;
    /** Overrules that of the topmost look that is filled. */
    opacity?: number;
    /** The pictures of the style's patterns, by their names. */
    patterns: Readonly<Record<string, PatternPixels>>;
}

/** What exporters need of others. */
export interface ExportEngine {
    /** The style as calls of the library's classes, for a font of `size` pixels. */
    toCpp(style: StyleFile, size: number, options: CppOptions): string;
    /** What `vorelpaint --font` takes for the fonts of the work's text; without it, its font's own name. */
    fontNames?(work: Work): readonly string[];
}

/** Writes a work that check.ts has found to be one; of its words it takes any. Throws nothing of its own. */
export type Exporter = (work: Work, engine: ExportEngine) => Exported;

/** The notes as one, none where there are none. */
export function noted(...notes: (string | undefined)[]): { note?: string } {
    const said = notes.filter((note) => note !== undefined);
    return said.length === 0 ? {} : { note: said.join(' ') };
}
