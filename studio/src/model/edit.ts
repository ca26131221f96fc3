import {
    effectsOf,
    isEffectName,
    type EffectName,
    type Effects,
    type LookStyle,
    type StyleFile,
} from './style_file';
import type { Work } from './work';

/** Changes of a style as plain functions: each gives a new value and leaves its argument as it was. */

export const maxLooks = 32;

/** What an effect has when it is added, in lengths that follow the text. */
export const freshEffects: Required<Effects> = {
    outerShadow: { angle: 135, distance: '6%', size: '6%', color: '#000000', opacity: 0.6 },
    innerShadow: { angle: 135, distance: '3%', size: '4%', color: '#000000', opacity: 0.6 },
    outerGlow: { size: '12%', color: '#FFD23F', opacity: 0.8 },
    innerGlow: { size: '6%', color: '#FFFFFF', opacity: 0.8 },
    bevel: {
        size: '4%',
        angle: 135,
        altitude: 30,
        highlightColor: '#FFFFFF',
        shadowColor: '#000000',
    },
    emboss: {
        size: '4%',
        angle: 135,
        altitude: 30,
        highlightColor: '#FFFFFF',
        shadowColor: '#000000',
    },
    linearGradient: {
        angle: 90,
        gradient: [
            { location: 0, color: '#2D6CDF' },
            { location: 1, color: '#9CE5FF' },
        ],
    },
    radialGradient: {
        gradient: [
            { location: 0, color: '#FFF3B0' },
            { location: 1, color: '#E4572E' },
        ],
    },
    stroke: { size: '4%', color: '#FFFFFF', position: 'outside' },
    pattern: { image: 'tiles.png', width: '33%' },
    text: { color: '#1F2937' },
};

function withLooks(style: StyleFile, looks: LookStyle[]): StyleFile {
    return { ...style, looks };
}

function moved<T>(list: readonly T[], from: number, to: number): T[] {
    const result = [...list];
    const [item] = result.splice(from, 1);
    if (item !== undefined) result.splice(Math.max(0, Math.min(result.length, to)), 0, item);
    return result;
}

/** A look on top of the others; beyond 32 the style stays as it is. */
export function addLook(style: StyleFile, look: LookStyle = { color: '#FFFFFF' }): StyleFile {
    return style.looks.length < maxLooks ? withLooks(style, [...style.looks, look]) : style;
}

/** The last look stays: a style has at least one. */
export function removeLook(style: StyleFile, index: number): StyleFile {
    if (style.looks.length < 2) return style;
    return withLooks(
        style,
        style.looks.filter((_, at) => at !== index),
    );
}

export function moveLook(style: StyleFile, from: number, to: number): StyleFile {
    return withLooks(style, moved(style.looks, from, to));
}

export function changeLook(
    style: StyleFile,
    index: number,
    change: (look: LookStyle) => LookStyle,
): StyleFile {
    return withLooks(
        style,
        style.looks.map((look, at) => (at === index ? change(look) : look)),
    );
}

function without(look: LookStyle, ...keys: (keyof LookStyle)[]): LookStyle {
    const entries = Object.entries(look).filter(([key]) => !keys.some((gone) => gone === key));
    return Object.fromEntries(entries);
}

/** The effect on top of those that the look has; one that is there stays. */
export function addEffect(look: LookStyle, name: EffectName): LookStyle {
    if (look[name]) return look;
    if (name !== 'text') return { ...look, [name]: freshEffects[name] };
    const { color } = look;
    return { ...without(look, 'color', 'fill'), text: { color: color ?? freshEffects.text.color } };
}

/** Without the effect; the colour of the effect `text` becomes that of the look. */
export function removeEffect(look: LookStyle, name: EffectName): LookStyle {
    const rest = without(look, name);
    return name === 'text' && look.text ? { color: look.text.color, ...rest } : rest;
}

/** Moves an effect to a place among the effects of its look, 0 the first one added. */
export function moveEffect(look: LookStyle, name: EffectName, to: number): LookStyle {
    const names = effectsOf(look);
    const order = moved(names, names.indexOf(name), to);
    const plain = Object.entries(look).filter(([key]) => !isEffectName(key));
    return Object.fromEntries([...plain, ...order.map((key) => [key, look[key]])]) as LookStyle;
}

/** Sets a field of an effect; undefined takes it away. */
export function setField(
    look: LookStyle,
    name: EffectName,
    key: string,
    value: unknown,
): LookStyle {
    return { ...look, [name]: withKey(look[name] ?? {}, key, value) };
}

/** The object with the key set; undefined takes it away. */
export function withKey<T extends object>(object: T, key: string, value: unknown): T {
    if (value !== undefined) return { ...object, [key]: value };
    return Object.fromEntries(Object.entries(object).filter(([name]) => name !== key)) as T;
}

/** A look without fill has no colour, opacity or effect of the text. */
export function setFill(look: LookStyle, filled: boolean): LookStyle {
    if (filled) return { color: '#FFFFFF', ...without(look, 'fill') };
    return { fill: false, ...without(look, 'fill', 'color', 'textOpacity', 'text') };
}

export function withStyle(work: Work, change: (style: StyleFile) => StyleFile): Work {
    return { ...work, style: change(work.style) };
}
