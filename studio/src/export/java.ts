import { noted } from './exported';
import type { Exporter } from './exported';
import { glyphNotes, headerLines, inLines, moved, unpaintedComments } from './glyph_notes';
import type { EffectCall, PlacedLook, RampStop } from './looks';
import { isPlainStack, patternNames, patternsOf, placedLooks, spansOf } from './looks';
import { floatLiteral } from './numbers';
import { javaSentence } from './words';

type PatternNames = ReadonlyMap<string, string>;

const width = 105;

function number(value: number): string {
    return floatLiteral(value, 'f');
}

function numbers(...values: number[]): string {
    return values.map(number).join(', ');
}

/** The stops, in a line if it is short, else in a line for each. */
function ramp(stops: RampStop[]): string {
    const calls = stops.map(({ color, opacity, place }) => {
        const rest = opacity === 1 ? number(place) : numbers(opacity, place);
        return `.add(0x${color}, ${rest})`;
    });
    const line = `Stops.builder()${calls.join('')}.build()`;
    if (line.length <= width - 50) return line;
    const margin = '\n' + ' '.repeat(24);
    return `Stops.builder()${calls.map((call) => margin + call).join('')}${margin}.build()`;
}

function call(effect: EffectCall, patterns: PatternNames): string {
    const { kind, opacity } = effect;
    switch (kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const light = numbers(effect.angle, effect.distance, effect.size);
            return `.${kind}(${light}, 0x${effect.color}, ${number(opacity)})`;
        }
        case 'outerGlow':
        case 'innerGlow':
            return effect.stops.length === 0
                ? `.${kind}(${number(effect.size)}, 0x${effect.color}, ${number(opacity)})`
                : `.${kind}(${numbers(effect.size, opacity)}, ${ramp(effect.stops)})`;
        case 'linearGradient':
            return `.${kind}(${numbers(effect.angle, effect.scale, opacity)}, ${ramp(effect.stops)})`;
        case 'radialGradient':
            return `.${kind}(${numbers(effect.scale, opacity)}, ${ramp(effect.stops)})`;
        case 'stroke': {
            const { size, color, position } = effect;
            const plain = `${number(size)}, 0x${color}`;
            const where = `Position.${position.toUpperCase()}`;
            if (opacity !== 1) return `.stroke(${plain}, ${number(opacity)}, ${where})`;
            return `.stroke(${plain}${position === 'outside' ? '' : `, ${where}`})`;
        }
        case 'pattern': {
            const name = patterns.get(effect.image) ?? 'pattern';
            const pixels = `${name}, ${name}Width, ${name}Height`;
            return `.pattern(${pixels}, ${numbers(effect.scale, opacity)})`;
        }
    }
}

function patternParameters(names: readonly string[]): string[] {
    return names.map((name) => `int[] ${name}, int ${name}Width, int ${name}Height`);
}

function patternArguments(names: readonly string[]): string {
    return names.map((name) => `${name}, ${name}Width, ${name}Height`).join(', ');
}

function lookMethod(look: PlacedLook, name: string, patterns: PatternNames): string {
    const { fill, textOpacity } = look;
    const opacity = fill && fill.opacity !== 1 ? `, ${number(fill.opacity)}` : '';
    const lines = [
        fill ? `.fill(0x${fill.color}${opacity})` : '.noFill()',
        ...(textOpacity === 1 ? [] : [`.textOpacity(${number(textOpacity)})`]),
        ...look.calls.map((effect) => call(effect, patterns)),
    ];
    const said = look.description === '' ? [] : [look.description];
    const comments = [...said.map(javaSentence), ...unpaintedComments(look)];
    const parameters = patternParameters(patternsOf(look, patterns)).join(', ');
    return [
        ...comments.map((line) => `    // ${line}\n`),
        `    static Look ${name}(${parameters}) {\n        return new Look()`,
        ...lines.map((line) => `\n                ${line}`),
        ';\n    }\n',
    ].join('');
}

function nameOf(i: number, count: number): string {
    return count === 1 ? 'look' : `look${i + 1}`;
}

function made(look: PlacedLook, i: number, count: number, patterns: PatternNames): string {
    return `${nameOf(i, count)}(${patternArguments(patternsOf(look, patterns))})`;
}

/** The stack of looks of which none is moved. */
function stackMethod(looks: PlacedLook[], patterns: PatternNames): string {
    const parameters = patternParameters([...patterns.values()]).join(', ');
    const each = looks.map((look, i) => made(look, i, looks.length, patterns)).join(', ');
    return (
        '    // All of them, the last on top, for a Painter.\n' +
        `    static Look[] looks(${parameters}) {\n        return new Look[] {${each}};\n    }\n`
    );
}

/** The statements that paint one look in its place. */
function painting(look: PlacedLook, i: number, count: number, patterns: PatternNames): string {
    const place = `page, ${moved('x', look.x)}, ${moved('y', look.y)}`;
    const own = made(look, i, count, patterns);
    if (look.span === 'block') return `        ${own}.paint(text, ${place});\n`;
    return (
        `        try (Painter painter = new Painter(${own})) {\n` +
        `            for (List<Glyph> run : ${look.span}s) painter.paint(run, ${place});\n        }\n`
    );
}

/** The method that paints looks that are moved, or of lines, words or glyphs. */
function paintMethod(looks: PlacedLook[], patterns: PatternNames): string {
    const hasBlock = looks.some((look) => look.span === 'block');
    const spans = spansOf(looks).map((span) => `${span}s`);
    const parameters = [
        ...(hasBlock ? ['List<Glyph> text'] : []),
        ...spans.map((span) => `List<List<Glyph>> ${span}`),
        ...patternParameters([...patterns.values()]),
        'PictureView page',
        'int x',
        'int y',
    ];
    const runs =
        spans.length === 0
            ? ''
            : `    // ${spans.join(', ')}: the glyphs of each, in reading order.\n`;
    return [
        '    // Paints the text with its origin at (x, y), look by look, each over those before.\n',
        runs,
        `    static void paint(${inLines(parameters, 22, 102)}) {\n`,
        ...looks.map((look, i) => painting(look, i, looks.length, patterns)),
        '    }\n',
    ].join('');
}

function imports(looks: PlacedLook[], source: string): string {
    const names = ['Glyph', 'Look', 'Painter', 'PictureView', 'Position', 'Stops'];
    const used = names.filter((name) => new RegExp(`\\b${name}\\b`).test(source));
    const lists = isPlainStack(looks) ? '' : 'import java.util.List;\n';
    return lists + used.map((name) => `import org.voreleffect.${name};\n`).join('');
}

/** How looks of which none is moved are painted. */
function usage(looks: PlacedLook[], patterns: PatternNames): string {
    const given = patternArguments([...patterns.values()]);
    const use =
        looks.length === 1
            ? `Title.${nameOf(0, 1)}(${given}).paint(glyphs, page, x, y);`
            : `try (Painter painter = new Painter(Title.looks(${given}))) {\n` +
              '//         painter.paint(glyphs, page, x, y);\n//     }';
    return `// To lay text over a page, its origin at (x, y):\n//     ${use}\n`;
}

/** A class of org.voreleffect's looks, with what paints them where they are several. */
export const java: Exporter = (work) => {
    const looks = placedLooks(work);
    const patterns = patternNames(work);
    const header = headerLines(work, '0xAARRGGBB', javaSentence);
    const isPlain = isPlainStack(looks);
    const parts = looks.map((look, i) => lookMethod(look, nameOf(i, looks.length), patterns));
    if (!isPlain) parts.push(paintMethod(looks, patterns));
    if (isPlain && looks.length > 1) parts.push(stackMethod(looks, patterns));
    const body = parts.join('\n');
    const code = body.replace(/^ *\/\/.*$/gm, '');
    const use = isPlain ? usage(looks, patterns) : '';
    const start = `${header}${use}final class Title {\n    private Title() {}\n\n`;
    const text = `${imports(looks, code)}\n${start}${body}}\n`;
    return { name: 'Title.java', language: 'java', text, ...noted(...glyphNotes(work, looks)) };
};
