/** Words from strangers in source: comments that stay on their line, literals that stay within their quotes. */

/** What is no character of a well-formed text; a text with half of a pair cannot be written as UTF-8. */
const halves = /\p{Surrogate}/gu;

/**
 * Characters that a reader does not see or that change what he sees: controls, separators of lines, and
 * the marks, embeddings, overrides and isolates of direction.
 */
const unseen = /[\p{Cc}\u061c\u200e\u200f\u2028-\u202e\u2066-\u2069\ufeff]/gu;

/** The text with halves of pairs replaced, as whoever writes it as UTF-8 does. */
export function wellFormed(text: string): string {
    return text.replace(halves, '\ufffd');
}

/** 'U+202E' of such a character. */
function nameOf(character: string): string {
    return 'U+' + character.charCodeAt(0).toString(16).toUpperCase().padStart(4, '0');
}

/** The text in one line: controls become blanks, others that are not seen are spelled. */
export function printable(text: string): string {
    return wellFormed(text).replace(unseen, (character) =>
        character <= '\x1f' || character === '\x7f' ? ' ' : `<${nameOf(character)}>`,
    );
}

/**
 * A sentence in one line, for a comment to the end of the line. It ends with a full stop: a comment of C
 * that ended with a backslash would take the next line in.
 */
export function sentence(text: string): string {
    const line = printable(text).trim();
    return line.endsWith('.') ? line : line + '.';
}

/** The same for Java, which reads \u000a as the end of a line in comments, too, but not behind a backslash. */
export function javaSentence(text: string): string {
    return sentence(text.replaceAll('\\', '\\\\'));
}

const shortEscapes: Readonly<Record<string, string>> = { '\n': '\\n', '\t': '\\t', '\r': '\\r' };

/** A string literal of Python or JavaScript (and with double quotes of JSON) that is the very text. */
export function stringLiteral(text: string, quote: '"' | "'"): string {
    const escaped = wellFormed(text)
        .replaceAll('\\', '\\\\')
        .replaceAll(quote, '\\' + quote)
        .replace(
            unseen,
            (character) =>
                shortEscapes[character] ??
                '\\u' + character.charCodeAt(0).toString(16).padStart(4, '0'),
        );
    return quote + escaped + quote;
}

/** A word of a POSIX shell that is the very text, which has no character that is not seen but line feeds. */
export function shellWord(text: string): string {
    if (/^[\w./:=,+@%-]+$/.test(text) && !text.startsWith('-')) return text;
    return "'" + text.replaceAll("'", "'\\''") + "'";
}

/** Whether the text has characters that a terminal or a reader would not take as they are. */
export function hasUnseen(text: string): boolean {
    return text.replaceAll('\n', '').search(unseen) >= 0;
}

/** The argument of the shell's printf that prints the text: such characters by their bytes in octal digits. */
export function printfFormat(text: string): string {
    const escaped = wellFormed(text)
        .replaceAll('\\', '\\\\')
        .replaceAll('%', '%%')
        .replaceAll("'", "'\\''")
        .replace(unseen, (character) => {
            const bytes = Array.from(new TextEncoder().encode(character));
            return bytes.map((byte) => '\\' + byte.toString(8).padStart(3, '0')).join('');
        });
    return "'" + escaped + "'";
}
