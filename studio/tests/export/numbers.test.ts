import fc from 'fast-check';
import { describe, expect, it } from 'vitest';
import { floatLiteral, sixDigits, spelled } from '../../src/export/numbers';

describe('a number', () => {
    it.each([
        [0.6, '0.6'],
        [Math.fround(0.6), '0.6'],
        [100, '100'],
        [-33.5, '-33.5'],
        [1 / 3, '0.33333334'],
        [0, '0'],
    ])('%d is spelled %s', (value, text) => {
        expect(spelled(value)).toBe(text);
    });
    it('is read as the same float', () => {
        fc.assert(
            fc.property(fc.float({ noNaN: true, min: -1000, max: 1000 }), (value) => {
                expect(Math.fround(Number(spelled(value))) + 0).toBe(value + 0);
            }),
        );
    });
    it('is a literal with a suffix only where it is not whole', () => {
        expect(floatLiteral(0.25, 'F')).toBe('0.25F');
        expect(floatLiteral(4, 'f')).toBe('4');
        expect(floatLiteral(1e-7, 'f')).toBe('1e-7f');
    });
});

it('A colour of three digits has each twice', () => {
    expect(sixDigits('#f80')).toBe('FF8800');
    expect(sixDigits('#1b2a6b')).toBe('1B2A6B');
});
