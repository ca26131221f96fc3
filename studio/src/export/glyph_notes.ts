import type { Work } from '../model/work';
import { patternFiles } from './patterns';
import type { PlacedLook } from './looks';
import { patternNames, spansOf } from './looks';

/** What the faces that paint masks take for granted, for the person who exports. */
export function glyphNotes(work: Work, looks: readonly PlacedLook[]): string[] {
    const notes = [`Lengths are in pixels, for text of ${work.size} pixels.`];
    notes.push('The glyphs are those of your own text layout.');
    const spans = spansOf(looks).map((span) => `${span}s`);
    if (spans.length > 0)
        notes.push(`It takes a list of glyphs for each of the ${spans.join(', ')}.`);
    const files = [...patternFiles(work.style).values()];
    if (files.length > 0) notes.push(`It takes the pixels of ${files.join(', ')}.`);
    if (work.markup) notes.push('Colours of words are left out.');
    return notes;
}

/**
 * The comment that a source begins with, lines of '// ': what it shows, the size that its lengths are for,
 * and which picture each parameter of a pattern has the pixels of, straight, in their order `pixels`. `say`
 * makes a sentence of words from strangers.
 */
export function headerLines(work: Work, pixels: string, say: (text: string) => string): string {
    const files = patternFiles(work.style);
    const said = work.style.description ?? '';
    const lines = [
        ...(said === '' ? [] : [say(said)]),
        `Lengths are in pixels, for text of ${work.size} pixels.`,
        ...[...patternNames(work)].map(
            ([image, name]) =>
                `${name}: the pixels of ${files.get(image) ?? ''}, straight ${pixels}.`,
        ),
    ];
    return lines.map((line) => `// ${line}\n`).join('');
}

/** For comments: a line of each effect that the library has no core for. */
export function unpaintedComments(look: PlacedLook): string[] {
    return look.unpainted.map((effect) => `${effect}: the library has no core for it.`);
}

/** The parts of a list in a line, if that fits behind `taken` columns of `width`, else in a line for each. */
export function inLines(parts: readonly string[], taken: number, width = 105): string {
    const line = parts.join(', ');
    return taken + line.length <= width ? line : parts.join(`,\n${' '.repeat(taken)}`);
}

/** A coordinate, moved: 'x + 3'. */
export function moved(coordinate: string, by: number): string {
    return by === 0 ? coordinate : `${coordinate} ${by < 0 ? '-' : '+'} ${Math.abs(by)}`;
}
