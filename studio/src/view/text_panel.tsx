import { useRef } from 'preact/hooks';
import { shippedFonts } from '../engine/fonts';
import { limits } from '../model/check';
import type { Field } from '../model/schema';
import { firstWork, type Align, type Work } from '../model/work';
import { notice } from '../state/notices';
import { addFont, failure, forgetFont, ownFonts, picture } from '../state/painting';
import { edit, work } from '../state/store';
import { CheckField, ChoiceField, FileButton, LengthField, NumberField } from './fields';

/** The text, its font, and how it is set. */
export function TextPanel() {
    const now = work.value;
    const set = <Key extends keyof Work>(key: Key, value: Work[Key]) =>
        edit((before) => ({ ...before, [key]: value }), key);
    const composes = useRef(false);
    // A word that an input method composes is one step to undo, however long it takes.
    const write = (event: InputEvent & { currentTarget: HTMLTextAreaElement }) => {
        const text = event.currentTarget.value;
        edit((before) => ({ ...before, text }), 'text', composes.current);
        composes.current = event.isComposing;
    };
    return (
        <div class="form">
            <label class="label" for="text">
                Text
            </label>
            <textarea
                id="text"
                rows={3}
                dir="auto"
                maxLength={limits.text}
                spellcheck={false}
                aria-describedby="text-notes"
                value={now.text}
                onInput={write}
                onCompositionEnd={() => (composes.current = false)}
            />
            <TextNotes />
            <FontField font={now.font} onChange={(font) => set('font', font)} />
            <NumberField
                label="Size"
                help="Of the font, in pixels"
                value={now.size}
                min={limits.size.min}
                max={limits.size.max}
                sliderMax={300}
                step={1}
                onChange={(size) => set('size', Math.round(size))}
            />
            <AlignField align={now.align} onChange={(align) => set('align', align)} />
            <NumberField
                label="Line height"
                help="In line heights of the font"
                value={now.lineHeight}
                min={limits.lineHeight.min}
                max={limits.lineHeight.max}
                sliderMax={3}
                step={0.05}
                onChange={(height) => set('lineHeight', height)}
            />
            <LengthField
                field={spacingField}
                value={
                    now.letterSpacing.endsWith('%') ? now.letterSpacing : Number(now.letterSpacing)
                }
                size={now.size}
                onChange={(value) => set('letterSpacing', String(value))}
            />
            <NumberField
                label="Opacity"
                help="Of the topmost look that is filled; 1 leaves it its own"
                value={now.opacity}
                min={0}
                max={1}
                step={0.01}
                onChange={(opacity) => set('opacity', opacity)}
            />
            <NumberField
                label="Padding"
                help="Pixels around the ink and its effects"
                value={now.padding}
                min={limits.padding.min}
                max={limits.padding.max}
                sliderMax={100}
                step={1}
                onChange={(padding) => set('padding', Math.round(padding))}
            />
            <CheckField
                label="Colours of words: <c #FF8800>word</c>"
                checked={now.markup}
                onChange={(markup) => set('markup', markup)}
            />
        </div>
    );
}

const range = { min: -limits.letterSpacing, max: limits.letterSpacing };

const spacingField: Field = {
    key: 'letterSpacing',
    kind: 'length',
    label: 'Letter spacing',
    help: 'Between letters, beside what the font has',
    required: false,
    ...range,
    percent: range,
    step: 1,
    default: 0,
    choices: [],
};

/** What the picture does not show as it is written, beside the text. */
function TextNotes() {
    const notes = failure.value ? [] : (picture.value?.notes ?? []);
    return (
        <div id="text-notes" class="notes" role="status">
            {notes.slice(0, 4).map((note) => (
                <p key={note}>{note}</p>
            ))}
            {notes.length > 4 && <p>and {notes.length - 4} more notes</p>}
        </div>
    );
}

/** Takes a font file and sets the text in it, or says why not. */
export async function useFontFile(file: File): Promise<void> {
    try {
        const font = await addFont(file);
        edit((now) => ({ ...now, font }));
        notice('info', 'font', `${font} is used, and stays in this browser only.`);
    } catch (error) {
        notice('error', 'font', (error as Error).message);
    }
}

function FontField({ font, onChange }: { font: string; onChange: (font: string) => void }) {
    const shipped = shippedFonts.map(({ id, label }) => [id, label] as const);
    const own = ownFonts.value.map((name) => [name, `${name} (own)`] as const);
    const known = [...shipped, ...own].some(([id]) => id === font);
    const choices = known
        ? [...shipped, ...own]
        : [...shipped, ...own, [font, `${font} (missing)`] as const];
    return (
        <>
            <ChoiceField label="Font" value={font} choices={choices} onChange={onChange} />
            {ownFonts.value.includes(font) && (
                <button
                    type="button"
                    class="button"
                    onClick={() => {
                        onChange(firstWork.font);
                        void forgetFont(font);
                    }}
                >
                    Forget {font}
                </button>
            )}
            <FileButton
                label="Open a font file…"
                accept=".ttf,.otf,.ttc,.otc,.woff"
                onFile={(file) => void useFontFile(file)}
            />
        </>
    );
}

const aligns: readonly (readonly [Align, string])[] = [
    ['left', 'Left'],
    ['center', 'Centre'],
    ['right', 'Right'],
    ['start', 'Start of its direction'],
    ['end', 'End of its direction'],
];

function AlignField({ align, onChange }: { align: Align; onChange: (align: Align) => void }) {
    return (
        <ChoiceField
            label="Alignment"
            help="Where short lines stand"
            value={align}
            choices={aligns}
            onChange={onChange}
        />
    );
}
