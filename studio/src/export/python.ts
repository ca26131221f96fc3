import { noted } from './exported';
import type { Exporter } from './exported';
import { unpaintedComments } from './glyph_notes';
import type { EffectCall, PlacedLook, RampStop } from './looks';
import { isPlainStack, placedLooks } from './looks';
import { spelled } from './numbers';
import { patternFiles, patternNote, withPatternFiles } from './patterns';
import { fontNames, textOptions } from './text_options';
import { sentence, stringLiteral } from './words';
import type { Work } from '../model/work';
import { python as notation, written } from './written';

const width = 100;

function color(digits: string): string {
    return `"#${digits}"`;
}

/** ', opacity=0.5' where the number is not the one that it has without. */
function argument(name: string, value: number, usual: number): string {
    return value === usual ? '' : `, ${name}=${spelled(value)}`;
}

function ramp(stops: RampStop[]): string {
    const entries = stops.map((stop) => {
        const opacity = stop.opacity === 1 ? '' : `, ${spelled(stop.opacity)}`;
        return `(${color(stop.color)}, ${spelled(stop.place)}${opacity})`;
    });
    const line = `[${entries.join(', ')}]`;
    if (line.length <= width - 40) return line;
    return `[\n${entries.map((entry) => `            ${entry},\n`).join('')}        ]`;
}

function call(effect: EffectCall, files: ReadonlyMap<string, string>): string {
    const opacity = argument('opacity', effect.opacity, 1);
    switch (effect.kind) {
        case 'outerShadow':
        case 'innerShadow': {
            const name = effect.kind === 'outerShadow' ? 'outer_shadow' : 'inner_shadow';
            const place = `angle=${spelled(effect.angle)}, distance=${spelled(effect.distance)}`;
            return `.${name}(${color(effect.color)}, ${place}, size=${spelled(effect.size)}${opacity})`;
        }
        case 'outerGlow':
        case 'innerGlow': {
            const name = effect.kind === 'outerGlow' ? 'outer_glow' : 'inner_glow';
            const stops = effect.stops.length === 0 ? '' : `, stops=${ramp(effect.stops)}`;
            return `.${name}(${spelled(effect.size)}, ${color(effect.color)}${stops}${opacity})`;
        }
        case 'linearGradient': {
            const angle = argument('angle', effect.angle, 0);
            const scale = argument('scale', effect.scale, 1);
            return `.linear_gradient(${ramp(effect.stops)}${angle}${scale}${opacity})`;
        }
        case 'radialGradient': {
            const scale = argument('scale', effect.scale, 1);
            return `.radial_gradient(${ramp(effect.stops)}${scale}${opacity})`;
        }
        case 'stroke': {
            const { position } = effect;
            const where = position === 'outside' ? '' : `, position="${position}"`;
            return `.stroke(${spelled(effect.size)}, ${color(effect.color)}${where}${opacity})`;
        }
        case 'pattern': {
            const file = stringLiteral(files.get(effect.image) ?? effect.image, '"');
            const scale = argument('scale', effect.scale, 1);
            return `.pattern(PIL.Image.open(${file}).convert("RGBA")${scale}${opacity})`;
        }
    }
}

/** The expression of one look, its calls at eight columns. */
function lookExpression(look: PlacedLook, files: ReadonlyMap<string, string>): string {
    const { fill, textOpacity } = look;
    const said = look.description === '' ? [] : [look.description];
    const comments = [...said.map(sentence), ...unpaintedComments(look)];
    const opacity = fill && fill.opacity !== 1 ? `, ${spelled(fill.opacity)}` : '';
    return [
        '(ve.Look()',
        ...comments.map((line) => `# ${line}`),
        fill ? `.fill(${color(fill.color)}${opacity})` : '.no_fill()',
        ...(textOpacity === 1 ? [] : [`.text_opacity(${spelled(textOpacity)})`]),
        ...look.calls.map((effect) => call(effect, files)),
    ].join('\n        ');
}

/** Statements that make `look` of looks as values. */
function lookValues(work: Work, looks: readonly PlacedLook[]): string {
    const files = patternFiles(work.style);
    const each = looks.map((look) => `${lookExpression(look, files)})`);
    if (each.length === 1) return `look = ${each.join('')}\n`;
    return `look = [\n${each.map((look) => `    ${look},\n`).join('')}]\n`;
}

/** A statement that makes `look` of the whole style. */
function styleValue(work: Work): string {
    const value = written({ ...withPatternFiles(work.style), $schema: undefined }, notation, 0, 25);
    const folder = patternFiles(work.style).size > 0 ? ', folder="."' : '';
    return `look = ve.Style.from_json(${value}${folder})\n`;
}

/** The call that paints. */
function painting(work: Work, fonts: readonly string[], opacity: number): string {
    const { align, lineHeight, letterSpacing, markup, padding, background } = textOptions(work);
    const spacing =
        typeof letterSpacing === 'string' ? stringLiteral(letterSpacing, '"') : letterSpacing;
    const names = fonts.map((font) => stringLiteral(font, '"'));
    const parts = [
        stringLiteral(work.text, '"'),
        `font=${names.length === 1 ? names[0] : `[${names.join(', ')}]`}`,
        `size=${work.size}`,
        'look=look',
        ...(align === undefined ? [] : [`align=${stringLiteral(align, '"')}`]),
        ...(lineHeight === undefined ? [] : [`line_height=${lineHeight}`]),
        ...(spacing === undefined ? [] : [`letter_spacing=${spacing}`]),
        ...(opacity === 1 ? [] : [`opacity=${opacity}`]),
        ...(padding === undefined ? [] : [`padding=${padding}`]),
        ...(background === undefined ? [] : [`background=${stringLiteral(background, '"')}`]),
        ...(markup ? ['markup=True'] : []),
    ];
    const line = `image = ve.text(${parts.join(', ')})\n`;
    if (line.length <= width) return line;
    return `image = ve.text(\n${parts.map((part) => `    ${part},\n`).join('')})\n`;
}

/**
 * A program that paints the text: looks as values where they are a plain stack, else the whole style. Its
 * first line is words of our own: in a comment there, Python would look for the source's encoding.
 */
export const python: Exporter = (work, engine) => {
    const looks = placedLooks(work);
    const isPlain = isPlainStack(looks);
    const hasPattern = isPlain && patternFiles(work.style).size > 0;
    const said = work.style.description ?? '';
    const text = [
        '"""Paints a text into title.png."""\n\n',
        hasPattern ? 'import PIL.Image\n' : '',
        'import voreleffect as ve\n\n',
        said === '' ? '' : `# ${sentence(said)}\n`,
        isPlain ? lookValues(work, looks) : styleValue(work),
        // Looks as values have the work's opacity in them.
        painting(work, fontNames(work, engine), isPlain ? 1 : work.opacity),
        'image.save("title.png")\n',
    ].join('');
    const size = isPlain ? `Lengths are in pixels, for text of ${work.size} pixels.` : undefined;
    return { name: 'title.py', language: 'python', text, ...noted(size, patternNote(work.style)) };
};
