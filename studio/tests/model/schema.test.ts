import { expect, it } from 'vitest';
import { freshEffects } from '../../src/model/edit';
import { asStyle } from '../../src/model/check';
import { fieldsOf, helpOf, lookField, offsetFields } from '../../src/model/schema';
import { effectNames } from '../../src/model/style_file';

it('gives each effect its fields with ranges, defaults and help', () => {
    const stroke = fieldsOf('stroke');
    expect(stroke.map((field) => [field.key, field.kind])).toEqual([
        ['size', 'length'],
        ['color', 'colour'],
        ['opacity', 'number'],
        ['strokeStyle', 'integer'],
        ['position', 'choice'],
    ]);
    expect(stroke[0]).toMatchObject({
        min: 0,
        max: 100,
        help: 'Width of the outline',
        required: true,
    });
    expect(stroke[4]?.choices).toEqual(['center', 'outside', 'inside']);
    expect(fieldsOf('linearGradient')[1]).toMatchObject({
        min: 0.1,
        max: 2,
        default: 1,
        step: 0.01,
    });
});

it('names fields as a reader does', () => {
    expect(fieldsOf('bevel').map((field) => field.label)).toContain('Highlight colour');
    expect(offsetFields().map((field) => field.label)).toEqual(['Offset right', 'Offset down']);
    expect(lookField('span').choices).toEqual(['block', 'line', 'word', 'glyph']);
    expect(helpOf('outerGlow')).toBe('A halo around the text');
});

it('agrees with what an effect has when it is added', () => {
    for (const name of effectNames) asStyle({ version: 2, [name]: freshEffects[name] });
});
