import { noted } from './exported';
import type { Exporter } from './exported';
import { glyphNotes, headerLines, inLines, moved, unpaintedComments } from './glyph_notes';
import type { EffectCall, PlacedLook, RampStop } from './looks';
import { isPlainStack, patternNames, patternsOf, placedLooks, spansOf } from './looks';
import { floatLiteral } from './numbers';
import { sentence } from './words';

type PatternNames = ReadonlyMap<string, string>;

const width = 105;

const functions = {
    outerShadow: 'outer_shadow',
    innerShadow: 'inner_shadow',
    outerGlow: 'outer_glow',
    innerGlow: 'inner_glow',
    linearGradient: 'linear_gradient',
    radialGradient: 'radial_gradient',
    stroke: 'stroke',
    pattern: 'pattern',
} as const;

function number(value: number): string {
    return floatLiteral(value, 'F');
}

function numbers(...values: number[]): string {
    return values.map(number).join(', ');
}

/** The array of a ramp's stops. */
function stopsArray(name: string, stops: RampStop[]): string {
    const entries = stops.map(
        ({ color, opacity, place }) => `{0x${color}, ${numbers(opacity, place)}}`,
    );
    const start = `    const vorel_stop ${name}[] = {`;
    const line = `${start}${entries.join(', ')}};\n`;
    if (line.length <= width + 1) return line;
    return `${start}\n${entries.map((entry) => `        ${entry},\n`).join('')}    };\n`;
}

/** The name of a ramp's array: 'outer_glow_stops'. */
function stopsName(call: EffectCall): string {
    return `${functions[call.kind]}_stops`;
}

function handedOver(call: EffectCall & { stops: RampStop[] }): string {
    return call.stops.length === 0 ? 'NULL, 0' : `${stopsName(call)}, ${call.stops.length}`;
}

/** The arguments of the call behind the look. */
function argumentsOf(call: EffectCall, patterns: PatternNames): string {
    switch (call.kind) {
        case 'outerShadow':
        case 'innerShadow':
            return `${numbers(call.angle, call.distance, call.size)}, 0x${call.color}, ${number(call.opacity)}`;
        case 'outerGlow':
        case 'innerGlow':
            return `${number(call.size)}, 0x${call.color}, ${number(call.opacity)}, ${handedOver(call)}`;
        case 'linearGradient':
            return `${numbers(call.angle, call.scale, call.opacity)}, ${handedOver(call)}`;
        case 'radialGradient':
            return `${numbers(call.scale, call.opacity)}, ${handedOver(call)}`;
        case 'stroke': {
            const where = `VOREL_${call.position.toUpperCase()}`;
            return `${number(call.size)}, 0x${call.color}, ${number(call.opacity)}, ${where}`;
        }
        case 'pattern':
            return `${patterns.get(call.image) ?? 'pattern'}, ${numbers(call.scale, call.opacity)}`;
    }
}

function callLines(look: PlacedLook, patterns: PatternNames): string[] {
    const { fill, textOpacity } = look;
    const fillCall = fill
        ? `fill(*look, 0x${fill.color}, ${number(fill.opacity)})`
        : 'no_fill(*look)';
    return [
        fillCall,
        ...(textOpacity === 1 ? [] : [`text_opacity(*look, ${number(textOpacity)})`]),
        ...look.calls.map(
            (call) => `${functions[call.kind]}(*look, ${argumentsOf(call, patterns)})`,
        ),
    ].map((call) => `    if (status == VOREL_OK) status = vorel_look_${call};\n`);
}

function lookFunction(look: PlacedLook, name: string, patterns: PatternNames): string {
    const taken = patternsOf(look, patterns).map((pattern) => `, const vorel_pixels* ${pattern}`);
    const said = look.description === '' ? [] : [look.description];
    const comments = [
        ...said.map(sentence),
        ...unpaintedComments(look),
        "Makes the look. It is the caller's to free, also where this fails.",
    ];
    return [
        ...comments.map((line) => `// ${line}\n`),
        `vorel_status ${name}(vorel_look** look${taken.join('')}) {\n`,
        ...look.calls.map((call) =>
            'stops' in call && call.stops.length > 0 ? stopsArray(stopsName(call), call.stops) : '',
        ),
        '    vorel_status status = vorel_look_new(look);\n',
        ...callLines(look, patterns),
        '    return status;\n}\n',
    ].join('');
}

const runs = `// A list of glyphs with a text box of its own.
typedef struct title_run {
    const vorel_glyph* glyphs;
    size_t count;
} title_run;

static vorel_status paint_title_runs(vorel_look* look, const title_run* runs, size_t count,
                                     const vorel_view* page, int32_t x, int32_t y) {
    vorel_painter* painter = NULL;
    vorel_status status = vorel_painter_new(&look, 1, &painter);
    for (size_t i = 0; i < count && status == VOREL_OK; ++i)
        status = vorel_painter_paint(painter, runs[i].glyphs, runs[i].count, page, x, y, NULL);
    vorel_painter_free(painter);
    return status;
}
`;

/** How a look is called among so many. */
function variable(i: number, count: number): string {
    return count === 1 ? 'look' : `looks[${i}]`;
}

/** The statement that paints one look in its place. */
function painting(look: Pick<PlacedLook, 'x' | 'y' | 'span'>, i: number, count: number): string {
    const place = `page, ${moved('x', look.x)}, ${moved('y', look.y)}`;
    const { span } = look;
    const own = variable(i, count);
    const call =
        span === 'block'
            ? `vorel_paint(&${own}, 1, text, count, ${place}, NULL)`
            : `paint_title_runs(${own}, ${span}s, ${span}_count, ${place})`;
    return `    if (status == VOREL_OK) status = ${call};\n`;
}

function parametersOf(looks: PlacedLook[], patterns: PatternNames): string {
    const hasBlock = looks.some((look) => look.span === 'block');
    const parameters = [
        ...(hasBlock ? ['const vorel_glyph* text, size_t count'] : []),
        ...spansOf(looks).map((span) => `const title_run* ${span}s, size_t ${span}_count`),
        ...[...patterns.values()].map((pattern) => `const vorel_pixels* ${pattern}`),
        'const vorel_view* page, int32_t x, int32_t y',
    ];
    return inLines(parameters, 25, 102);
}

/** The statements that make the looks. */
function making(looks: PlacedLook[], patterns: PatternNames): string[] {
    const count = looks.length;
    return looks.map((look, i) => {
        const taken = patternsOf(look, patterns).map((pattern) => `, ${pattern}`);
        const call = `${nameOf(i, count)}(&${variable(i, count)}${taken.join('')})`;
        return `${i === 0 ? '    vorel_status' : '    if (status == VOREL_OK)'} status = ${call};\n`;
    });
}

/** The declaration of the looks, the statement that paints them as a stack, and those that free them. */
function stackStatements(count: number): { declared: string; painted: string; freed: string } {
    if (count === 1) {
        return {
            declared: '    vorel_look* look = NULL;\n',
            painted: painting({ x: 0, y: 0, span: 'block' }, 0, 1),
            freed: '    vorel_look_free(look);\n',
        };
    }
    const call = `vorel_paint(looks, ${count}, text, count, page, x, y, NULL)`;
    return {
        declared: `    vorel_look* looks[${count}] = {NULL};\n`,
        painted: `    if (status == VOREL_OK) status = ${call};\n`,
        freed: `    for (size_t i = 0; i < ${count}; ++i)\n        vorel_look_free(looks[i]);\n`,
    };
}

function paintFunction(looks: PlacedLook[], patterns: PatternNames): string {
    const count = looks.length;
    const { declared, painted, freed } = stackStatements(count);
    return [
        '// Paints the text with its origin at (x, y), look by look, each over those before.\n',
        ...(spansOf(looks).length > 0 ? ['// Runs stand in reading order.\n'] : []),
        `vorel_status paint_title(${parametersOf(looks, patterns)}) {\n`,
        declared,
        ...making(looks, patterns),
        ...(isPlainStack(looks) ? [painted] : looks.map((look, i) => painting(look, i, count))),
        freed,
        '    return status;\n}\n',
    ].join('');
}

function nameOf(i: number, count: number): string {
    return count === 1 ? 'title_look' : `title_look_${i + 1}`;
}

/** Functions of voreleffect_c.h: one for each look, and the one that paints them. */
export const c: Exporter = (work) => {
    const looks = placedLooks(work);
    const patterns = patternNames(work);
    const header = headerLines(work, 'R, G, B, A', sentence);
    const parts = looks.map((look, i) => lookFunction(look, nameOf(i, looks.length), patterns));
    if (spansOf(looks).length > 0) parts.push(runs);
    parts.push(paintFunction(looks, patterns));
    const include = '#include <voreleffect/voreleffect_c.h>\n';
    const text = `${header}${include}\n${parts.join('\n')}`;
    return { name: 'title.c', language: 'c', text, ...noted(...glyphNotes(work, looks)) };
};
