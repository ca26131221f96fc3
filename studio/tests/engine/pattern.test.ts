import { readFileSync } from 'node:fs';
import { encode } from 'fast-png';
import { expect, it } from 'vitest';
import { readPattern } from '../../src/engine/pattern';

function pixelsOf(bytes: Uint8Array): number[] {
    return [...Buffer.from(readPattern(bytes).data, 'base64')];
}

it('keeps the colours of translucent pixels', () => {
    const data = Uint8Array.of(200, 100, 50, 1, 10, 20, 30, 128);
    const png = encode({ width: 2, height: 1, data, channels: 4 });
    expect(pixelsOf(png)).toEqual([...data]);
});

it('reads grey, grey with alpha, colour and 16 bits', () => {
    const grey = encode({ width: 2, height: 1, data: Uint8Array.of(7, 200), channels: 1 });
    expect(pixelsOf(grey)).toEqual([7, 7, 7, 255, 200, 200, 200, 255]);
    const alpha = encode({ width: 1, height: 1, data: Uint8Array.of(7, 9), channels: 2 });
    expect(pixelsOf(alpha)).toEqual([7, 7, 7, 9]);
    const deep = encode({
        width: 1,
        height: 1,
        data: Uint16Array.of(0x1234, 0xff00, 0),
        channels: 3,
        depth: 16,
    });
    expect(pixelsOf(deep)).toEqual([0x12, 0xff, 0, 255]);
});

it('reads the patterns of the presets', () => {
    for (const name of ['chalk', 'halftone', 'spray', 'stripes', 'tiles']) {
        const file = new URL(`../../../style/presets/${name}.png`, import.meta.url);
        const { width, height, data } = readPattern(readFileSync(file));
        expect(Buffer.from(data, 'base64')).toHaveLength(width * height * 4);
    }
});

it('says what is wrong with a file', () => {
    expect(() => readPattern(new Uint8Array(100))).toThrow('no PNG');
    const large = encode({ width: 1025, height: 1, data: new Uint8Array(1025), channels: 1 });
    expect(() => readPattern(large)).toThrow('1025 × 1 pixels');
    const whole = encode({ width: 8, height: 8, data: new Uint8Array(64), channels: 1 });
    expect(() => readPattern(whole.slice(0, 50))).toThrow('damaged');
});
