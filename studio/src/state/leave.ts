import { signal } from '@preact/signals';
import type { Code } from '../engine/messages';
import { patternPictures, styleFile } from '../export';
import { asWork, CheckError, readStyle } from '../model/check';
import { writeLink } from '../model/permalink';
import { notice, settle } from './notices';
import { engine } from './painting';
import { withStyleAndPatterns } from './patterns';
import { announce, replaceWork, work } from './store';

/** How a work leaves the page, and how one comes in. */

/** A file name of the first words of the text. */
export function fileName(ending: string): string {
    const words = work.value.text.trim().split(/\s+/).slice(0, 4).join('-');
    const plain = words.replace(/[^\p{L}\p{N}-]/gu, '').slice(0, 40);
    return `${plain || 'text'}${ending}`;
}

export function download(name: string, content: BlobPart, type: string): void {
    const address = URL.createObjectURL(new Blob([content], { type }));
    const link = document.createElement('a');
    link.href = address;
    link.download = name;
    link.click();
    setTimeout(() => URL.revokeObjectURL(address), 10_000);
}

/** Whether pictures are saved with the colour behind the text. */
export const onGround = signal(false);

/** The picture painted anew at a multiple of its size. */
export async function savePng(scale: number): Promise<void> {
    try {
        const result = await engine?.call('png', {
            work: work.value,
            scale,
            onGround: onGround.value,
        });
        if (!result) return;
        download(fileName(scale > 1 ? `@${scale}x.png` : '.png'), result.bytes, 'image/png');
        settle('png');
        if (result.notes.length > 0) notice('info', 'png', result.notes.join(' '));
        announce('PNG saved');
    } catch (error) {
        notice('error', 'png', `No PNG: ${(error as Error).message}`);
    }
}

/** The style file, by the name that commands and programs ask for. */
export function saveStyle(): void {
    const { name, text } = styleFile(work.value);
    download(name, text, 'application/json');
}

/** The pictures of patterns, which lie beside a style file or a program. */
export async function savePatterns(): Promise<void> {
    for (const { name, bytes } of await patternPictures(work.value)) {
        download(name, new Uint8Array(bytes), 'image/png');
    }
}

/** Copies and says so. */
export async function copy(text: string, what: string): Promise<void> {
    try {
        await navigator.clipboard.writeText(text);
        notice('info', 'copy', `${what} copied.`);
    } catch {
        notice('error', 'copy', `${what} could not be copied: the browser does not allow it here.`);
    }
}

export function styleText(): string {
    return JSON.stringify(work.value.style, null, 2) + '\n';
}

export async function copyLink(): Promise<void> {
    try {
        const address = new URL(location.href);
        address.hash = await writeLink(work.value);
        await copy(address.href, `Link of ${address.href.length} characters`);
    } catch (error) {
        notice('error', 'copy', (error as Error).message);
    }
}

/** Takes the text of a style file as the style of the work. Resolves to why not, or to an empty text. */
export async function takeStyle(text: string): Promise<string> {
    try {
        const taken = await withStyleAndPatterns(work.value, readStyle(text));
        await engine?.call('style', { style: taken.style, patterns: taken.patterns });
        replaceWork(taken);
        announce('Style taken');
        return '';
    } catch (error) {
        return (error as Error).message;
    }
}

/** Opens a style file, or a whole work that was saved. */
export async function openJson(file: File): Promise<void> {
    const wrong =
        file.size > maxFile ? 'it has more than 64 MiB' : await takeJson(await file.text());
    if (wrong) notice('error', 'file', `${file.name}: ${wrong}`);
    else settle('file');
}

const maxFile = 64 * 1024 * 1024;

/** Why the text could not be taken, or an empty text. */
async function takeJson(text: string): Promise<string> {
    const whole = readWork(text);
    if (whole instanceof CheckError) return whole.message;
    if (!whole) return takeStyle(text);
    replaceWork(whole);
    return '';
}

/** The work that the text is, what is wrong with it, or nothing where it is a style. */
function readWork(text: string) {
    try {
        const value = JSON.parse(text) as unknown;
        const isWork =
            typeof value === 'object' && value !== null && 'style' in value && 'font' in value;
        return isWork ? asWork(value) : undefined;
    } catch (error) {
        return error instanceof CheckError ? error : undefined;
    }
}

/** The work in other languages, or why there is none. */
export const codes = signal<Code[]>([]);
export const codeError = signal('');

export async function writeCodes(): Promise<void> {
    try {
        codes.value = (await engine?.newest('exports', { work: work.value })) ?? [];
        codeError.value = '';
    } catch (error) {
        codeError.value = (error as Error).message;
    }
}
