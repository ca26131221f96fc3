import { useId, useLayoutEffect, useRef } from 'preact/hooks';
import { inUnit, readLength, writeLength, type Unit } from '../model/lengths';
import type { Field } from '../model/schema';
import type { Length } from '../model/style_file';

/** Controls of forms. Each calls `onChange` with every value that is within its range, while it moves. */

interface NumberProps {
    label: string;
    help?: string;
    value: number;
    min: number;
    max: number;
    step: number;
    /** The slider may span less than the field takes. */
    sliderMax?: number;
    onChange: (value: number) => void;
    unit?: preact.ComponentChildren;
}

function valueWithin(input: HTMLInputElement, min: number, max: number): number | undefined {
    const value = input.valueAsNumber;
    return value >= min && value <= max ? value : undefined;
}

function thousandths(value: number): number {
    return Math.round(value * 1000) / 1000;
}

/** A slider and a field of one number. */
export function NumberField(props: NumberProps) {
    const { label, help, value, min, max, step, sliderMax = max, onChange, unit } = props;
    const id = useId();
    const shown = thousandths(value);
    const field = useRef<HTMLInputElement>(null);
    // A number that is being written stays as it is: 1.0 may become 1.05.
    useLayoutEffect(() => {
        const input = field.current;
        if (input && thousandths(input.valueAsNumber) !== shown) input.value = String(shown);
    }, [shown]);
    const taken = (event: Event) => {
        const number = valueWithin(event.currentTarget as HTMLInputElement, min, max);
        if (number !== undefined) onChange(number);
    };
    return (
        <div class="field" title={help}>
            <label for={id}>{label}</label>
            <input
                type="range"
                aria-label={`${label}, slider`}
                min={min}
                max={sliderMax}
                step={step}
                value={value}
                onInput={taken}
            />
            <span class="field-value">
                <input
                    ref={field}
                    id={id}
                    type="number"
                    min={min}
                    max={max}
                    step="any"
                    onInput={taken}
                    // What could not be taken does not stay as if it were.
                    onBlur={(event) => (event.currentTarget.value = String(shown))}
                />
                {unit}
            </span>
        </div>
    );
}

interface LengthProps {
    field: Field;
    value: Length;
    /** Of the font, in pixels. */
    size: number;
    onChange: (value: Length) => void;
}

/** A length in pixels or in percent of the size. */
export function LengthField({ field, value, size, onChange }: LengthProps) {
    const { value: number, unit } = readLength(value);
    const { min, max } = unit === '%' ? field.percent : field;
    const turned = (event: Event) => {
        const to = (event.currentTarget as HTMLSelectElement).value as Unit;
        const length = readLength(inUnit(value, to, size));
        const range = to === '%' ? field.percent : field;
        onChange(writeLength(Math.min(range.max, Math.max(range.min, length.value)), to));
    };
    return (
        <NumberField
            label={field.label}
            help={field.help}
            value={number}
            min={min}
            max={max}
            step={unit === '%' ? 0.5 : 1}
            onChange={(to) => onChange(writeLength(to, unit))}
            unit={
                <select aria-label={`${field.label}, unit`} value={unit} onChange={turned}>
                    <option value="%">%</option>
                    <option value="px">px</option>
                </select>
            }
        />
    );
}

/** '#RGB' as the '#rrggbb' that the browser's colour input takes. */
export function longColour(colour: string): string {
    return colour.length === 4 ? colour.replace(/[0-9a-f]/gi, '$&$&') : colour;
}

interface ColourProps {
    label: string;
    help?: string;
    value: string;
    onChange: (colour: string) => void;
}

/** The browser's colour input, and the colour as it is written. */
export function ColourField({ label, help, value, onChange }: ColourProps) {
    const id = useId();
    const written = (event: Event) => {
        const text = (event.currentTarget as HTMLInputElement).value.trim();
        if (/^#([0-9a-f]{3}|[0-9a-f]{6})$/i.test(text)) onChange(text.toUpperCase());
    };
    return (
        <div class="field" title={help}>
            <label for={id}>{label}</label>
            <input
                id={id}
                type="color"
                value={longColour(value).toLowerCase()}
                onInput={(event) => onChange(event.currentTarget.value.toUpperCase())}
            />
            <span class="field-value">
                <input
                    type="text"
                    class="hex"
                    spellcheck={false}
                    aria-label={`${label}, hexadecimal`}
                    value={value}
                    onChange={written}
                />
            </span>
        </div>
    );
}

interface ChoiceProps<Value extends string> {
    label: string;
    help?: string;
    value: Value;
    choices: readonly (readonly [Value, string])[];
    onChange: (value: Value) => void;
}

export function ChoiceField<Value extends string>(props: ChoiceProps<Value>) {
    const { label, help, value, choices, onChange } = props;
    const id = useId();
    return (
        <div class="field wide" title={help}>
            <label for={id}>{label}</label>
            <select
                id={id}
                value={value}
                onChange={(event) => onChange(event.currentTarget.value as Value)}
            >
                {choices.map(([key, name]) => (
                    <option key={key} value={key}>
                        {name}
                    </option>
                ))}
            </select>
        </div>
    );
}

interface TextProps {
    label: string;
    help?: string;
    value: string;
    onChange: (text: string) => void;
}

export function TextField({ label, help, value, onChange }: TextProps) {
    const id = useId();
    return (
        <div class="field wide" title={help}>
            <label for={id}>{label}</label>
            <input
                id={id}
                type="text"
                maxLength={200}
                value={value}
                onInput={(event) => onChange(event.currentTarget.value)}
            />
        </div>
    );
}

interface CheckProps {
    label: string;
    help?: string;
    checked: boolean;
    onChange: (checked: boolean) => void;
}

export function CheckField({ label, help, checked, onChange }: CheckProps) {
    return (
        <label class="check" title={help}>
            <input
                type="checkbox"
                checked={checked}
                onChange={(event) => onChange(event.currentTarget.checked)}
            />
            {label}
        </label>
    );
}

interface FileProps {
    label: string;
    accept: string;
    onFile: (file: File) => void;
}

/** A button that opens a file. */
export function FileButton({ label, accept, onFile }: FileProps) {
    const chosen = (event: Event) => {
        const input = event.currentTarget as HTMLInputElement;
        const file = input.files?.[0];
        if (file) onFile(file);
        input.value = '';
    };
    return (
        <label class="button file">
            <input type="file" accept={accept} onChange={chosen} />
            {label}
        </label>
    );
}
