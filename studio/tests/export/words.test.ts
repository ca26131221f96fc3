import { execFileSync } from 'node:child_process';
import { runInNewContext } from 'node:vm';
import fc from 'fast-check';
import { describe, expect, it } from 'vitest';
import type { ExportEngine, ExportName } from '../../src/export';
import { exporters } from '../../src/export';
import { printable, stringLiteral } from '../../src/export/words';
import { workOf } from './samples';

const engine: ExportEngine = { toCpp: () => '' };

/** What breaks out of a comment or a literal somewhere, between other characters. */
const words = fc
    .array(
        fc.oneof(
            fc.constantFrom(
                ...[
                    '*/',
                    '/*',
                    '//',
                    '"""',
                    "'''",
                    '"',
                    "'",
                    '`',
                    '\\',
                    '\\u000a',
                    '\\u002a/',
                    '${x}',
                ],
                ...[
                    '\n',
                    '\r',
                    '\0',
                    '\t',
                    '\v',
                    '\f',
                    '\x1b[0m',
                    '\x85',
                    '\u2028',
                    '\u2029',
                    '\u202e',
                ],
                ...[
                    '??/',
                    '\\\n',
                    '#',
                    '$(id)',
                    '%s',
                    '!',
                    '-',
                    '--',
                    '</script>',
                    'coding: utf-7',
                    '.',
                ],
            ),
            fc.string({ unit: 'binary' }),
        ),
        { maxLength: 8 },
    )
    .map((parts) => parts.join(''));

/** What ends a line in one of the languages. */
const lineEnd = /\r\n|[\p{Cc}\u2028\u2029]/u;

const comments: [ExportName, string][] = [
    ['cpp-look', '//'],
    ['c', '//'],
    ['java', '//'],
    ['python', '#'],
    ['javascript', '//'],
    ['command', '#'],
];

describe('a description', () => {
    it.each(comments)('stays in the comments of %s', (name, mark) => {
        const code = (said: string): string[] => {
            const looks = [{ description: said }, { description: said }];
            const work = workOf({ version: 2, description: said, looks });
            const { text } = exporters[name](work, engine);
            return text.split(lineEnd).filter((line) => !line.trim().startsWith(mark));
        };
        const usual = code('A title');
        fc.assert(
            fc.property(words, (said) => {
                fc.pre(said !== '');
                expect(code(said)).toEqual(usual);
            }),
        );
    });
    it('never takes the next line into a comment of C, nor an escape of Java', () => {
        fc.assert(
            fc.property(words, (said) => {
                const work = workOf({ version: 2, description: said, looks: [{}] });
                for (const name of ['c', 'cpp-look'] as const) {
                    expect(exporters[name](work, engine).text).not.toMatch(/(\\|\?\?\/)\s*\n/);
                }
                const java = exporters.java(work, engine).text.replaceAll('\\\\', '');
                expect(java).not.toMatch(/\\u/);
            }),
        );
    });
    it("is not where Python looks for the source's encoding", () => {
        const work = workOf({ version: 2, description: 'coding: utf-7', looks: [{}] });
        const { text } = exporters.python(work, engine);
        expect(text.split('\n').slice(0, 2).join()).not.toMatch(/coding/);
    });
});

describe('a literal', () => {
    it('is the text in JavaScript and in JSON', () => {
        fc.assert(
            fc.property(words, (text) => {
                const wanted = text.replace(/\p{Surrogate}/gu, '\ufffd');
                const single = stringLiteral(text, "'");
                expect(runInNewContext(single)).toBe(wanted);
                expect(JSON.parse(stringLiteral(text, '"'))).toBe(wanted);
                expect(single).not.toMatch(lineEnd);
            }),
        );
    });
    it('is the text in Python', () => {
        const texts = fc.sample(words, 300);
        const literals = texts.map((text) => stringLiteral(text, '"')).join(',\n');
        const program = `import json\nprint(json.dumps([\n${literals}\n]))`;
        const said = execFileSync('/usr/bin/python3', ['-'], { input: program, encoding: 'utf8' });
        expect(JSON.parse(said)).toEqual(
            texts.map((text) => text.replace(/\p{Surrogate}/gu, '\ufffd')),
        );
    });
});

describe('a command', () => {
    /** A shell that runs the command with a function in place of the program, which prints its words. */
    function wordsIn(shell: string, commands: string[]): string[] {
        const program = `vorelpaint() { printf '%s\\0' "$@" '<end>'; }\n${commands.join('')}`;
        const said = execFileSync(shell, ['-s'], { input: program, encoding: 'utf8' });
        return said.split('<end>\0').slice(0, -1);
    }
    it.each(['bash', 'dash'])('hands the very text over in %s', (shell) => {
        const texts = fc.sample(words, 300).map((text) => text.replaceAll('\0', ''));
        const commands = texts.map((text) => {
            const work = workOf([{}], { text, font: text, letterSpacing: '-5%' });
            return exporters.command(work, engine).text;
        });
        const found = wordsIn(shell, commands).map((each) => each.split('\0').slice(0, -1));
        expect(found.map((each) => each.at(-1))).toEqual(
            texts.map((text) => text.replace(/\p{Surrogate}/gu, '\ufffd')),
        );
        const before = '--style title.json --size 40 --letter-spacing=-5% -o title.png --'.split(
            ' ',
        );
        for (const each of found) {
            const own = each.filter((word, i) => before.includes(word) || i === each.length - 1);
            expect(own.slice(0, -1)).toEqual(expect.arrayContaining(before));
            expect(each.length).toBeLessThanOrEqual(before.length + 3);
        }
    });
    it('has no character that a terminal acts upon', () => {
        fc.assert(
            fc.property(words, (text) => {
                const said = exporters.command(workOf([{}], { text, font: text }), engine).text;
                expect(said.replaceAll('\n', '')).not.toMatch(/[\p{Cc}\u2028-\u202e]/u);
            }),
        );
    });
});

it('What is not seen is spelled, what breaks lines is a blank', () => {
    expect(printable('a\nb\u202ec\x85d\ud800e')).toBe('a b<U+202E>c<U+0085>d\ufffde');
});
