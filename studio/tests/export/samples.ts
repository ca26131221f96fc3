import { readdirSync, readFileSync } from 'node:fs';
import { decode } from 'fast-png';
import type { LookStyle, StyleFile } from '../../src/model/style_file';
import type { PatternPixels, Work } from '../../src/model/work';

const presetFolder = new URL('../../../style/presets/', import.meta.url);

/** A work of DejaVu Sans, of the looks or the style, with what differs from the usual. */
export function workOf(style: LookStyle[] | StyleFile, other: Partial<Work> = {}): Work {
    return {
        text: 'Title',
        markup: false,
        font: 'DejaVu Sans:bold',
        size: 40,
        align: 'left',
        lineHeight: 1,
        letterSpacing: '0',
        style: Array.isArray(style) ? { version: 2, looks: style } : style,
        patterns: {},
        opacity: 1,
        padding: 8,
        background: 'transparent',
        ...other,
    };
}

/** A file of one look, as many presets are, becomes a list of one. */
function asList(file: Record<string, unknown>): StyleFile {
    if ('looks' in file) return file as unknown as StyleFile;
    const { description, ...look } = file;
    const said = typeof description === 'string' ? { description } : {};
    delete look.version;
    delete look.$schema;
    return { version: 2, ...said, looks: [look] };
}

function pixelsOf(file: URL): PatternPixels {
    const picture = decode(readFileSync(file));
    const { width, height, channels } = picture;
    const bytes = Buffer.alloc(width * height * 4, 255);
    for (let i = 0; i < width * height; ++i)
        for (let channel = 0; channel < 4; ++channel) {
            const isAlpha = channel === 3;
            const from = channels < 3 ? (isAlpha ? 1 : 0) : channel;
            if (isAlpha && channels % 2 === 1) continue;
            bytes[4 * i + channel] = Number(picture.data[i * channels + from]);
        }
    return { width, height, data: bytes.toString('base64') };
}

function patternsOf(style: StyleFile): Record<string, PatternPixels> {
    const images = style.looks.flatMap((look) => (look.pattern ? [look.pattern.image] : []));
    return Object.fromEntries(
        images.map((image) => [image, pixelsOf(new URL(image, presetFolder))]),
    );
}

/** A work of each preset, by its name. */
export function presetWorks(): Map<string, Work> {
    const files = readdirSync(presetFolder).filter((file) => file.endsWith('.json'));
    return new Map(
        files.map((file) => {
            const text = readFileSync(new URL(file, presetFolder), 'utf8');
            const style = asList(JSON.parse(text) as Record<string, unknown>);
            return [file.replace('.json', ''), workOf(style, { patterns: patternsOf(style) })];
        }),
    );
}

/** Pixels in which all four channels vary, clear and half clear ones among them. */
function tileOf(width: number, height: number): PatternPixels {
    const byte = (i: number): number => (i % 4 === 3 ? i * 37 : i * 61 + 9) % 256;
    const bytes = Array.from({ length: width * height * 4 }, (_, i) => byte(i));
    return { width, height, data: Buffer.from(bytes).toString('base64') };
}

export const tile = tileOf(5, 3);

const ramp = [
    { location: 0, color: '#F40' },
    { location: 0.37, color: '#fa3', opacity: 0.65 },
    { location: 1, color: '#FFFFE0' },
];
const longRamp = Array.from({ length: 9 }, (_, i) => ({
    location: i / 8,
    color: `#${(i * 28).toString(16).padStart(2, '0')}80C0`,
    opacity: 1 - i / 16,
}));
const shadow = { angle: 135, distance: 4, size: 4, color: '#102040' };
const relief = {
    size: 3,
    angle: 120,
    altitude: 30,
    highlightColor: '#FFFFFF',
    shadowColor: '#000000',
};
const lines = 'Two words\nand 3 more';

/** A work for each effect and option of looks, and of the text around them. */
export const handMade: Readonly<Record<string, Work>> = {
    empty: workOf([{}]),
    fill: workOf([{ color: '#1b8', textOpacity: 0.4, outerShadow: { ...shadow, opacity: 0.3 } }]),
    outerShadow: workOf([
        { color: '#FFF', outerShadow: { ...shadow, angle: -33.5, distance: 7.9 } },
    ]),
    innerShadow: workOf([
        { color: '#FC8', innerShadow: { ...shadow, size: 0, opacity: 0.123456 } },
    ]),
    outerGlow: workOf([{ outerGlow: { size: 6, color: '#0CF', opacity: 0.7 } }]),
    glowOfStops: workOf([
        {
            outerGlow: { size: 9, color: '#F0F', gradient: ramp },
            innerGlow: { size: 4, gradient: ramp },
        },
    ]),
    innerGlow: workOf([{ color: '#333', innerGlow: { size: 3, color: '#FE0' } }]),
    linearGradient: workOf([
        { linearGradient: { angle: 47, scale: 1.35, opacity: 0.8, gradient: ramp } },
    ]),
    oneStop: workOf([
        {
            linearGradient: { angle: 0, gradient: [{ location: 0.5, color: '#4C8' }] },
            outerGlow: { size: 4, gradient: [{ location: 0, color: '#C48', opacity: 0.5 }] },
        },
    ]),
    longRamps: workOf([
        {
            linearGradient: { angle: 270, opacity: 0.5, gradient: longRamp },
            radialGradient: { gradient: longRamp },
            innerGlow: { size: 4, gradient: longRamp },
        },
    ]),
    radialGradient: workOf([{ radialGradient: { scale: 0.6, opacity: 0.9, gradient: ramp } }]),
    strokes: workOf([
        { fill: false, stroke: { size: 9, color: '#000', position: 'outside', opacity: 0.5 } },
        { color: '#48C', stroke: { size: 4, color: '#FFF', position: 'center' } },
        { fill: false, stroke: { size: 2, color: '#F00', position: 'inside', strokeStyle: 3 } },
    ]),
    pattern: workOf([{ pattern: { image: 'a b/tile.png', scale: 2.5, opacity: 0.75 } }], {
        patterns: { 'a b/tile.png': tile },
    }),
    tileWidth: workOf(
        [
            {
                pattern: { image: 'tile.png', width: '30%' },
                stroke: { size: 2, color: '#222', position: 'outside' },
            },
            { pattern: { image: 'other', width: 7 }, textOpacity: 0, span: 'word' },
            { fill: false, pattern: { image: 'other', width: '1000%', opacity: 0.2 } },
        ],
        { patterns: { 'tile.png': tile, other: tile } },
    ),
    // As floats, 31 / 7 * 7 is less than 31: the tile would be a pixel too narrow.
    roundedTile: workOf([{ pattern: { image: 'seven.png', width: 31 } }], {
        size: 90,
        patterns: { 'seven.png': tileOf(7, 2) },
    }),
    textFill: workOf([
        { text: { color: '#8B2', opacity: 0.5 }, outerShadow: shadow, textOpacity: 1 },
        { innerShadow: shadow, text: { color: '#2B8', opacity: 0.6 }, textOpacity: 0.5 },
    ]),
    noFill: workOf([{ fill: false, outerShadow: shadow, innerGlow: { size: 5, color: '#F80' } }]),
    bothReliefs: workOf([
        {
            color: '#888',
            bevel: relief,
            stroke: { size: 1, color: '#000', position: 'inside' },
            emboss: relief,
        },
    ]),
    order: workOf([
        {
            innerShadow: { ...shadow, opacity: 0.9 },
            linearGradient: { angle: 90, opacity: 0.6, gradient: ramp },
            innerGlow: { size: 4, color: '#0F0', opacity: 0.5 },
            stroke: { size: 5, color: '#222', position: 'outside', opacity: 0.7 },
            outerShadow: { ...shadow, distance: 9, opacity: 0.7 },
            outerGlow: { size: 7, color: '#F0F', opacity: 0.6 },
        },
    ]),
    percent: workOf(
        [
            {
                stroke: { size: '3.125%', color: '#000', position: 'outside' },
                outerShadow: { ...shadow, distance: '12.5%', size: '1.1%' },
                innerGlow: { size: '7%', color: '#FFF' },
            },
            { outerShadow: { ...shadow, distance: '0%', size: '2.4px' }, color: '#C00' },
        ],
        { size: 52 },
    ),
    thin: workOf(
        [
            {
                stroke: { size: '0.7%', color: '#000', position: 'outside', opacity: 0.9 },
                outerShadow: { ...shadow, distance: '1.3%', size: '1%' },
                outerGlow: { size: '2%', gradient: ramp },
                innerGlow: { size: '0.333%', color: '#F00' },
            },
        ],
        { size: 31 },
    ),
    large: workOf([{ stroke: { size: '40%', color: '#1F4E9E', position: 'outside' } }], {
        size: 300,
        text: 'A',
    }),
    moved: workOf([
        { color: '#000', offset: { x: 3.5, y: '2%' } },
        {
            color: '#FC0',
            offset: { x: -2.5, y: '-1.25%' },
            stroke: { size: 2, color: '#FFF', position: 'outside' },
        },
        { color: '#08F', offset: {}, textOpacity: 0.5 },
    ]),
    lines: workOf(
        [
            { fill: false, stroke: { size: '9%', color: '#13294B', position: 'outside' } },
            { span: 'line', linearGradient: { angle: 90, gradient: ramp } },
        ],
        { text: lines, align: 'center', lineHeight: 0.8 },
    ),
    words: workOf(
        [
            {
                span: 'word',
                color: '#FFF',
                linearGradient: { angle: 0, gradient: ramp },
                outerShadow: shadow,
            },
        ],
        { text: lines, letterSpacing: '5%' },
    ),
    glyphs: workOf(
        [
            {
                span: 'glyph',
                radialGradient: { gradient: ramp },
                stroke: { size: 3, color: '#000', position: 'outside' },
            },
            { span: 'line', fill: false, offset: { x: 2 }, innerShadow: shadow },
        ],
        { text: lines, letterSpacing: '-2' },
    ),
    faded: workOf(
        [
            { color: '#C33', outerShadow: shadow },
            {
                color: '#3C3',
                textOpacity: 0.9,
                stroke: { size: 2, color: '#000', position: 'outside' },
            },
            { fill: false, innerShadow: shadow },
        ],
        { opacity: 0.35 },
    ),
    fadedAndMoved: workOf(
        [
            { text: { color: '#3C3', opacity: 0.5 }, offset: { y: 4 }, outerShadow: shadow },
            { fill: false, outerGlow: { size: 3, color: '#C0F' } },
        ],
        { opacity: 0.55, padding: 20 },
    ),
    aroundTheLook: workOf(
        [{ color: '#FFF', stroke: { size: 2, color: '#000', position: 'outside' } }],
        {
            text: 'a <c #F40>red</c> &amp;\n<c #08F>b</c>',
            markup: true,
            background: '#204060',
            align: 'right',
            opacity: 0.8,
        },
    ),
    hostile: workOf(
        {
            version: 2,
            description:
                'Ends "here" */ \\u000a not \' ``` <!-- %s $(id) ??/\n#include </script> \\',
            looks: [
                { description: '// \\u002a\\u002f } \u2028 ] ) \u202e """', color: '#123456' },
                { description: 'coding: utf-7', color: '#654321', offset: { x: 1 } },
            ],
        },
        { text: '-o "\'; $(exit 3) `x` \\n %s \u2192\n\u00e9 </script>\\' },
    ),
};
