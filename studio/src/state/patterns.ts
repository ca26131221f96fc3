import chalk from '../../../style/presets/chalk.png?url';
import halftone from '../../../style/presets/halftone.png?url';
import spray from '../../../style/presets/spray.png?url';
import stripes from '../../../style/presets/stripes.png?url';
import tiles from '../../../style/presets/tiles.png?url';
import { imagesOf } from '../export/patterns';
import { limits } from '../model/check';
import type { StyleFile } from '../model/style_file';
import type { PatternPixels, Work } from '../model/work';
import { engine } from './painting';

/** Pictures of patterns: those that lie beside the page, and the person's own. */

const shipped: Record<string, string> = {
    'chalk.png': chalk,
    'halftone.png': halftone,
    'spray.png': spray,
    'stripes.png': stripes,
    'tiles.png': tiles,
};

export const shippedPatterns: readonly string[] = Object.keys(shipped);

const tooMany = `a work has at most ${limits.patterns} patterns`;

const read = new Map<string, Promise<PatternPixels>>();

function decoded(name: string, bytes: ArrayBuffer): Promise<PatternPixels> {
    if (!engine) return Promise.reject(new Error('nothing can be painted here'));
    return engine.call('pattern', { name, bytes: new Uint8Array(bytes) });
}

async function fetched(name: string): Promise<PatternPixels> {
    const response = await fetch(shipped[name] ?? '');
    if (!response.ok) throw new Error(`the pattern ${name} could not be loaded`);
    return decoded(name, await response.arrayBuffer());
}

/** The pixels of a pattern that lies beside the page. Rejects where there is none of the name. */
export function shippedPattern(name: string): Promise<PatternPixels> {
    if (!Object.hasOwn(shipped, name)) {
        return Promise.reject(
            new Error(`the picture '${name}' of a pattern is not here; open its file`),
        );
    }
    const known = read.get(name) ?? fetched(name);
    read.set(name, known);
    known.catch(() => read.delete(name));
    return known;
}

/** Reads a file as a pattern. Rejects with a sentence for the reader. */
export async function ownPattern(file: File): Promise<PatternPixels> {
    if (file.size > 16 * 1024 * 1024) throw new Error(`${file.name} has more than 16 MiB`);
    try {
        return await decoded(file.name, await file.arrayBuffer());
    } catch (error) {
        throw new Error(`${file.name}: ${(error as Error).message}`, { cause: error });
    }
}

/** The pictures that a style asks for, from those given or from beside the page. Rejects where one is missing. */
export async function patternsFor(
    style: StyleFile,
    given: Record<string, PatternPixels>,
): Promise<Record<string, PatternPixels>> {
    const names = imagesOf(style);
    if (names.length > limits.patterns) {
        throw new Error(tooMany);
    }
    const pixels = await Promise.all(
        names.map((name) => {
            const known = Object.hasOwn(given, name) ? given[name] : undefined;
            return known ? Promise.resolve(known) : shippedPattern(name);
        }),
    );
    return Object.fromEntries(names.map((name, at) => [name, pixels[at] as PatternPixels]));
}

/** The work with another style and the pictures that it needs. */
export async function withStyleAndPatterns(work: Work, style: StyleFile): Promise<Work> {
    return { ...work, style, patterns: await patternsFor(style, work.patterns) };
}

/**
 * The work with the pixels of a pattern. Where it has too many, those go that no look asks for; throws a sentence
 * for the reader where all are asked for.
 */
export function withPattern(work: Work, name: string, pixels: PatternPixels): Work {
    const used = imagesOf(work.style);
    if (used.length > limits.patterns) throw new Error(tooMany);
    const all = Object.entries({ ...work.patterns, [name]: pixels });
    const kept = all.length > limits.patterns ? all.filter(([image]) => used.includes(image)) : all;
    return { ...work, patterns: Object.fromEntries(kept) };
}
