import { lookSchema, resolve, type Schema } from './schema';
import { effectsOf, type LookStyle, type Stop, type StyleFile } from './style_file';
import type { Align, PatternPixels, Work } from './work';

/**
 * What comes from outside (a link, a file, the clipboard) is a value of any kind. It becomes a Work or a
 * style here or is refused, with the path of what is wrong.
 */

/** `path` as 'looks[1].stroke.size'; empty for the whole. */
export class CheckError extends Error {
    constructor(
        readonly path: string,
        reason: string,
    ) {
        super(path ? `${path}: ${reason}` : reason);
        this.name = 'CheckError';
    }
}

export const limits = {
    text: 5000,
    size: { min: 1, max: 1000 },
    lineHeight: { min: 0.5, max: 10 },
    padding: { min: 0, max: 1000 },
    /** To either side, in pixels or percent. */
    letterSpacing: 200,
    /** Side of a pattern in pixels, and how many a work may have. */
    patternSide: 1024,
    patterns: 8,
    styleBytes: 128 * 1024,
};

type Plain = Record<string, unknown>;

function isPlain(value: unknown): value is Plain {
    return typeof value === 'object' && value !== null && !Array.isArray(value);
}

function typeOf(value: unknown): string {
    if (value === null) return 'null';
    if (Array.isArray(value)) return 'array';
    if (typeof value === 'number' && Number.isInteger(value)) return 'integer';
    return typeof value;
}

const inWords: Record<string, string> = {
    array: 'a list',
    object: 'an object',
    number: 'a number',
    integer: 'a whole number',
    string: 'a string',
    boolean: 'true or false',
};

function checkType(value: unknown, types: string[], path: string): void {
    const type = typeOf(value);
    if (types.includes(type) || (type === 'integer' && types.includes('number'))) return;
    throw new CheckError(
        path,
        `must be ${types.map((name) => inWords[name] ?? name).join(' or ')}`,
    );
}

function matches(value: unknown, schema: Schema): boolean {
    try {
        checkSchema(value, schema, '');
        return true;
    } catch {
        return false;
    }
}

function checkNumber(value: number, schema: Schema, path: string): void {
    const { minimum = -Infinity, maximum = Infinity } = schema;
    if (!(value >= minimum && value <= maximum)) {
        throw new CheckError(path, `${value} is out of range, ${minimum} to ${maximum}`);
    }
}

function checkString(value: string, schema: Schema, path: string): void {
    if (value.length < (schema.minLength ?? 0)) throw new CheckError(path, 'is empty');
    if (schema.pattern && !new RegExp(schema.pattern, 'u').test(value)) {
        throw new CheckError(path, `'${value.slice(0, 40)}' is no ${what(schema)}`);
    }
}

function what(schema: Schema): string {
    return schema.pattern?.startsWith('^#(')
        ? 'colour, such as "#FF8800"'
        : 'length within its range';
}

function checkList(list: unknown[], schema: Schema, path: string): void {
    const { minItems = 0, maxItems = Infinity, items } = schema;
    if (list.length < minItems || list.length > maxItems) {
        throw new CheckError(
            path,
            `has ${list.length} entries; ${minItems} to ${maxItems} may stand here`,
        );
    }
    if (items) list.forEach((item, at) => checkSchema(item, items, `${path}[${at}]`));
}

function checkKeys(object: Plain, schema: Schema, path: string, closed: boolean): void {
    const properties = schema.properties ?? {};
    for (const [key, value] of Object.entries(object)) {
        const property = Object.hasOwn(properties, key) ? properties[key] : undefined;
        const at = path ? `${path}.${key}` : key;
        if (property === false) throw new CheckError(at, 'must not stand here');
        if (property) checkSchema(value, property, at);
        else if (closed) throw new CheckError(at, 'unknown key');
    }
    for (const key of schema.required ?? []) {
        if (!Object.hasOwn(object, key)) throw new CheckError(path, `${key} is missing`);
    }
}

function checkRules(value: unknown, schema: Schema, path: string): void {
    if (schema.anyOf && !schema.anyOf.some((rule) => matches(value, rule))) {
        const keys = schema.anyOf.flatMap((rule) => rule.required ?? []);
        throw new CheckError(path, `${keys.join(' or ')} is missing`);
    }
    if (schema.not && matches(value, schema.not)) {
        throw new CheckError(
            path,
            `${(schema.not.required ?? []).join(' and ')} exclude one another`,
        );
    }
    if (schema.if && schema.then && matches(value, schema.if))
        checkSchema(value, schema.then, path);
}

/** Throws a CheckError where the value is not as the schema says. */
export function checkSchema(value: unknown, given: Schema, path: string, closed = false): void {
    const schema = resolve(given);
    if (schema.type) checkType(value, [schema.type].flat(), path);
    if (schema.enum && !schema.enum.some((choice) => choice === value)) {
        throw new CheckError(path, `must be ${schema.enum.join(', ')}`);
    }
    if ('const' in schema && schema.const !== value) throw new CheckError(path, 'is another value');
    if (typeof value === 'number') checkNumber(value, schema, path);
    if (typeof value === 'string') checkString(value, schema, path);
    if (Array.isArray(value)) checkList(value, schema, path);
    if (isPlain(value))
        checkKeys(value, schema, path, closed || schema.additionalProperties === false);
    checkRules(value, schema, path);
}

function checkStops(stops: Stop[], path: string): void {
    stops.forEach((stop, at) => {
        const before = stops[at - 1];
        if (before && stop.location < before.location) {
            const reason = 'lies before the stop that precedes it';
            throw new CheckError(`${path}.gradient[${at}].location`, reason);
        }
    });
}

function checkStopOrder(look: LookStyle, path: string): void {
    for (const name of effectsOf(look)) {
        const effect = look[name] as { gradient?: Stop[] };
        if (effect.gradient) checkStops(effect.gradient, path ? `${path}.${name}` : name);
    }
}

/**
 * The value as a style of version 2 with a list of looks; one look alone, also of version 1, becomes a list.
 * Throws a CheckError.
 */
export function asStyle(value: unknown): StyleFile {
    if (!isPlain(value)) throw new CheckError('', 'a style is an object in braces');
    const { $schema, version = 1, description, ...rest } = value;
    if (version !== 1 && version !== 2) throw new CheckError('version', 'must be 1 or 2');
    if (description !== undefined) checkType(description, ['string'], 'description');
    if ($schema !== undefined) checkType($schema, ['string'], '$schema');
    const listed = 'looks' in rest;
    const looks = listed ? rest['looks'] : [rest];
    if (listed && Object.keys(rest).length > 1) {
        throw new CheckError('', 'beside looks stand only $schema, version and description');
    }
    checkType(looks, ['array'], 'looks');
    checkList(looks as unknown[], { minItems: 1, maxItems: 32 }, 'looks');
    (looks as unknown[]).forEach((look, at) => {
        const path = listed ? `looks[${at}]` : '';
        checkSchema(look, lookSchema, path, true);
        checkStopOrder(look as LookStyle, path);
    });
    const style = { version: 2 as const, looks: looks as StyleFile['looks'] };
    return description === undefined ? style : { ...style, description: description as string };
}

/** Reads the text of a style file. Throws a CheckError. */
export function readStyle(text: string): StyleFile {
    if (text.length > limits.styleBytes) throw new CheckError('', 'more than 128 KiB of style');
    return asStyle(parse(text));
}

function parse(text: string): unknown {
    try {
        return JSON.parse(text);
    } catch (error) {
        throw new CheckError('', `no JSON: ${(error as Error).message}`);
    }
}

function checkPattern(value: unknown, path: string): PatternPixels {
    if (!isPlain(value)) throw new CheckError(path, 'must be an object');
    const { width, height, data } = value;
    for (const side of [width, height]) {
        checkSchema(side, { type: 'integer', minimum: 1, maximum: limits.patternSide }, path);
    }
    const bytes = (width as number) * (height as number) * 4;
    const length = Math.ceil(bytes / 3) * 4;
    if (
        typeof data !== 'string' ||
        data.length !== length ||
        !/^[A-Za-z0-9+/]*={0,2}$/.test(data)
    ) {
        throw new CheckError(path, 'has not the pixels of its width and height');
    }
    return { width: width as number, height: height as number, data };
}

function checkPatterns(value: unknown): Record<string, PatternPixels> {
    if (!isPlain(value)) throw new CheckError('patterns', 'must be an object');
    const entries = Object.entries(value);
    if (entries.length > limits.patterns) {
        throw new CheckError('patterns', `more than ${limits.patterns} patterns`);
    }
    return Object.fromEntries(
        entries.map(([name, pixels]) => [name, checkPattern(pixels, `patterns.${name}`)]),
    );
}

const workSchema: Schema = {
    type: 'object',
    additionalProperties: false,
    required: [
        'text',
        'markup',
        'font',
        'size',
        'align',
        'lineHeight',
        'letterSpacing',
        'style',
        'patterns',
        'opacity',
        'padding',
        'background',
    ],
    properties: {
        text: { type: 'string' },
        markup: { type: 'boolean' },
        font: { type: 'string', minLength: 1 },
        size: { type: 'integer', minimum: limits.size.min, maximum: limits.size.max },
        align: { enum: ['left', 'center', 'right', 'start', 'end'] satisfies Align[] },
        lineHeight: {
            type: 'number',
            minimum: limits.lineHeight.min,
            maximum: limits.lineHeight.max,
        },
        letterSpacing: { type: 'string', pattern: '^-?[0-9]{1,4}(\\.[0-9]{1,3})?%?$' },
        style: { type: 'object' },
        patterns: { type: 'object' },
        opacity: { type: 'number', minimum: 0, maximum: 1 },
        padding: { type: 'integer', minimum: limits.padding.min, maximum: limits.padding.max },
        background: {
            type: 'string',
            pattern: '^(transparent|checkerboard|picture|#[0-9A-Fa-f]{6})$',
        },
    },
};

/** The value as a Work. Throws a CheckError. */
export function asWork(value: unknown): Work {
    checkSchema(value, workSchema, '');
    const work = value as Work;
    if (work.text.length > limits.text) {
        throw new CheckError('text', `more than ${limits.text} characters`);
    }
    const spacing = Number.parseFloat(work.letterSpacing);
    if (Math.abs(spacing) > limits.letterSpacing) {
        throw new CheckError('letterSpacing', `${spacing} is out of range, -200 to 200`);
    }
    return { ...work, style: asStyle(work.style), patterns: checkPatterns(work.patterns) };
}
