import { noted } from './exported';
import type { Exported } from './exported';
import type { Work } from '../model/work';
import { patternNote, withPatternFiles } from './patterns';
import { json, written } from './written';

/** The style file's name, as the other exports ask for it. */
export const styleName = 'title.json';

/** The style file itself; its patterns are named as the PNG files beside it. */
export function style(work: Work): Exported {
    const text = written(withPatternFiles(work.style), json) + '\n';
    const faded =
        work.opacity === 1
            ? undefined
            : `The opacity of the text, ${work.opacity}, is no part of a style: give it by --opacity.`;
    return { name: styleName, language: 'json', text, ...noted(patternNote(work.style), faded) };
}
