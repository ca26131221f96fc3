import { decode } from 'fast-png';
import { describe, expect, it } from 'vitest';
import type { CppOptions, ExportEngine, ExportName } from '../../src/export';
import { exporters, patternFiles, patternPictures } from '../../src/export';
import type { LookStyle } from '../../src/model/style_file';
import type { Work } from '../../src/model/work';
import { tile, workOf } from './samples';

const engine: ExportEngine = { toCpp: (_style, size, options) => `// ${options.name} ${size}\n` };

function textOf(name: ExportName, looks: LookStyle[], other: Partial<Work> = {}): string {
    return exporters[name](workOf(looks, other), engine).text;
}
function noteOf(name: ExportName, looks: LookStyle[], other: Partial<Work> = {}): string {
    return exporters[name](workOf(looks, other), engine).note ?? '';
}

const badge: LookStyle = {
    color: '#36C',
    outerShadow: { angle: 120, distance: '10%', size: 8.5, color: '#101828', opacity: 0.6 },
    stroke: { size: 3, color: '#fff', position: 'center' },
    linearGradient: {
        angle: 90,
        gradient: [
            { location: 0, color: '#FF4E50' },
            { location: 1, color: '#F9E26B', opacity: 0.5 },
        ],
    },
};
const moved: LookStyle[] = [
    { color: '#000', offset: { x: 3, y: -2 } },
    { color: '#FFF', span: 'word' },
];
const patterned: LookStyle[] = [{ pattern: { image: 'a/b.png', scale: 2 } }];
const withTile = { patterns: { 'a/b.png': tile } };

describe('a badge', () => {
    it('is a function of look.h', () => {
        expect(textOf('cpp-look', [badge])).toBe(`// Lengths are in pixels, for text of 40 pixels.
// To lay text over a page, its origin at (x, y):
//     paint(titleLook(), glyphs, page, x, y);
#include <voreleffect/look.h>

using namespace VFontEffect;

Look titleLook() {
    return Look()
        .fill(rgb(0x3366CC))
        .add(OuterShadow(rgb(0x101828)).angle(120).distance(4).size(8.5F).opacity(0.6F))
        .add(Stroke(3, rgb(0xFFFFFF)).position(Position::centre))
        .add(LinearGradient({{rgb(0xFF4E50), 1, 0}, {rgb(0xF9E26B), 0.5F, 1}}).angle(90));
}
`);
    });
    it('is two functions of C', () => {
        expect(textOf('c', [badge])).toBe(`// Lengths are in pixels, for text of 40 pixels.
#include <voreleffect/voreleffect_c.h>

// Makes the look. It is the caller's to free, also where this fails.
vorel_status title_look(vorel_look** look) {
    const vorel_stop linear_gradient_stops[] = {{0xFF4E50, 1, 0}, {0xF9E26B, 0.5F, 1}};
    vorel_status status = vorel_look_new(look);
    if (status == VOREL_OK) status = vorel_look_fill(*look, 0x3366CC, 1);
    if (status == VOREL_OK) status = vorel_look_outer_shadow(*look, 120, 4, 8.5F, 0x101828, 0.6F);
    if (status == VOREL_OK) status = vorel_look_stroke(*look, 3, 0xFFFFFF, 1, VOREL_CENTRE);
    if (status == VOREL_OK) status = vorel_look_linear_gradient(*look, 90, 1, 1, linear_gradient_stops, 2);
    return status;
}

// Paints the text with its origin at (x, y), look by look, each over those before.
vorel_status paint_title(const vorel_glyph* text, size_t count,
                         const vorel_view* page, int32_t x, int32_t y) {
    vorel_look* look = NULL;
    vorel_status status = title_look(&look);
    if (status == VOREL_OK) status = vorel_paint(&look, 1, text, count, page, x, y, NULL);
    vorel_look_free(look);
    return status;
}
`);
    });
    it('is a class of Java', () => {
        expect(textOf('java', [badge])).toBe(`import org.voreleffect.Look;
import org.voreleffect.Position;
import org.voreleffect.Stops;

// Lengths are in pixels, for text of 40 pixels.
// To lay text over a page, its origin at (x, y):
//     Title.look().paint(glyphs, page, x, y);
final class Title {
    private Title() {}

    static Look look() {
        return new Look()
                .fill(0x3366CC)
                .outerShadow(120, 4, 8.5f, 0x101828, 0.6f)
                .stroke(3, 0xFFFFFF, Position.CENTRE)
                .linearGradient(90, 1, 1, Stops.builder()
                        .add(0xFF4E50, 0)
                        .add(0xF9E26B, 0.5f, 1)
                        .build());
    }
}
`);
    });
    it('is a program of Python', () => {
        expect(textOf('python', [badge])).toBe(`"""Paints a text into title.png."""

import voreleffect as ve

look = (ve.Look()
        .fill("#3366CC")
        .outer_shadow("#101828", angle=120, distance=4, size=8.5, opacity=0.6)
        .stroke(3, "#FFFFFF", position="centre")
        .linear_gradient([("#FF4E50", 0), ("#F9E26B", 1, 0.5)], angle=90))
image = ve.text("Title", font="DejaVu Sans:bold", size=40, look=look)
image.save("title.png")
`);
    });
    it('is a module of JavaScript', () => {
        expect(textOf('javascript', [badge])).toBe(`import { load } from 'voreleffect/text';

const { Font, Look, Text } = await load();

// Font: DejaVu Sans:bold.
/** Paints a text; takes the bytes of a font file. */
export function paintTitle(font) {
    const look = new Look()
        .fill('#3366CC')
        .outerShadow('#101828', { angle: 120, distance: 4, size: 8.5, opacity: 0.6 })
        .stroke(3, '#FFFFFF', { position: 'centre' })
        .linearGradient([['#FF4E50', 0], ['#F9E26B', 1, 0.5]], { angle: 90 });
    return Text.picture('Title', { fonts: new Font(font), size: 40, look });
}
`);
    });
    it('is a style file', () => {
        expect(textOf('style', [badge])).toBe(`{
  "version": 2,
  "looks": [
    {
      "color": "#36C",
      "outerShadow": {
        "angle": 120,
        "distance": "10%",
        "size": 8.5,
        "color": "#101828",
        "opacity": 0.6
      },
      "stroke": { "size": 3, "color": "#fff", "position": "center" },
      "linearGradient": {
        "angle": 90,
        "gradient": [
          { "location": 0, "color": "#FF4E50" },
          { "location": 1, "color": "#F9E26B", "opacity": 0.5 }
        ]
      }
    }
  ]
}
`);
    });
    it('is a command', () => {
        expect(textOf('command', [badge])).toBe(
            "vorelpaint --style title.json --font 'DejaVu Sans:bold' --size 40 -o title.png -- Title\n",
        );
    });
});

describe('looks that are moved or of words', () => {
    it('are painted one after the other by look.h', () => {
        expect(textOf('cpp-look', moved)).toContain(
            '    if (!paint(titleLook1(), text, page, x + 3, y - 2)) return false;\n' +
                '    Painter painter2(titleLook2());\n' +
                '    for (const std::vector<Glyph>& run : words)\n' +
                '        if (!painter2.paint(run, page, x, y)) return false;\n',
        );
    });
    it('are painted one after the other in C', () => {
        expect(textOf('c', moved)).toContain(
            '    if (status == VOREL_OK) status = vorel_paint(&looks[0], 1, text, count, page, x + 3, y - 2, NULL);\n' +
                '    if (status == VOREL_OK) status = paint_title_runs(looks[1], words, word_count, page, x, y);\n',
        );
    });
    it('are painted one after the other in Java', () => {
        expect(textOf('java', moved)).toContain(
            '        look1().paint(text, page, x + 3, y - 2);\n' +
                '        try (Painter painter = new Painter(look2())) {\n' +
                '            for (List<Glyph> run : words) painter.paint(run, page, x, y);\n        }\n',
        );
    });
    it('are a whole style in Python and JavaScript', () => {
        expect(textOf('python', moved)).toContain('look = ve.Style.from_json({\n    "version": 2,');
        expect(textOf('javascript', moved)).toContain('const look = Style.fromJSON({');
    });
    it('need lists of glyphs, as the note says', () => {
        expect(noteOf('cpp-look', moved)).toContain(
            'It takes a list of glyphs for each of the words.',
        );
    });
});

it('A stack of looks is one in every language', () => {
    const stack: LookStyle[] = [{ color: '#000' }, { color: '#FFF' }];
    expect(textOf('cpp-look', stack)).toContain('return {titleLook1(), titleLook2()};');
    expect(textOf('c', stack)).toContain('vorel_paint(looks, 2, text, count, page, x, y, NULL)');
    expect(textOf('java', stack)).toContain('return new Look[] {look1(), look2()};');
    expect(textOf('python', stack)).toContain(
        'look = [\n    (ve.Look()\n        .fill("#000000")),',
    );
    expect(textOf('javascript', stack)).toContain(
        "const look = [\n        new Look()\n            .fill('#000000'),",
    );
});

describe('the opacity of the text', () => {
    const looks: LookStyle[] = [{ textOpacity: 0.9 }, { textOpacity: 0.8 }, { fill: false }];
    it('is that of the topmost look that is filled', () => {
        const found = textOf('python', looks, { opacity: 0.25 }).match(/text_opacity\(.*?\)/g);
        expect(found).toEqual(['text_opacity(0.9)', 'text_opacity(0.25)']);
    });
    it('is an argument where there is a whole style', () => {
        expect(textOf('python', moved, { opacity: 0.25 })).toContain('opacity=0.25');
        expect(textOf('javascript', moved, { opacity: 0.25 })).toContain('opacity: 0.25');
        expect(textOf('command', looks, { opacity: 0.25 })).toContain(' --opacity 0.25 ');
        expect(noteOf('style', looks, { opacity: 0.25 })).toContain('--opacity');
    });
    it('is handed to the writer of classes, which 1 is not', () => {
        const given: CppOptions[] = [];
        const asked: ExportEngine = {
            toCpp: (_style, _size, options) => (given.push(options), ''),
        };
        exporters['cpp-classes'](workOf(looks, { opacity: 0.25 }), asked);
        exporters['cpp-classes'](workOf(looks), asked);
        expect(given.map(({ name, opacity }) => [name, opacity])).toEqual([
            ['addTitle', 0.25],
            ['addTitle', undefined],
        ]);
    });
});

describe('a pattern', () => {
    it('is a parameter where there are masks', () => {
        const cpp = textOf('cpp-look', patterned, withTile);
        expect(cpp).toContain('// pattern: the pixels of b.png, straight R, G, B, A.\n');
        expect(cpp).toContain('Look titleLook(const PixelView& pattern) {');
        expect(cpp).toContain('.add(Pattern(pattern).scale(2))');
        expect(textOf('java', patterned, withTile)).toContain(
            '.pattern(pattern, patternWidth, patternHeight, 2, 1)',
        );
    });
    it('is a file beside the others', () => {
        expect(textOf('python', patterned, withTile)).toContain(
            '.pattern(PIL.Image.open("b.png").convert("RGBA"), scale=2)',
        );
        expect(textOf('style', patterned, withTile)).toContain('"image": "b.png"');
        expect(noteOf('style', patterned, withTile)).toBe('b.png must lie beside it.');
        expect(noteOf('command', patterned, withTile)).toBe('It reads title.json, b.png.');
    });
    it('has a file of its very pixels', async () => {
        const pictures = await patternPictures(workOf(patterned, withTile));
        expect(pictures.map(({ name }) => name)).toEqual(['b.png']);
        const { width, height, data } = decode(pictures[0]?.bytes ?? new Uint8Array());
        expect([width, height]).toEqual([5, 3]);
        expect(Buffer.from(data as Uint8Array).toString('base64')).toBe(tile.data);
    });
    it('has a name that is plain, and of its own', () => {
        const images = ['/x/A.png', 'b/a.PNG', '..', '-rf', '__proto__', "it's; rm", '../../etc/x'];
        const looks = images.map((image) => ({ pattern: { image } }));
        expect([...patternFiles({ version: 2, looks }).values()]).toEqual([
            ...[
                'A.png',
                'a-2.png',
                'pattern.png',
                'rf.png',
                '__proto__.png',
                'it-s-rm.png',
                'x.png',
            ],
        ]);
    });
    it.each([
        [{ width: 257, height: 256, data: '' }, 'more than 65536 pixels'],
        [undefined, 'has no picture'],
    ])('that cannot be written as classes is told', (picture, told) => {
        const patterns: Work['patterns'] = picture ? { 'a/b.png': picture } : {};
        const { text, note } = exporters['cpp-classes'](workOf(patterned, { patterns }), engine);
        expect(text).toMatch(/^\/\/ .*\n$/);
        expect(text).toContain(told);
        expect(note).toContain(told);
    });
});

describe('the text around the look', () => {
    const other: Partial<Work> = {
        text: "It's\ntwo",
        align: 'center',
        lineHeight: 1.2,
        letterSpacing: '-5%',
        markup: true,
        padding: 20,
        background: '#204060',
    };
    it('is told to Python', () => {
        expect(textOf('python', [{}], other)).toContain(`image = ve.text(
    "It's\\ntwo",
    font="DejaVu Sans:bold",
    size=40,
    look=look,
    align="center",
    line_height=1.2,
    letter_spacing="-5%",
    padding=20,
    background="#204060",
    markup=True,
)
`);
    });
    it('is told to JavaScript', () => {
        expect(textOf('javascript', [{}], other))
            .toContain(`    return Text.picture('It\\'s\\ntwo', {
        fonts: new Font(font),
        size: 40,
        look,
        align: 'center',
        lineHeight: 1.2,
        letterSpacing: '-5%',
        markup: true,
        padding: 20,
        background: '#204060',
    });
`);
    });
    it('is told on the command line', () => {
        expect(textOf('command', [{}], other)).toBe(`vorelpaint \\
    --style title.json \\
    --font 'DejaVu Sans:bold' \\
    --size 40 \\
    --align center \\
    --line-height 1.2 \\
    --letter-spacing='-5%' \\
    --padding 20 \\
    --background '#204060' \\
    --markup \\
    -o title.png \\
    -- 'It'\\''s
two'
`);
    });
    it.each(['checkerboard', 'picture', 'transparent'])('has no background of %s', (background) => {
        expect(textOf('command', [{}], { background })).not.toContain('background');
    });
    it.each(['0', '0%', '0px', '-0.0'])('has no letter spacing of %s', (letterSpacing) => {
        expect(textOf('command', [{}], { letterSpacing })).not.toContain('spacing');
    });
    it('has the fonts by the names that others know', () => {
        const known = { ...engine, fontNames: ({ font }: Work) => [`${font}!`, 'Other'] };
        const work = workOf([{}], { font: 'sans' });
        expect(exporters.command(work, known).text).toContain("--font 'sans!' --font Other");
        expect(exporters.python(work, known).text).toContain('font=["sans!", "Other"]');
        const { text } = exporters.javascript(work, known);
        expect(text).toContain('// Fonts: sans!, Other.\n');
        expect(text).toContain('export function paintTitle(fonts) {');
        expect(text).toContain('fonts: fonts.map((font) => new Font(font))');
    });
    it('has colours of words that masks have not, as the note says', () => {
        for (const name of ['cpp-look', 'c', 'java', 'cpp-classes'] as const)
            expect(noteOf(name, [{}], { markup: true })).toContain(
                'Colours of words are left out.',
            );
    });
});

it('An effect that the library has no core for is a comment', () => {
    const relief = { size: 1, angle: 0, altitude: 9, highlightColor: '#FFF', shadowColor: '#000' };
    for (const name of ['cpp-look', 'c', 'java', 'python', 'javascript'] as const)
        expect(textOf(name, [{ bevel: relief }])).toContain(
            'bevel: the library has no core for it.',
        );
});

it('The order of keys is kept', () => {
    const look: LookStyle = {
        stroke: { position: 'inside', color: '#123', size: 2 },
        color: '#abc',
    };
    const said = JSON.parse(textOf('style', [look])) as { looks: LookStyle[] };
    expect(JSON.stringify(said.looks[0])).toBe(JSON.stringify(look));
});
