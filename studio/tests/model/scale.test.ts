import { expect, it } from 'vitest';
import { scaledWork } from '../../src/model/scale';
import { firstWork, type Work } from '../../src/model/work';

it('scales pixels and leaves percent to the size', () => {
    const work: Work = {
        ...firstWork,
        size: 40,
        padding: 5,
        letterSpacing: '1.5',
        style: {
            version: 2,
            looks: [
                {
                    offset: { x: 3, y: '2%' },
                    outerShadow: { angle: 90, distance: 7, size: '4px', color: '#000000' },
                    innerGlow: { size: '5%', color: '#FFFFFF' },
                    pattern: { image: 'a', scale: 4 },
                    stroke: { size: 60, color: '#000000', position: 'inside' },
                },
            ],
        },
    };
    const big = scaledWork(work, 3);
    expect([big.size, big.padding, big.letterSpacing]).toEqual([120, 15, '4.5']);
    expect(big.style.looks[0]).toEqual({
        offset: { x: 9, y: '2%' },
        outerShadow: { angle: 90, distance: 21, size: 12, color: '#000000' },
        innerGlow: { size: '5%', color: '#FFFFFF' },
        pattern: { image: 'a', scale: 10 },
        stroke: { size: 100, color: '#000000', position: 'inside' },
    });
    expect(scaledWork({ ...work, letterSpacing: '5%' }, 2).letterSpacing).toBe('5%');
});
