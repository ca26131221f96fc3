import type { StyleFile } from '../model/style_file';
import type { Work } from '../model/work';
import { png } from './png';

/** The names under which the style asks for pictures, in their order, each once. */
export function imagesOf(style: StyleFile): string[] {
    const names = style.looks.flatMap((look) => (look.pattern ? [look.pattern.image] : []));
    return [...new Set(names)];
}

/** A plain file name: the last part of the path, without characters that mean something to a shell. */
function plainName(image: string): string {
    const last = image.split(/[/\\]/).at(-1) ?? '';
    const stem = last
        .replace(/\.png$/i, '')
        .replace(/[^A-Za-z0-9_.-]+/g, '-')
        .replace(/^[-.]+|[-.]+$/g, '')
        .slice(0, 60);
    return stem || 'pattern';
}

/** The PNG files that lie beside what is exported, by the names under which the style asks for them. */
export function patternFiles(style: StyleFile): Map<string, string> {
    const files = new Map<string, string>();
    const taken = new Set<string>();
    for (const image of imagesOf(style)) {
        const stem = plainName(image);
        let file = `${stem}.png`;
        for (let i = 2; taken.has(file.toLowerCase()); ++i) file = `${stem}-${i}.png`;
        taken.add(file.toLowerCase());
        files.set(image, file);
    }
    return files;
}

/** The style with its patterns named as the files are. */
export function withPatternFiles(style: StyleFile): StyleFile {
    const files = patternFiles(style);
    const looks = style.looks.map((look) => {
        if (!look.pattern) return look;
        const image = files.get(look.pattern.image) ?? look.pattern.image;
        return { ...look, pattern: { ...look.pattern, image } };
    });
    return { ...style, looks };
}

/** The files themselves. A pattern whose picture the work has not is left out. */
export async function patternPictures(work: Work): Promise<{ name: string; bytes: Uint8Array }[]> {
    const pictures: { name: string; bytes: Uint8Array }[] = [];
    for (const [image, name] of patternFiles(work.style)) {
        const pattern = Object.hasOwn(work.patterns, image) ? work.patterns[image] : undefined;
        if (!pattern) continue;
        const data = Uint8ClampedArray.from(atob(pattern.data), (byte) => byte.charCodeAt(0));
        pictures.push({ name, bytes: await png(data, pattern.width, pattern.height) });
    }
    return pictures;
}

/** What a person is told of the files beside an export; nothing when there are none. */
export function patternNote(style: StyleFile): string | undefined {
    const files = [...patternFiles(style).values()];
    if (files.length === 0) return undefined;
    return `${files.join(', ')} must lie beside it.`;
}
