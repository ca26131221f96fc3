import { expect, it } from 'vitest';
import type { ExportEngine } from '../../src/export';
import type { LookStyle } from '../../src/model/style_file';
import { exporters } from '../../src/export';
import { workOf } from './samples';

const engine: ExportEngine = { toCpp: () => '' };
const stroke: LookStyle = {
    stroke: { size: 2, color: '#FFFFFF', opacity: 1, position: 'outside' },
};

function exported(name: 'cpp-look' | 'java', looks: LookStyle[]): string {
    return exporters[name](workOf(looks), engine).text;
}

it('A look that is not moved says how it is painted', () => {
    expect(exported('cpp-look', [stroke])).toContain(
        '\n//     paint(titleLook(), glyphs, page, x, y);\n',
    );
    expect(exported('java', [stroke])).toContain(
        '\n//     Title.look().paint(glyphs, page, x, y);\n',
    );
});

it('A stack whose looks are not moved is painted as one', () => {
    expect(exported('cpp-look', [stroke, {}])).toContain(
        'paint(titleLooks(), glyphs, page, x, y);',
    );
    expect(exported('java', [stroke, {}])).toContain('new Painter(Title.looks()))');
});

it('Looks that are moved have a function that paints them', () => {
    const moved = [{ ...stroke, offset: { x: 3, y: 0 } }];
    expect(exported('cpp-look', moved)).not.toContain('To lay text');
    expect(exported('java', moved)).not.toContain('To lay text');
});
