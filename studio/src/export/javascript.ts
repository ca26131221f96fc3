import { noted } from './exported';
import type { Exporter } from './exported';
import { unpaintedComments } from './glyph_notes';
import type { EffectCall, PlacedLook, RampStop } from './looks';
import { isPlainStack, placedLooks } from './looks';
import { spelled } from './numbers';
import { patternFiles, withPatternFiles } from './patterns';
import { fontNames, textOptions } from './text_options';
import { sentence, stringLiteral } from './words';
import type { Work } from '../model/work';
import { javaScript as notation, written } from './written';

const width = 100;

function color(digits: string): string {
    return `'#${digits}'`;
}

/** 'opacity: 0.5' where the number is not the one that it has without. */
function option(name: string, value: number, usual: number): string[] {
    return value === usual ? [] : [`${name}: ${spelled(value)}`];
}

/** ', { opacity: 0.5 }'; nothing where there are no options. */
function options(...each: string[]): string {
    return each.length === 0 ? '' : `, { ${each.join(', ')} }`;
}

function ramp(stops: RampStop[]): string {
    const entries = stops.map((stop) => {
        const opacity = stop.opacity === 1 ? '' : `, ${spelled(stop.opacity)}`;
        return `[${color(stop.color)}, ${spelled(stop.place)}${opacity}]`;
    });
    const line = `[${entries.join(', ')}]`;
    if (line.length <= width - 40) return line;
    return `[\n${entries.map((entry) => `            ${entry},\n`).join('')}        ]`;
}

function call(effect: EffectCall, files: ReadonlyMap<string, string>): string {
    const { kind } = effect;
    const opacity = option('opacity', effect.opacity, 1);
    switch (kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const { angle, distance, size } = effect;
            const place = Object.entries({ angle, distance, size });
            const told = place.map(([name, value]) => `${name}: ${spelled(value)}`);
            return `.${kind}(${color(effect.color)}${options(...told, ...opacity)})`;
        }
        case 'outerGlow':
        case 'innerGlow': {
            const stops = effect.stops.length === 0 ? [] : [`stops: ${ramp(effect.stops)}`];
            const rest = options(...stops, ...opacity);
            return `.${kind}(${spelled(effect.size)}, ${color(effect.color)}${rest})`;
        }
        case 'linearGradient': {
            const place = [
                ...option('angle', effect.angle, 0),
                ...option('scale', effect.scale, 1),
            ];
            return `.${kind}(${ramp(effect.stops)}${options(...place, ...opacity)})`;
        }
        case 'radialGradient': {
            const scale = option('scale', effect.scale, 1);
            return `.${kind}(${ramp(effect.stops)}${options(...scale, ...opacity)})`;
        }
        case 'stroke': {
            const { position } = effect;
            const where = position === 'outside' ? [] : [`position: '${position}'`];
            const rest = options(...where, ...opacity);
            return `.${kind}(${spelled(effect.size)}, ${color(effect.color)}${rest})`;
        }
        case 'pattern': {
            const file = stringLiteral(files.get(effect.image) ?? effect.image, "'");
            const scale = option('scale', effect.scale, 1);
            return `.${kind}(patterns[${file}]${options(...scale, ...opacity)})`;
        }
    }
}

function lookExpression(
    look: PlacedLook,
    files: ReadonlyMap<string, string>,
    margin: string,
): string {
    const { fill, textOpacity } = look;
    const said = look.description === '' ? [] : [look.description];
    const comments = [...said.map(sentence), ...unpaintedComments(look)];
    const opacity = fill && fill.opacity !== 1 ? `, ${spelled(fill.opacity)}` : '';
    return [
        'new Look()',
        ...comments.map((line) => `// ${line}`),
        fill ? `.fill(${color(fill.color)}${opacity})` : '.noFill()',
        ...(textOpacity === 1 ? [] : [`.textOpacity(${spelled(textOpacity)})`]),
        ...look.calls.map((effect) => call(effect, files)),
    ].join(`\n${margin}`);
}

function lookValues(work: Work, looks: readonly PlacedLook[]): string {
    const files = patternFiles(work.style);
    if (looks.length === 1) {
        return looks.map((look) => lookExpression(look, files, ' '.repeat(8))).join('');
    }
    const each = looks.map((look) => lookExpression(look, files, ' '.repeat(12)));
    return `[\n${each.map((look) => `        ${look},\n`).join('')}    ]`;
}

function styleValue(work: Work): string {
    const images = patternFiles(work.style).size > 0 ? ', { images: patterns }' : '';
    return `Style.fromJSON(${written({ ...withPatternFiles(work.style), $schema: undefined }, notation, 1, 33)}${images})`;
}

function painting(work: Work, fonts: readonly string[], opacity: number): string {
    const { align, lineHeight, letterSpacing, markup, padding, background } = textOptions(work);
    const more = { align, lineHeight, letterSpacing, markup, padding, background };
    const told = Object.entries(opacity === 1 ? more : { ...more, opacity });
    const parts = [
        fonts.length === 1 ? 'fonts: new Font(font)' : 'fonts: fonts.map((font) => new Font(font))',
        `size: ${work.size}`,
        'look',
        ...told
            .filter(([, value]) => value !== undefined)
            .map(([name, value]) => `${name}: ${written(value, notation)}`),
    ];
    const text = stringLiteral(work.text, "'");
    const line = `    return Text.picture(${text}, { ${parts.join(', ')} });\n`;
    if (line.length <= width) return line;
    const lines = parts.map((part) => `        ${part},\n`).join('');
    return `    return Text.picture(${text}, {\n${lines}    });\n`;
}

/** A module with a function that paints the text, in a browser or in node. */
export const javascript: Exporter = (work, engine) => {
    const looks = placedLooks(work);
    const isPlain = isPlainStack(looks);
    const files = [...patternFiles(work.style).values()];
    const said = work.style.description ?? '';
    const fonts = fontNames(work, engine);
    const taken = fonts.length === 1 ? 'a font file' : 'font files, in their order';
    const pixels =
        files.length === 0 ? '' : `, and the pixels of ${files.join(', ')} by these names`;
    const parameters = [
        fonts.length === 1 ? 'font' : 'fonts',
        ...(files.length === 0 ? [] : ['patterns']),
    ];
    const text = [
        "import { load } from 'voreleffect/text';\n\n",
        `const { Font, ${isPlain ? 'Look' : 'Style'}, Text } = await load();\n\n`,
        said === '' ? '' : `// ${sentence(said)}\n`,
        `// ${sentence(`${fonts.length === 1 ? 'Font' : 'Fonts'}: ${fonts.join(', ')}`)}\n`,
        `/** Paints a text; takes the bytes of ${taken}${pixels}. */\n`,
        `export function paintTitle(${parameters.join(', ')}) {\n`,
        `    const look = ${isPlain ? lookValues(work, looks) : styleValue(work)};\n`,
        painting(work, fonts, isPlain ? 1 : work.opacity),
        '}\n',
    ].join('');
    const size = isPlain ? `Lengths are in pixels, for text of ${work.size} pixels.` : undefined;
    const told =
        files.length === 0 ? undefined : `It takes the pixels of ${files.join(', ')}, straight.`;
    return { name: 'title.mjs', language: 'javascript', text, ...noted(size, told) };
};
