import { noted } from './exported';
import type { CppOptions, Exporter } from './exported';
import { imagesOf } from './patterns';
import type { Work } from '../model/work';
import { printable } from './words';

const mostPatternPixels = 1 << 16;

/** The first pattern whose picture is missing, or too large to stand in a source; nothing when none is. */
function patternFault(work: Work): string | undefined {
    for (const image of imagesOf(work.style)) {
        const picture = Object.hasOwn(work.patterns, image) ? work.patterns[image] : undefined;
        const name = `The pattern '${printable(image)}'`;
        if (!picture) return `${name} has no picture.`;
        if (picture.width * picture.height > mostPatternPixels) {
            return `${name} has more than ${mostPatternPixels} pixels, too many to be written as C++.`;
        }
    }
    return undefined;
}

/** Calls of the classes of VFEffect.h, with the pixels of patterns. */
export const cppClasses: Exporter = (work, engine) => {
    const fault = patternFault(work);
    const options: CppOptions = {
        name: 'addTitle',
        patterns: work.patterns,
        ...(work.opacity === 1 ? {} : { opacity: work.opacity }),
    };
    const text = fault ? `// ${fault}\n` : engine.toCpp(work.style, work.size, options);
    const size = `Lengths are in pixels, for text of ${work.size} pixels.`;
    const markup = work.markup ? 'Colours of words are left out.' : undefined;
    return { name: 'title_classes.cpp', language: 'cpp', text, ...noted(fault ?? size, markup) };
};
