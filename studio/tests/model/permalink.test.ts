import { describe, expect, it } from 'vitest';
import { CheckError } from '../../src/model/check';
import { maxLink, readLink, writeLink } from '../../src/model/permalink';
import { firstWork } from '../../src/model/work';
import { seeded } from '../seeded';

describe('a link', () => {
    it('holds the whole work', async () => {
        const work = {
            ...firstWork,
            text: 'नमस्ते\n<c #FF0000>Welt</c>',
            patterns: { a: { width: 1, height: 1, data: 'AQIDBA==' } },
        };
        const link = await writeLink(work);
        expect(link).toMatch(/^1\.[A-Za-z0-9_-]+$/);
        expect(link.length).toBeLessThan(1000);
        expect(await readLink(`#${link}`)).toEqual(work);
    });
    it('is refused when it would be too long', async () => {
        const random = seeded(1);
        const bytes = Uint8Array.from({ length: 128 * 128 * 4 }, () => random() * 256);
        const data = Buffer.from(bytes).toString('base64');
        const patterns = { noise: { width: 128, height: 128, data } };
        await expect(writeLink({ ...firstWork, patterns })).rejects.toThrow(`more than ${maxLink}`);
    });
    it('does not unpack without end', async () => {
        const zeros = new Blob([new Uint8Array(20 * 1024 * 1024)]).stream();
        const packed = zeros.pipeThrough(new CompressionStream('deflate-raw'));
        const code = Buffer.from(await new Response(packed).arrayBuffer()).toString('base64url');
        await expect(readLink(`1.${code}`)).rejects.toThrow('more than a work can have');
    });
    it('gives a CheckError for whatever else it is', async () => {
        const random = seeded(20);
        const good = await writeLink(firstWork);
        for (let round = 0; round < 400; round++) {
            const letters = good.split('');
            for (let hit = 0; hit <= random() * 4; hit++) {
                letters[Math.floor(random() * letters.length)] = String.fromCharCode(
                    33 + random() * 94,
                );
            }
            const link = letters
                .join('')
                .slice(0, random() < 0.3 ? random() * good.length : undefined);
            const work = await readLink(link).catch((error: unknown) => error);
            if (work instanceof Error) expect(work).toBeInstanceOf(CheckError);
        }
    });
});
