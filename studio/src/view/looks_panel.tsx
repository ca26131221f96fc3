import {
    addEffect,
    addLook,
    maxLooks,
    moveEffect,
    moveLook,
    removeEffect,
    removeLook,
    setFill,
    withKey,
    withStyle,
} from '../model/edit';
import { helpOf, labelOf, lookField, offsetFields } from '../model/schema';
import {
    effectsOf,
    lookName,
    paintedEffects,
    type EffectName,
    type LookStyle,
    type Span,
} from '../model/style_file';
import { announce, edit, editLook, openEffect, openLook, work } from '../state/store';
import { choosePattern, EffectForm } from './effect_form';
import {
    CheckField,
    ChoiceField,
    ColourField,
    LengthField,
    NumberField,
    TextField,
} from './fields';
import { focusButton, focusPlace } from './focus';
import { Icon, IconButton } from './icons';
import { useReorder } from './reorder';

/** The stack of looks, the topmost first, and the effects of the one that is open. */
export function LooksPanel() {
    const looks = work.value.style.looks;
    const index = Math.min(openLook.value, looks.length - 1);
    const look = looks[index];
    return (
        <>
            <LookList looks={looks} open={index} />
            {look && <LookEditor key={index} look={look} index={index} />}
        </>
    );
}

function swatchOf(look: LookStyle): string | undefined {
    const ramp = look.linearGradient ?? look.radialGradient;
    if (ramp) return ramp.gradient[Math.floor(ramp.gradient.length / 2)]?.color;
    return look.fill === false ? look.stroke?.color : (look.text?.color ?? look.color ?? '#000000');
}

function LookList({ looks, open }: { looks: LookStyle[]; open: number }) {
    const last = looks.length - 1;
    const move = (from: number, to: number) => {
        if (to < 0 || to > last) return;
        edit((now) => withStyle(now, (style) => moveLook(style, from, to)), 'looks.order');
        openLook.value = to;
        announce(`Look moved to place ${last - to + 1} of ${last + 1} from the top`);
    };
    const remove = (index: number) =>
        edit((now) => withStyle(now, (style) => removeLook(style, index)));
    const { list, handle } = useReorder((from, to) => move(last - from, last - to));
    return (
        <section class="group" aria-labelledby="looks-title">
            <div class="group-head">
                <h3 id="looks-title">Stack of looks</h3>
                <button
                    type="button"
                    class="button"
                    disabled={looks.length >= maxLooks}
                    onClick={() => {
                        edit((now) => withStyle(now, addLook));
                        openLook.value = work.value.style.looks.length - 1;
                    }}
                >
                    <Icon name="plus" /> Add look
                </button>
            </div>
            <ol class="rows" ref={list}>
                {looks.toReversed().map((look, row) => {
                    const index = last - row;
                    return (
                        <li key={row} class={index === open ? 'row-item open' : 'row-item'}>
                            <span class="grip" {...handle(row)}>
                                <Icon name="grip" />
                            </span>
                            <button
                                type="button"
                                class="row-name"
                                aria-pressed={index === open}
                                onClick={() => (openLook.value = index)}
                            >
                                <span
                                    class="swatch"
                                    style={{ backgroundColor: swatchOf(look) ?? '' }}
                                />
                                <span class="row-text">{lookName(look, index)}</span>
                            </button>
                            <RowButtons
                                name={lookName(look, index)}
                                list={list}
                                row={row}
                                up={index < last ? () => move(index, index + 1) : undefined}
                                down={index > 0 ? () => move(index, index - 1) : undefined}
                                remove={last > 0 ? () => remove(index) : undefined}
                            />
                        </li>
                    );
                })}
            </ol>
        </section>
    );
}

interface RowButtonsProps {
    name: string;
    list: { readonly current: HTMLElement | null };
    /** Place in the list, 0 the topmost. */
    row: number;
    up?: (() => void) | undefined;
    down?: (() => void) | undefined;
    remove?: (() => void) | undefined;
}

/** The keyboard stays with the row that moves, and in the list when one goes. */
function RowButtons({ name, list, row, up, down, remove }: RowButtonsProps) {
    const turned = (move: (() => void) | undefined, to: number, button: number) => () => {
        move?.();
        focusButton(list.current, to, button);
    };
    const removed = () => {
        remove?.();
        focusPlace(list.current, row);
    };
    return (
        <span class="row-buttons">
            <IconButton
                icon="up"
                label={`Move ${name} up`}
                disabled={!up}
                onClick={turned(up, row - 1, 0)}
            />
            <IconButton
                icon="down"
                label={`Move ${name} down`}
                disabled={!down}
                onClick={turned(down, row + 1, 1)}
            />
            <IconButton
                icon="cross"
                label={`Remove ${name}`}
                disabled={!remove}
                onClick={removed}
            />
        </span>
    );
}

function LookEditor({ look, index }: { look: LookStyle; index: number }) {
    const names = effectsOf(look);
    const last = names.length - 1;
    const move = (name: EffectName, to: number) => {
        if (to < 0 || to > last) return;
        editLook(index, (now) => moveEffect(now, name, to), 'order');
        announce(`${labelOf(name)} moved to place ${last - to + 1} of ${last + 1} from the top`);
    };
    const drag = (from: number, to: number) => {
        const name = names[last - from];
        if (name) move(name, last - to);
    };
    // An open form is higher than the rows that it would be dragged over.
    const { list, handle } = useReorder(drag, () => (openEffect.value = ''));
    return (
        <section class="group" aria-labelledby="effects-title">
            <div class="group-head">
                <h3 id="effects-title">Effects of {lookName(look, index)}</h3>
                <AddEffect look={look} index={index} />
            </div>
            <ol class="rows" ref={list}>
                {names.toReversed().map((name, row) => (
                    <li key={row} class={openEffect.value === name ? 'row-item open' : 'row-item'}>
                        <span class="grip" {...handle(row)}>
                            <Icon name="grip" />
                        </span>
                        <RowName name={name} label={labelOf(name)} />
                        <RowButtons
                            name={labelOf(name)}
                            list={list}
                            row={row}
                            up={row > 0 ? () => move(name, last - row + 1) : undefined}
                            down={row < last ? () => move(name, last - row - 1) : undefined}
                            remove={() => editLook(index, (now) => removeEffect(now, name))}
                        />
                        {openEffect.value === name && (
                            <div class="row-form">
                                <p class="help">{helpOf(name)}</p>
                                <EffectForm look={look} index={index} name={name} />
                            </div>
                        )}
                    </li>
                ))}
            </ol>
            <div class={openEffect.value === 'fill' ? 'row-item open' : 'row-item'}>
                <RowName name="fill" label="Name, fill, place and span" />
                {openEffect.value === 'fill' && <LookForm look={look} index={index} />}
            </div>
        </section>
    );
}

function RowName({ name, label }: { name: EffectName | 'fill'; label: string }) {
    const open = openEffect.value === name;
    return (
        <button
            type="button"
            class="row-name"
            aria-expanded={open}
            onClick={() => (openEffect.value = open ? '' : name)}
        >
            <span class="row-text">{label}</span>
        </button>
    );
}

/** A closed list would add an effect at each arrow or letter, the first that it leads to: such keys open it. */
function openChoices(event: KeyboardEvent & { currentTarget: HTMLSelectElement }): void {
    const turns = event.key.length === 1 || event.key.startsWith('Arrow');
    if (!turns || event.ctrlKey || event.metaKey) return;
    event.preventDefault();
    event.currentTarget.showPicker();
}

function AddEffect({ look, index }: { look: LookStyle; index: number }) {
    const free = paintedEffects.filter(
        (name) => !look[name] && (name !== 'text' || look.fill !== false),
    );
    const add = (name: EffectName) => {
        openEffect.value = name;
        if (name === 'pattern') void choosePattern(index, 'tiles.png');
        else editLook(index, (now) => addEffect(now, name));
    };
    return (
        <select
            class="button"
            aria-label="Add an effect"
            value=""
            disabled={free.length === 0}
            onKeyDown={openChoices}
            onChange={(event) => {
                const chosen = free.find((name) => name === event.currentTarget.value);
                event.currentTarget.value = '';
                if (chosen) add(chosen);
            }}
        >
            <option value="">+ Add effect</option>
            {free.map((name) => (
                <option key={name} value={name} title={helpOf(name)}>
                    {labelOf(name)}
                </option>
            ))}
        </select>
    );
}

const spans: readonly (readonly [Span, string])[] = [
    ['block', 'Whole text'],
    ['line', 'Each line'],
    ['word', 'Each word'],
    ['glyph', 'Each glyph'],
];

/** What a look has beside its effects. */
function LookForm({ look, index }: { look: LookStyle; index: number }) {
    const set = (key: string, value: unknown) =>
        editLook(index, (now) => withKey(now, key, value), key);
    const opacity = lookField('textOpacity');
    return (
        <div class="row-form form">
            <TextField
                label="Name"
                help={lookField('description').help}
                value={look.description ?? ''}
                onChange={(name) => set('description', name || undefined)}
            />
            <CheckField
                label="The text is filled"
                help={lookField('fill').help}
                checked={look.fill !== false}
                onChange={(filled) => editLook(index, (now) => setFill(now, filled))}
            />
            {look.fill !== false && !look.text && (
                <ColourField
                    label="Fill colour"
                    value={look.color ?? '#000000'}
                    onChange={(color) => set('color', color)}
                />
            )}
            {look.fill !== false && (
                <NumberField
                    label="Text opacity"
                    help={opacity.help}
                    value={look.textOpacity ?? 1}
                    min={opacity.min}
                    max={opacity.max}
                    step={opacity.step}
                    onChange={(value) => set('textOpacity', value)}
                />
            )}
            {offsetFields().map((field) => (
                <LengthField
                    key={field.key}
                    field={field}
                    value={look.offset?.[field.key as 'x' | 'y'] ?? 0}
                    size={work.value.size}
                    onChange={(value) => set('offset', { ...look.offset, [field.key]: value })}
                />
            ))}
            <ChoiceField
                label="Gradients fill"
                help={lookField('span').help}
                value={look.span ?? 'block'}
                choices={spans}
                onChange={(span) => set('span', span === 'block' ? undefined : span)}
            />
        </div>
    );
}
