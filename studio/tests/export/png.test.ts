import { decode } from 'fast-png';
import { describe, expect, it } from 'vitest';
import { png } from '../../src/export';

function picture(width: number, height: number, byte: (i: number) => number): Uint8ClampedArray {
    return Uint8ClampedArray.from({ length: width * height * 4 }, (_, i) => byte(i));
}
function noise(i: number): number {
    return Math.imul(i + 1, 0x9e3779b1) >>> 24;
}

describe('a PNG', () => {
    it.each([
        ['noise', 1, 1, noise],
        ['noise', 67, 33, noise],
        ['a ramp', 256, 5, (i: number) => Math.floor(i / 4) % 256],
        ['stripes', 40, 40, (i: number) => (Math.floor(i / 160) % 7) * 30],
        ['colours of clear pixels', 30, 3, (i: number) => (i % 4 === 3 ? 0 : noise(i))],
    ])('of %s of %i x %i pixels is read as the very bytes', async (_, width, height, byte) => {
        const data = picture(width, height, byte);
        const read = decode(await png(data, width, height), { checkCrc: true });
        expect([read.width, read.height, read.channels, read.depth]).toEqual([width, height, 4, 8]);
        expect(Buffer.compare(read.data as Uint8Array, new Uint8Array(data.buffer))).toBe(0);
    });
    it('is the same every time', async () => {
        const data = picture(50, 50, noise);
        expect(await png(data, 50, 50)).toEqual(await png(data, 50, 50));
    });
    it('of rows that go on from those above is small', async () => {
        // Each row is the one above and one more in each byte; a hundred rows have 40,000 bytes.
        const data = picture(100, 100, (i) => (noise(i % 400) + Math.floor(i / 400)) % 256);
        expect((await png(data, 100, 100)).length).toBeLessThan(1500);
    });
    it.each([
        [0, 4],
        [2, 3],
        [-2, -2],
        [1.5, 2],
    ])('of 16 bytes is not one of %d x %d pixels', async (width, height) => {
        await expect(png(new Uint8ClampedArray(16), width, height)).rejects.toThrow(RangeError);
    });
});
