import { fromBase64, toBase64 } from './base64';
import { asWork, CheckError } from './check';
import type { Work } from './work';

/**
 * A work as the fragment of an address: '1.' and the base64url of its deflated JSON. The number is the
 * version of this form, so that a later one can tell.
 */

const version = '1.';

type Bytes = CompressionStream | DecompressionStream;

/** Characters that a link may have; browsers and mail programs cut longer ones. */
export const maxLink = 32_000;
/** Bytes of JSON that a link may hold: a pattern of the largest side is within them. */
const maxJson = 8 * 1024 * 1024;

async function through(bytes: BlobPart, stream: Bytes, limit: number): Promise<Uint8Array> {
    const reader = (
        new Blob([bytes]).stream().pipeThrough(stream) as ReadableStream<Uint8Array>
    ).getReader();
    const parts: Uint8Array[] = [];
    let length = 0;
    for (;;) {
        const { done, value } = await reader.read();
        if (done) break;
        length += value.length;
        if (length > limit) {
            await reader.cancel();
            throw new CheckError('', 'the link holds more than a work can have');
        }
        parts.push(value);
    }
    return joined(parts, length);
}

function joined(parts: Uint8Array[], length: number): Uint8Array {
    const all = new Uint8Array(length);
    let at = 0;
    for (const part of parts) {
        all.set(part, at);
        at += part.length;
    }
    return all;
}

/** The fragment without '#'. Throws a CheckError where it would be longer than `maxLink`. */
export async function writeLink(work: Work): Promise<string> {
    const packed = await through(
        JSON.stringify(work),
        new CompressionStream('deflate-raw'),
        Infinity,
    );
    const code = toBase64(packed).replace(/\+/g, '-').replace(/\//g, '_').replace(/=+$/, '');
    const link = version + code;
    if (link.length > maxLink) {
        throw new CheckError(
            '',
            `the link would have ${link.length} characters, more than ${maxLink}; download the work instead`,
        );
    }
    return link;
}

/** Reads what `writeLink` gave. Whatever else it is given, it throws a CheckError. */
export async function readLink(fragment: string): Promise<Work> {
    const text = fragment.replace(/^#/, '');
    if (!text.startsWith(version)) {
        throw new CheckError('', 'the link is of another version of the studio, or not complete');
    }
    if (text.length > maxLink)
        throw new CheckError('', `the link has more than ${maxLink} characters`);
    return asWork(JSON.parse(await unpacked(text.slice(version.length))));
}

async function unpacked(code: string): Promise<string> {
    try {
        const bytes = fromBase64(code.replace(/-/g, '+').replace(/_/g, '/'));
        const stream = new DecompressionStream('deflate-raw');
        const json = await through(bytes, stream, maxJson);
        const text = new TextDecoder('utf-8', { fatal: true }).decode(json);
        JSON.parse(text);
        return text;
    } catch (error) {
        if (error instanceof CheckError) throw error;
        throw new CheckError('', 'the link is damaged or not complete');
    }
}
