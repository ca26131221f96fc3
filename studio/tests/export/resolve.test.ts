import { describe, expect, it } from 'vitest';
import { resolved } from '../../src/export/resolve';
import type { LookStyle } from '../../src/model/style_file';

function lookAt(size: number, look: LookStyle): LookStyle | undefined {
    return resolved({ version: 2, looks: [look] }, size).looks[0];
}
const stroke = { color: '#000', position: 'outside' } as const;

describe('a length', () => {
    it.each([
        // 4 of 100 of 32 are 1.28 pixels; halves are rounded up; 40 of 100 of 300 are 120, above the most.
        ['4%', 32, 1],
        ['2.5%', 100, 3],
        ['40%', 300, 100],
        // The library cuts pixels itself.
        ['2.9px', 100, Math.fround(2.9)],
        [2.9, 100, Math.fround(2.9)],
        // 1.005 as a float is a little less; the thousandths that are written count: 5.025 of 500, 201 of 1000.
        ['0.3%', 500, 2],
        ['100%', 1, 1],
    ])('of %s is at a font of %i pixels %d', (size, font, pixels) => {
        expect(lookAt(font, { stroke: { ...stroke, size } })?.stroke?.size).toBe(pixels);
    });
    it('below a pixel is a pixel of a fainter effect', () => {
        const look = lookAt(30, { stroke: { ...stroke, size: '1%', opacity: 0.5 } });
        // 0.3 to 1/65536 is 19661 of them; floats are multiplied as floats.
        const kept = Math.fround(19661 / 65536);
        expect(look?.stroke).toEqual({ ...stroke, size: 1, opacity: Math.fround(0.5 * kept) });
    });
    it('of a blur below a pixel is rounded, of a distance fades', () => {
        const shadow = { angle: 0, color: '#000', distance: '1%', size: '1%' };
        const look = lookAt(40, { outerShadow: shadow });
        const opacity = Math.fround(26214 / 65536);
        expect(look?.outerShadow).toEqual({ ...shadow, distance: 1, size: 0, opacity });
    });
    it('of no distance keeps the opacity', () => {
        const shadow = { angle: 0, color: '#000', distance: '0%', size: 3, opacity: 0.5 };
        expect(lookAt(40, { innerShadow: shadow })?.innerShadow).toEqual({
            ...shadow,
            distance: 0,
        });
    });
});

describe('an offset', () => {
    it.each([
        [2.5, 3],
        [-2.5, -3],
        ['-1.25%', -1],
        ['0.4px', 0],
        [undefined, 0],
    ])('of %s is at a font of 96 pixels %i', (x, pixels) => {
        const offset = x === undefined ? {} : { x };
        expect(lookAt(96, { offset })?.offset).toEqual({ x: pixels, y: 0 });
    });
});

describe('a tile', () => {
    it.each([
        ['30%', 12],
        ['1000%', 400],
        ['0.5%', 1],
        [7.5, 7.5],
    ])('of %s is at a font of 40 pixels %d wide', (width, pixels) => {
        expect(lookAt(40, { pattern: { image: 'x', width } })?.pattern?.width).toBe(pixels);
    });
});

describe('a style', () => {
    it('keeps its order and all else', () => {
        const look: LookStyle = {
            description: 'A',
            span: 'line',
            innerGlow: { size: '10%', color: '#123' },
            linearGradient: { angle: 3, gradient: [] },
            outerGlow: { size: '20%', color: '#123', opacity: 0.3 },
        };
        const found = lookAt(10, look);
        expect(Object.keys(found ?? {})).toEqual(Object.keys(look));
        expect(found).toEqual({
            ...look,
            innerGlow: { size: 1, color: '#123' },
            outerGlow: { size: 2, color: '#123', opacity: 0.3 },
        });
    });
});
