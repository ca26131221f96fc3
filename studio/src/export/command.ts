import { noted } from './exported';
import type { Exporter } from './exported';
import { patternFiles } from './patterns';
import { styleName } from './style';
import { fontNames, textOptions } from './text_options';
import { hasUnseen, printable, printfFormat, sentence, shellWord, wellFormed } from './words';

const width = 100;

/**
 * The text as the last word of a command, and what stands before the command for it. Characters that a
 * terminal would act upon, or that would not be seen, are printed by the shell; a substitution drops line
 * feeds at the end, so a point stands behind them and is cut off again.
 */
function textWord(text: string): { before: string; word: string } {
    if (!hasUnseen(text)) return { before: '', word: shellWord(wellFormed(text)) };
    return { before: `text=$(printf -- ${printfFormat(text + '.')})\n`, word: '"${text%.}"' };
}

/** A font's name as a word; what is not seen in it is spelled, as no font has such a name. */
function nameWord(name: string): string {
    return shellWord(printable(name));
}

/** What stands between an option and its value: one that begins with a dash would be an option itself. */
function between(value: string | number): string {
    return String(value).startsWith('-') ? '=' : ' ';
}

/** A command line of vorelpaint for a POSIX shell, with the style file beside it. */
export const command: Exporter = (work, engine) => {
    const { align, lineHeight, letterSpacing, markup, padding, background } = textOptions(work);
    const { before, word } = textWord(work.text);
    const options: [string, string | number | undefined][] = [
        ['--style', styleName],
        ...fontNames(work, engine).map((name): [string, string] => ['--font', name]),
        ['--size', work.size],
        ['--align', align],
        ['--line-height', lineHeight],
        ['--letter-spacing', letterSpacing],
        ['--opacity', work.opacity === 1 ? undefined : work.opacity],
        ['--padding', padding],
        ['--background', background],
    ];
    const parts = options.flatMap(([name, value]) =>
        value === undefined ? [] : [`${name}${between(value)}${nameWord(String(value))}`],
    );
    const all = [
        'vorelpaint',
        ...parts,
        ...(markup ? ['--markup'] : []),
        '-o title.png',
        `-- ${word}`,
    ];
    const isLong = all.join(' ').length > width;
    const said = work.style.description ?? '';
    const comment = said === '' ? '' : `# ${sentence(said)}\n`;
    const text = `${comment}${before}${all.join(isLong ? ' \\\n    ' : ' ')}\n`;
    const files = [styleName, ...patternFiles(work.style).values()].join(', ');
    const zero = work.text.includes('\0') ? 'No command takes a text with U+0000.' : undefined;
    return { name: 'title.sh', language: 'sh', text, ...noted(`It reads ${files}.`, zero) };
};
