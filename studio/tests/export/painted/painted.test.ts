import { execFileSync } from 'node:child_process';
import { mkdirSync, readFileSync, symlinkSync, writeFileSync } from 'node:fs';
import { join } from 'node:path';
import type { Pixels } from 'voreleffect/text';
import { load } from 'voreleffect/text';
import { beforeAll, describe, expect, it } from 'vitest';
import type { ExportEngine, ExportName } from '../../../src/export';
import { exporters, patternFiles, patternPictures } from '../../../src/export';
import { isPlainStack, patternNames, placedLooks, spansOf } from '../../../src/export/looks';
import type { PatternPixels, Work } from '../../../src/model/work';
import { handMade, presetWorks } from '../samples';

/*
 * Every export of every sample is compiled, run, and compared with the package of Python's picture of the
 * same style, which has vorelpaint's pixels. scripts/export_test.sh builds what this needs and names it:
 *
 *   VOREL_EXPORTS   a folder to work in
 *   VOREL_BUILD     the build of the library and of vorelpaint
 *   VOREL_PYTHON    a Python that has the package
 *   VOREL_JAVA      the face of Java: the classes and the folders of the native libraries
 *   VOREL_FONT      the file of the samples' font
 */
const { VOREL_EXPORTS: folder = '', VOREL_BUILD: build = '' } = process.env;
const root = new URL('../../../..', import.meta.url).pathname;
const here = new URL('.', import.meta.url).pathname;

const works = new Map([...presetWorks(), ...Object.entries(handMade)]);
const names = [...works.keys()];
/** Masks have no colours of words, and no background. */
const ofMasks = names.filter((name) => !works.get(name)?.markup);

/** The package writes the calls of the classes, as it does for the page. */
async function engineOfThePage(): Promise<ExportEngine> {
    const { Style } = await load();
    const pixelsOf = ({ width, height, data }: PatternPixels): Pixels => ({
        width,
        height,
        data: new Uint8ClampedArray(Buffer.from(data, 'base64')),
    });
    return {
        toCpp: (style, size, { name, patterns, ...options }) => {
            const pictures = Object.entries(patterns).map(([image, each]) => [
                image,
                pixelsOf(each),
            ]);
            const images = Object.fromEntries(pictures) as Record<string, Pixels>;
            return Style.fromJSON(style, { images }).toCpp(name, size, options);
        },
    };
}

function run(program: string, words: string[], cwd = folder, env: NodeJS.ProcessEnv = {}): string {
    const options = { cwd, env: { ...process.env, ...env }, encoding: 'utf8' } as const;
    return execFileSync(program, words, { ...options, stdio: ['ignore', 'pipe', 'pipe'] });
}

function write(file: string, text: string): void {
    writeFileSync(join(folder, file), text);
}

/** The source in a namespace of its own; what it includes is there already. */
function inNamespace(name: string, source: string, rest: string): string {
    const code = source.replace(/^#include .*$/gm, '');
    return `namespace ${name} {\n${code}\n${rest}\n}  // namespace ${name}\n`;
}

/** How the samples' spans are called in runs.h: a list of glyphs cannot be called as the text's glyphs. */
const spanFields = { line: 'lines', word: 'words', glyph: 'letters' } as const;

/** The arguments of an exported function that paints, behind those of the text. */
function handed(
    work: Work,
    text: string,
    span: (field: string) => string,
    pattern: (i: number) => string,
): string[] {
    const looks = placedLooks(work);
    const isPlain = isPlainStack(looks);
    const hasBlock = looks.some((look) => look.span === 'block');
    return [
        ...(hasBlock || isPlain ? [text] : []),
        ...spansOf(looks).map((each) => span(spanFields[each])),
        ...[...patternNames(work).values()].map((_, i) => pattern(i)),
    ];
}

function cppLookCase(work: Work, source: string, i: number): string {
    const looks = placedLooks(work);
    const pattern = (at: number): string => `text.patterns[${at}]`;
    const patterns = [...patternNames(work).values()].map((_, at) => pattern(at)).join(', ');
    const call = isPlainStack(looks)
        ? `bool(paint(${looks.length === 1 ? 'titleLook' : 'titleLooks'}(${patterns}), text.glyphs, page, x, y))`
        : `paintTitle(${handed(work, 'text.glyphs', (field) => `text.${field}`, pattern).join(', ')}, page, x, y)`;
    return inNamespace(
        `look_${i}`,
        source,
        `bool run(const Text& text, const PictureView& page, int x, int y) {\n    return ${call};\n}`,
    );
}

function classCase(source: string, i: number): string {
    const list = source.includes('addTitleLooks')
        ? '    for (const AddTitleLook& look : addTitleLooks)\n' +
          '        looks.push_back({look.add, look.offsetX, look.offsetY, look.span});\n'
        : '    looks.push_back({addTitle, 0, 0, "block"});\n';
    return inNamespace(
        `classes_${i}`,
        source,
        `std::vector<ClassLook> looks() {\n    std::vector<ClassLook> looks;\n${list}    return looks;\n}`,
    );
}

function cCase(work: Work, source: string, i: number): string {
    const code = source.replace(/^#include .*$/gm, '').replace(/\b(paint_)?title_?\w*/g, `$&_${i}`);
    const runs = (field: string): string => {
        const count = `text->${field.slice(0, -1)}_count`;
        return `(const title_run_${i}*)text->${field}, ${count}`;
    };
    const words = handed(work, 'text->glyphs, text->count', runs, (at) => `&text->patterns[${at}]`);
    return (
        `${code}\nvorel_status run_${i}(const c_text* text, const vorel_view* page, int32_t x, int32_t y) {\n` +
        `    return paint_title_${i}(${words.join(', ')}, page, x, y);\n}\n`
    );
}

function javaCase(work: Work, i: number): string {
    const looks = placedLooks(work);
    const pattern = (at: number): string =>
        `text.patterns.get(${at}), text.widths.get(${at}), text.heights.get(${at})`;
    const patterns = [...patternNames(work).values()].map((_, at) => pattern(at)).join(', ');
    if (!isPlainStack(looks)) {
        const words = handed(work, 'text.glyphs', (field) => `text.${field}()`, pattern);
        return `Title${i}.paint(${words.join(', ')}, page, x, y);`;
    }
    if (looks.length === 1) return `Title${i}.look(${patterns}).paint(text.glyphs, page, x, y);`;
    return (
        `try (Painter painter = new Painter(Title${i}.looks(${patterns}))) {\n` +
        '    painter.paint(text.glyphs, page, x, y);\n}'
    );
}

/** All sources of one export, by the samples' names. */
const sources = new Map<string, Map<ExportName, string>>();

function sourceOf(name: string, kind: ExportName): string {
    return sources.get(name)?.get(kind) ?? '';
}

/** Each sample has a folder with what is exported, and with the pictures of its patterns. */
async function exportAll(): Promise<void> {
    const engine = await engineOfThePage();
    for (const [name, work] of works) {
        mkdirSync(join(folder, name), { recursive: true });
        for (const picture of await patternPictures(work))
            writeFileSync(join(folder, name, picture.name), picture.bytes);
        const made = new Map<ExportName, string>();
        for (const [kind, exporter] of Object.entries(exporters)) {
            const { name: file, text } = exporter(work, engine);
            write(join(name, file), text);
            made.set(kind as ExportName, text);
        }
        sources.set(name, made);
    }
}

function number(value: number): Buffer {
    const bytes = Buffer.alloc(4);
    bytes.writeInt32BE(value);
    return bytes;
}

function patternBytes(work: Work): Buffer {
    const images = [...patternNames(work).keys()];
    const pictures = images.flatMap((image) => work.patterns[image] ?? []);
    const parts = pictures.flatMap(({ width, height, data }) => [
        number(width),
        number(height),
        Buffer.from(data, 'base64'),
    ]);
    return Buffer.concat([number(pictures.length), ...parts]);
}

/** The masks of all samples' glyphs, by the layout of the project's own. */
function writeMasks(): void {
    const aligns = ['left', 'center', 'right', 'start', 'end'];
    const lines = Array.from(works, ([name, work]) => {
        const spacing = parseFloat(work.letterSpacing);
        const pixels = work.letterSpacing.endsWith('%') ? (spacing * work.size) / 100 : spacing;
        const text = Buffer.from(work.text).toString('hex');
        writeFileSync(join(folder, `${name}.patterns`), patternBytes(work));
        const align = aligns.indexOf(work.align);
        return `${name}.masks ${work.size} ${align} ${work.lineHeight} ${Math.round(pixels * 64)} ${text}\n`;
    });
    write('masks.txt', lines.join(''));
    const libraries = ['harfbuzz', 'fribidi', 'freetype2', 'libunibreak'];
    const flags = run('pkg-config', ['--libs', ...libraries])
        .trim()
        .split(/\s+/);
    const own = [join(build, 'text/libvoreltext.a'), ...library()];
    const program = join(folder, 'glyph_masks');
    run('g++', [
        '-std=c++17',
        ...warnings,
        join(here, 'glyph_masks.cpp'),
        `-I${root}`,
        ...headers,
        '-o',
        program,
        ...own,
        ...flags,
    ]);
    run(program, [process.env.VOREL_FONT ?? '', 'masks.txt']);
}

const warnings = ['-Wall', '-Wextra', '-Wconversion', '-Werror'];
const headers = [`-I${join(root, 'include')}`, `-I${here}`];

function library(): string[] {
    return [`-L${build}`, '-lvoreleffect', `-Wl,-rpath,${build}`];
}

/** One program of all samples' code in C++ and C: a source for each of the three faces. */
function buildNative(): void {
    const code = (write: (name: string, work: Work, i: number) => string): string =>
        names.map((name, i) => write(name, works.get(name) as Work, i)).join('\n');
    const table = names.map(
        (name, i) => `    {"${name}", look_${i}::run, classes_${i}::looks, run_${i}},\n`,
    );
    const declared = (line: (i: number) => string): string => names.map((_, i) => line(i)).join('');
    write(
        'looks.cpp',
        '#include "runs.h"\n' +
            code((name, work, i) => cppLookCase(work, sourceOf(name, 'cpp-look'), i)),
    );
    write(
        'classes.cpp',
        '#include <voreleffect/voreleffect.h>\n#include "runs.h"\n' +
            code((name, _work, i) => classCase(sourceOf(name, 'cpp-classes'), i)),
    );
    write(
        'in_c.c',
        '#include "runs.h"\n' + code((name, work, i) => cCase(work, sourceOf(name, 'c'), i)),
    );
    write(
        'table.cpp',
        '#include "runs.h"\n' +
            declared(
                (i) =>
                    `namespace look_${i} { bool run(const Text&, const VFontEffect::PictureView&, int, int); }\n`,
            ) +
            declared((i) => `namespace classes_${i} { std::vector<ClassLook> looks(); }\n`) +
            declared(
                (i) =>
                    `extern "C" vorel_status run_${i}(const c_text*, const vorel_view*, int32_t, int32_t);\n`,
            ) +
            `const Case kCases[] = {\n${table.join('')}};\nconst int kCaseCount = ${names.length};\n`,
    );
    run('gcc', ['-std=c99', '-Wpedantic', ...warnings, ...headers, '-c', 'in_c.c']);
    const ours = ['table.cpp', 'looks.cpp', 'classes.cpp', join(here, 'run_exports.cpp')];
    run('g++', [
        '-std=c++17',
        ...warnings,
        ...headers,
        ...ours,
        'in_c.o',
        '-o',
        'run_exports',
        ...library(),
    ]);
}

function runJava(): void {
    const [classes = '', libraries = ''] = (process.env.VOREL_JAVA ?? '').split(':::');
    mkdirSync(join(folder, 'java'), { recursive: true });
    const files = names.map((name, i) => {
        const file = join('java', `Title${i}.java`);
        write(file, sourceOf(name, 'java').replace(/\bTitle\b/g, `Title${i}`));
        return file;
    });
    const cases = names.map(
        (name, i) =>
            `case "${name}": return (text, page, x, y) -> {\n${javaCase(works.get(name) as Work, i)}\n};\n`,
    );
    write(
        'java/Cases.java',
        'import org.voreleffect.Painter;\n\nfinal class Cases {\n    private Cases() {}\n\n' +
            '    static RunExports.Case named(String name) {\n        switch (name) {\n' +
            `${cases.join('')}default: throw new IllegalArgumentException(name);\n}\n}\n}\n`,
    );
    const all = [...files, 'java/Cases.java', join(here, 'RunExports.java')];
    run('javac', ['-Xlint:all', '-Werror', '-cp', classes, '-d', 'java', ...all]);
    run('java', [
        `-Djava.library.path=${libraries}`,
        '-cp',
        `${classes}:java`,
        'RunExports',
        folder,
    ]);
}

function bytesOf(name: string, kind: string): Buffer {
    return readFileSync(join(folder, `${name}${kind}.rgba`));
}

function runJavaScript(): void {
    symlinkSync(join(root, 'studio/node_modules'), join(folder, 'node_modules'));
    const files = names.map((name) => {
        const { style } = works.get(name) as Work;
        return [name, Object.fromEntries(patternFiles(style))];
    });
    write('patterns.json', JSON.stringify(Object.fromEntries(files)));
    run('node', [join(here, 'run_javascript.mjs'), folder, process.env.VOREL_FONT ?? '']);
}

describe.skipIf(folder === '')('an export', () => {
    beforeAll(async () => {
        await exportAll();
        write('cases.json', JSON.stringify(Object.fromEntries(works)));
        const python = process.env.VOREL_PYTHON ?? '';
        const PATH = `${join(build, 'tools')}:${process.env.PATH ?? ''}`;
        run(python, ['-B', join(here, 'reference.py'), folder], folder, { PATH });
        writeMasks();
        buildNative();
        run(join(folder, 'run_exports'), [folder]);
        runJava();
        runJavaScript();
    }, 300_000);

    it.each(['cpp-look', 'cpp-classes', 'c', 'java'])('for %s paints the very bytes', (kind) => {
        const other = ofMasks.filter(
            (name) => !bytesOf(name, `.${kind}`).equals(bytesOf(name, '')),
        );
        expect(other).toEqual([]);
    });
    it.each(['python', 'javascript', 'command'])('for %s paints the very bytes', (kind) => {
        const painted = (name: string): Buffer => bytesOf(name, `.${kind}`);
        const other = names.filter((name) => !painted(name).equals(bytesOf(name, '.straight')));
        expect(other).toEqual([]);
    });
    it('is not all of clear pixels', () => {
        const clear = names.filter((name) => bytesOf(name, '').every((byte) => byte === 0));
        expect(clear).toEqual([]);
    });
});
