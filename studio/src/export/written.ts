import { stringLiteral } from './words';

/** How a language writes the values of JSON. */
export interface Notation {
    quote: '"' | "'";
    indent: number;
    truth: readonly [no: string, yes: string];
    /** Whether keys that are names stand without quotes. */
    bareKeys: boolean;
    /** Whether objects have blanks within their braces. */
    isAiry: boolean;
    /** Whether a comma stands behind the last entry of what is broken into lines. */
    trails: boolean;
}

export const json: Notation = {
    quote: '"',
    indent: 2,
    truth: ['false', 'true'],
    bareKeys: false,
    isAiry: true,
    trails: false,
};
export const python: Notation = {
    quote: '"',
    indent: 4,
    truth: ['False', 'True'],
    bareKeys: false,
    isAiry: false,
    trails: true,
};
export const javaScript: Notation = {
    quote: "'",
    indent: 4,
    truth: ['false', 'true'],
    bareKeys: true,
    isAiry: true,
    trails: true,
};

const width = 100;

type Entry = readonly [key: string, value: unknown];

function keyOf(key: string, notation: Notation): string {
    const isName = notation.bareKeys && /^[A-Za-z_$][\w$]*$/.test(key) && key !== '__proto__';
    return isName ? key : stringLiteral(key, notation.quote);
}

function leaf(value: unknown, notation: Notation): string {
    if (typeof value === 'string') return stringLiteral(value, notation.quote);
    if (typeof value === 'boolean') return notation.truth[value ? 1 : 0];
    return JSON.stringify(value);
}

function joined(parts: string[], brackets: string, pad: string): string {
    const [open, close] = brackets;
    return parts.length === 0 ? brackets : `${open}${pad}${parts.join(', ')}${pad}${close}`;
}

function inOneLine(value: unknown, notation: Notation): string {
    if (Array.isArray(value)) {
        return joined(
            value.map((each) => inOneLine(each, notation)),
            '[]',
            '',
        );
    }
    if (typeof value !== 'object' || value === null) return leaf(value, notation);
    const entries = Object.entries(value).filter(([, each]) => each !== undefined);
    const parts = entries.map(
        ([key, each]) => `${keyOf(key, notation)}: ${inOneLine(each, notation)}`,
    );
    return joined(parts, '{}', notation.isAiry ? ' ' : '');
}

function inLines(value: object, notation: Notation, depth: number): string {
    const isList = Array.isArray(value);
    const margin = ' '.repeat(notation.indent * (depth + 1));
    const entries: Entry[] = Object.entries(value);
    const lines = entries
        .filter(([, each]) => each !== undefined)
        .map(([key, each]) => {
            const prefix = isList ? '' : `${keyOf(key, notation)}: `;
            const taken = margin.length + prefix.length + 1;
            return margin + prefix + written(each, notation, depth + 1, taken);
        });
    const end = notation.trails ? ',' : '';
    const [open, close] = isList ? '[]' : '{}';
    const last = ' '.repeat(notation.indent * depth);
    return `${open}\n${lines.join(',\n')}${end}\n${last}${close}`;
}

/**
 * A value of JSON as source: what fits stands in one line, the rest has a line for each entry. The order
 * of keys is kept. `depth` counts the indents of the lines, `taken` the columns before the value.
 */
export function written(value: unknown, notation: Notation, depth = 0, taken = width): string {
    const line = inOneLine(value, notation);
    const isLeaf = typeof value !== 'object' || value === null || line.length === 2;
    return isLeaf || taken + line.length <= width ? line : inLines(value, notation, depth);
}
