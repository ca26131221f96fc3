import { noted } from './exported';
import type { Exporter } from './exported';
import { glyphNotes, headerLines, inLines, moved, unpaintedComments } from './glyph_notes';
import type { EffectCall, PlacedLook, RampStop } from './looks';
import { isPlainStack, patternNames, patternsOf, placedLooks, spansOf } from './looks';
import { floatLiteral } from './numbers';
import { sentence } from './words';

type PatternNames = ReadonlyMap<string, string>;

const width = 105;

function number(value: number): string {
    return floatLiteral(value, 'F');
}

/** A call of the chain where its number is not the one that it has without. */
function chained(name: string, value: number, usual: number): string {
    return value === usual ? '' : `.${name}(${number(value)})`;
}

/** The list of stops, in a line if it fits behind `taken` columns, else in a line for each. */
function list(stops: RampStop[], taken: number): string {
    const entries = stops.map(
        ({ color, opacity, place }) => `{rgb(0x${color}), ${number(opacity)}, ${number(place)}}`,
    );
    const line = `{${entries.join(', ')}}`;
    if (taken + line.length <= width) return line;
    return `{\n${entries.map((entry) => ' '.repeat(16) + entry).join(',\n')}}`;
}

function effect(call: EffectCall, patterns: PatternNames): string {
    const opacity = chained('opacity', call.opacity, 1);
    switch (call.kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const { angle, distance, size, color } = call;
            const name = call.kind === 'outerShadow' ? 'OuterShadow' : 'InnerShadow';
            const light = `.angle(${number(angle)}).distance(${number(distance)})`;
            return `${name}(rgb(0x${color}))${light}.size(${number(size)})${opacity}`;
        }
        case 'outerGlow':
        case 'innerGlow': {
            const name = call.kind === 'outerGlow' ? 'OuterGlow' : 'InnerGlow';
            const stops = call.stops.length > 0 ? `.stops(${list(call.stops, 46)})` : '';
            return `${name}(${number(call.size)}, rgb(0x${call.color}))${stops}${opacity}`;
        }
        case 'linearGradient': {
            const rest = chained('angle', call.angle, 0) + chained('scale', call.scale, 1);
            return `LinearGradient(${list(call.stops, 46)})${rest}${opacity}`;
        }
        case 'radialGradient':
            return `RadialGradient(${list(call.stops, 46)})${chained('scale', call.scale, 1)}${opacity}`;
        case 'stroke': {
            const { size, color, position } = call;
            const where = position === 'outside' ? '' : `.position(Position::${position})`;
            return `Stroke(${number(size)}, rgb(0x${color}))${where}${opacity}`;
        }
        case 'pattern': {
            const name = patterns.get(call.image) ?? 'pattern';
            return `Pattern(${name})${chained('scale', call.scale, 1)}${opacity}`;
        }
    }
}

/** The lines of the calls behind `Look()`. */
function calls(look: PlacedLook, patterns: PatternNames): string[] {
    const { fill, textOpacity } = look;
    const opacity = fill && fill.opacity !== 1 ? `, ${number(fill.opacity)}` : '';
    return [
        fill ? `.fill(rgb(0x${fill.color})${opacity})` : '.noFill()',
        ...(textOpacity === 1 ? [] : [`.textOpacity(${number(textOpacity)})`]),
        ...look.calls.map((call) => `.add(${effect(call, patterns)})`),
    ];
}

function lookFunction(look: PlacedLook, name: string, patterns: PatternNames): string {
    const parameters = patternsOf(look, patterns).map((pattern) => `const PixelView& ${pattern}`);
    const said = look.description === '' ? [] : [look.description];
    return [
        ...[...said.map(sentence), ...unpaintedComments(look)].map((line) => `/// ${line}\n`),
        `Look ${name}(${parameters.join(', ')}) {\n    return Look()`,
        ...calls(look, patterns).map((line) => `\n        ${line}`),
        ';\n}\n',
    ].join('');
}

function nameOf(i: number, count: number): string {
    return count === 1 ? 'titleLook' : `titleLook${i + 1}`;
}

function made(look: PlacedLook, i: number, count: number, patterns: PatternNames): string {
    return `${nameOf(i, count)}(${patternsOf(look, patterns).join(', ')})`;
}

/** The stack of looks of which none is moved. */
function stackFunction(looks: PlacedLook[], patterns: PatternNames): string {
    const parameters = [...patterns.values()].map((pattern) => `const PixelView& ${pattern}`);
    const each = looks.map((look, i) => made(look, i, looks.length, patterns));
    const name = `std::vector<Look> titleLooks(${parameters.join(', ')})`;
    return `/// All of them, the last on top.\n${name} {\n    return {${each.join(', ')}};\n}\n`;
}

/** The lines that paint one look in its place. */
function painting(look: PlacedLook, i: number, count: number, patterns: PatternNames): string {
    const place = `page, ${moved('x', look.x)}, ${moved('y', look.y)}`;
    const look_ = made(look, i, count, patterns);
    if (look.span === 'block') return `    if (!paint(${look_}, text, ${place})) return false;\n`;
    const painter = count === 1 ? 'painter' : `painter${i + 1}`;
    return (
        `    Painter ${painter}(${look_});\n` +
        `    for (const std::vector<Glyph>& run : ${look.span}s)\n` +
        `        if (!${painter}.paint(run, ${place})) return false;\n`
    );
}

/** The function that paints looks that are moved, or of lines, words or glyphs. */
function paintFunction(looks: PlacedLook[], patterns: PatternNames): string {
    const hasBlock = looks.some((look) => look.span === 'block');
    const spans = spansOf(looks);
    const parameters = [
        ...(hasBlock ? ['Glyphs text'] : []),
        ...spans.map((span) => `const std::vector<std::vector<Glyph>>& ${span}s`),
        ...[...patterns.values()].map((pattern) => `const PixelView& ${pattern}`),
        'const PictureView& page',
        'int x',
        'int y',
    ];
    const runs = spans.map((span) => `${span}s`).join(', ');
    const told =
        spans.length > 0 ? `///\n/// ${runs}: the glyphs of each, in reading order.\n` : '';
    return [
        '/// Paints the text with its origin at (x, y), look by look, each over those before. False where\n',
        '/// something cannot be painted.\n',
        told,
        `bool paintTitle(${inLines(parameters, 16, 102)}) {\n`,
        ...looks.map((look, i) => painting(look, i, looks.length, patterns)),
        '    return true;\n}\n',
    ].join('');
}

/** How looks of which none is moved are painted. */
function usage(looks: PlacedLook[], patterns: PatternNames): string {
    const name = looks.length === 1 ? nameOf(0, 1) : 'titleLooks';
    const made = `${name}(${[...patterns.values()].join(', ')})`;
    return `// To lay text over a page, its origin at (x, y):\n//     paint(${made}, glyphs, page, x, y);\n`;
}

/** Functions of look.h: one for each look, and what paints them where they are several. */
export const cppLook: Exporter = (work) => {
    const looks = placedLooks(work);
    const patterns = patternNames(work);
    const header = headerLines(work, 'R, G, B, A', sentence);
    const isPlain = isPlainStack(looks);
    const parts = looks.map((look, i) => lookFunction(look, nameOf(i, looks.length), patterns));
    if (!isPlain) parts.push(paintFunction(looks, patterns));
    if (isPlain && looks.length > 1) parts.push(stackFunction(looks, patterns));
    const needsVector = looks.length > 1 || !isPlain;
    const includes = `#include <voreleffect/look.h>\n${needsVector ? '\n#include <vector>\n' : ''}`;
    const use = isPlain ? usage(looks, patterns) : '';
    const text = `${header}${use}${includes}\nusing namespace VFontEffect;\n\n${parts.join('\n')}`;
    return { name: 'title.cpp', language: 'cpp', text, ...noted(...glyphNotes(work, looks)) };
};
