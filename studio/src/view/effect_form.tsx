import { freshEffects, setField } from '../model/edit';
import { fieldsOf, type Field } from '../model/schema';
import type { EffectName, Length, LookStyle, Stop } from '../model/style_file';
import { notice, settle } from '../state/notices';
import { ownPattern, shippedPattern, shippedPatterns, withPattern } from '../state/patterns';
import { edit, editLook, work } from '../state/store';
import { ChoiceField, ColourField, FileButton, LengthField, NumberField } from './fields';
import { GradientEditor } from './gradient';

interface Props {
    look: LookStyle;
    index: number;
    name: EffectName;
}

/** Fields of no consequence for the picture: the format carries them, and the form leaves them out. */
const carried = new Set(['strokeStyle', 'style', 'technique', 'direction']);

/** The form of an effect, made from the schema. */
export function EffectForm({ look, index, name }: Props) {
    const effect = (look[name] ?? {}) as Record<string, unknown>;
    const set = (key: string, value: unknown) =>
        editLook(index, (now) => setField(now, name, key, value), `${name}.${key}`);
    return (
        <div class="form">
            {fieldsOf(name)
                .filter((field) => isShown(field, effect))
                .map((field) => (
                    <EffectField
                        key={field.key}
                        field={field}
                        effect={effect}
                        set={set}
                        lookIndex={index}
                        name={name}
                    />
                ))}
            {isGlow(name) && <GlowColours effect={effect} set={set} />}
            {name === 'pattern' && <TileSize effect={effect} lookIndex={index} />}
        </div>
    );
}

function isGlow(name: EffectName): boolean {
    return name === 'outerGlow' || name === 'innerGlow';
}

/** Of two fields that exclude one another the form has the one that the effect has. */
function isShown(field: Field, effect: Record<string, unknown>): boolean {
    if (carried.has(field.key)) return false;
    const excluding: Record<string, string> = { scale: 'width', color: 'gradient' };
    const other = excluding[field.key];
    if (other && effect[other] !== undefined) return false;
    const optional = field.key === 'width' || (field.key === 'gradient' && !field.required);
    return !optional || effect[field.key] !== undefined;
}

interface FieldProps {
    field: Field;
    effect: Record<string, unknown>;
    set: (key: string, value: unknown) => void;
    lookIndex: number;
    name: EffectName;
}

function EffectField({ field, effect, set, lookIndex, name }: FieldProps) {
    const fresh = (freshEffects[name] as unknown as Record<string, unknown>)[field.key];
    const value = effect[field.key] ?? field.default ?? fresh;
    const onChange = (to: unknown) => set(field.key, to);
    switch (field.kind) {
        case 'length':
            return (
                <LengthField
                    field={field}
                    value={value as Length}
                    size={work.value.size}
                    onChange={onChange}
                />
            );
        case 'colour':
            return (
                <ColourField
                    label={field.label}
                    help={field.help}
                    value={value as string}
                    onChange={onChange}
                />
            );
        case 'choice':
            return (
                <ChoiceField
                    label={field.label}
                    help={field.help}
                    value={value as string}
                    choices={field.choices.map((choice) => [choice, named(choice)])}
                    onChange={onChange}
                />
            );
        case 'stops':
            return <GradientEditor label="Colours" stops={value as Stop[]} onChange={onChange} />;
        case 'image':
            return <ImageField lookIndex={lookIndex} image={value as string} />;
        default:
            return (
                <NumberField
                    label={field.label}
                    help={field.help}
                    value={value as number}
                    min={field.min}
                    max={field.max}
                    step={field.step}
                    onChange={onChange}
                />
            );
    }
}

/** 'center' as 'Centre', as the texts of the page spell it. */
function named(choice: string): string {
    const word = choice === 'center' ? 'centre' : choice;
    return word.charAt(0).toUpperCase() + word.slice(1);
}

/** A glow has one colour or a ramp. */
function GlowColours({ effect, set }: Pick<FieldProps, 'effect' | 'set'>) {
    if (effect['gradient'] !== undefined) {
        return (
            <button type="button" class="button" onClick={() => set('gradient', undefined)}>
                One colour instead
            </button>
        );
    }
    const color = (effect['color'] as string | undefined) ?? '#FFFFFF';
    const ramp: Stop[] = [
        { location: 0, color },
        { location: 1, color, opacity: 0 },
    ];
    return (
        <button type="button" class="button" onClick={() => set('gradient', ramp)}>
            Several colours instead
        </button>
    );
}

/** A tile has a size in sizes of its picture, or a width. */
function TileSize({ effect, lookIndex }: Pick<FieldProps, 'effect' | 'lookIndex'>) {
    const byWidth = effect['width'] !== undefined;
    const swap = () =>
        editLook(lookIndex, (look) => {
            if (!look.pattern) return look;
            const { image, opacity } = look.pattern;
            const kept = opacity === undefined ? { image } : { image, opacity };
            return {
                ...look,
                pattern: byWidth ? { ...kept, scale: 1 } : { ...kept, width: '33%' },
            };
        });
    return (
        <button type="button" class="button" onClick={swap}>
            {byWidth ? 'Size by scale instead' : 'Size by width instead'}
        </button>
    );
}

/** Puts the picture of a pattern into the work and names it in the look. */
export async function choosePattern(lookIndex: number, from: string | File): Promise<void> {
    try {
        const name = typeof from === 'string' ? from : from.name;
        const pixels = await (typeof from === 'string' ? shippedPattern(from) : ownPattern(from));
        edit((now) => {
            const looks = now.style.looks.map((look, at) =>
                at === lookIndex
                    ? {
                          ...look,
                          pattern: { ...(look.pattern ?? freshEffects.pattern), image: name },
                      }
                    : look,
            );
            return withPattern({ ...now, style: { ...now.style, looks } }, name, pixels);
        });
        settle('pattern');
    } catch (error) {
        notice('error', 'pattern', (error as Error).message);
    }
}

function ImageField({ lookIndex, image }: { lookIndex: number; image: string }) {
    const names = [...new Set([...shippedPatterns, ...Object.keys(work.value.patterns), image])];
    return (
        <>
            <ChoiceField
                label="Picture"
                help="A PNG file, tiled over the text from the top left corner of its box"
                value={image}
                choices={names.map((name) => [name, name.replace(/\.png$/i, '')])}
                onChange={(name) => {
                    if (work.value.patterns[name]) {
                        editLook(lookIndex, (look) => setField(look, 'pattern', 'image', name));
                    } else void choosePattern(lookIndex, name);
                }}
            />
            <FileButton
                label="Open a PNG…"
                accept="image/png"
                onFile={(file) => void choosePattern(lookIndex, file)}
            />
        </>
    );
}
