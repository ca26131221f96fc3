import file from '../../../style/vorelpaint-style.schema.json';
import type { EffectName } from './style_file';

/** What the studio reads of a JSON Schema. */
export interface Schema {
    $ref?: string;
    description?: string;
    type?: string | string[];
    enum?: (string | number)[];
    const?: unknown;
    default?: unknown;
    minimum?: number;
    maximum?: number;
    minLength?: number;
    pattern?: string;
    minItems?: number;
    maxItems?: number;
    items?: Schema;
    required?: string[];
    properties?: Record<string, Schema | false>;
    additionalProperties?: boolean;
    anyOf?: Schema[];
    not?: Schema;
    if?: Schema;
    then?: Schema;
}

const defs = file.$defs as unknown as Record<string, Schema>;

export type FieldKind =
    'length' | 'number' | 'integer' | 'colour' | 'choice' | 'stops' | 'image' | 'boolean' | 'text';

/** A control of a form: what it edits, within which bounds, and the sentence that explains it. */
export interface Field {
    key: string;
    kind: FieldKind;
    label: string;
    help: string;
    required: boolean;
    /** Of a length these hold for pixels. */
    min: number;
    max: number;
    /** Bounds of a length in percent. */
    percent: { min: number; max: number };
    step: number;
    default: unknown;
    choices: string[];
}

/** The definition that `$ref` names, beneath what the schema itself says. */
export function resolve(schema: Schema): Schema {
    if (!schema.$ref) return schema;
    const target = defs[refName(schema)];
    if (!target) throw new Error(`the schema has no ${schema.$ref}`);
    return { ...resolve(target), ...schema };
}

function refName(schema: Schema): string {
    return schema.$ref?.split('/').at(-1) ?? '';
}

const percentOf: Record<string, { min: number; max: number }> = {
    size: { min: 0, max: 100 },
    offset: { min: -100, max: 100 },
    tileWidth: { min: 1, max: 1000 },
};

const kindOfRef: Record<string, FieldKind> = {
    size: 'length',
    offset: 'length',
    tileWidth: 'length',
    colour: 'colour',
    stops: 'stops',
    code: 'integer',
};

function kindOf(key: string, schema: Schema, full: Schema): FieldKind {
    const byRef = kindOfRef[refName(schema)];
    if (byRef) return byRef;
    if (full.enum) return 'choice';
    if (key === 'image') return 'image';
    if (full.type === 'boolean') return 'boolean';
    if (full.type === 'integer') return 'integer';
    return full.type === 'string' ? 'text' : 'number';
}

/** 'highlightColor' as 'Highlight colour'. */
export function labelOf(key: string): string {
    const words = key
        .replace(/([A-Z])/g, ' $1')
        .toLowerCase()
        .replace('color', 'colour');
    return words.charAt(0).toUpperCase() + words.slice(1);
}

function stepOf(kind: FieldKind, min: number, max: number): number {
    if (kind === 'integer') return 1;
    return max - min <= 10 ? 0.01 : 1;
}

export function fieldOf(key: string, schema: Schema, required: boolean): Field {
    const full = resolve(schema);
    const kind = kindOf(key, schema, full);
    const min = full.minimum ?? 0;
    const max = full.maximum ?? 100;
    return {
        key,
        kind,
        label: labelOf(key),
        help: full.description ?? '',
        required,
        min,
        max,
        percent: percentOf[refName(schema)] ?? { min: 0, max: 100 },
        step: stepOf(kind, min, max),
        default: full.default,
        choices: (full.enum ?? []).map(String),
    };
}

/** The schema of a look, with its effects among its properties. */
export const lookSchema: Schema = defs['look'] ?? {};

export function effectSchema(name: EffectName): Schema {
    const schema = lookSchema.properties?.[name];
    if (!schema) throw new Error(`the schema has no effect ${name}`);
    return resolve(schema);
}

/** The fields of an effect in the schema's order. */
export function fieldsOf(name: EffectName): Field[] {
    const schema = effectSchema(name);
    return Object.entries(schema.properties ?? {}).flatMap(([key, property]) =>
        property ? [fieldOf(key, property, schema.required?.includes(key) ?? false)] : [],
    );
}

/** A field of a look that is no effect: span, textOpacity, ... */
export function lookField(key: string): Field {
    const schema = lookSchema.properties?.[key];
    if (!schema) throw new Error(`the schema has no ${key}`);
    return fieldOf(key, schema, false);
}

/** The sentence that explains an effect. */
export function helpOf(name: EffectName): string {
    const schema = lookSchema.properties?.[name];
    return schema ? (resolve(schema).description ?? '') : '';
}

/** The fields of an offset. */
export function offsetFields(): Field[] {
    const offset = lookSchema.properties?.['offset'];
    if (!offset) return [];
    return Object.entries(offset.properties ?? {}).flatMap(([key, property]) => {
        const label = key === 'x' ? 'Offset right' : 'Offset down';
        return property ? [{ ...fieldOf(key, property, false), label }] : [];
    });
}
