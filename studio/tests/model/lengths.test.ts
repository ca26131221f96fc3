import { expect, it } from 'vitest';
import { inUnit, readLength, writeLength } from '../../src/model/lengths';

it('reads and writes both units', () => {
    expect(readLength(4)).toEqual({ value: 4, unit: 'px' });
    expect(readLength('4px')).toEqual({ value: 4, unit: 'px' });
    expect(readLength('-2.5%')).toEqual({ value: -2.5, unit: '%' });
    expect(writeLength(2.00049, '%')).toBe('2%');
    expect(writeLength(-0, 'px')).toBe(0);
});

it('turns a unit into the other at a size', () => {
    expect(inUnit(4, '%', 32)).toBe('12.5%');
    expect(inUnit('12.5%', 'px', 32)).toBe(4);
    expect(inUnit('3%', '%', 32)).toBe('3%');
});
