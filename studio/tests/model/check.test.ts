import { readdirSync, readFileSync } from 'node:fs';
import { describe, expect, it } from 'vitest';
import { asWork, CheckError, readStyle } from '../../src/model/check';
import { firstWork } from '../../src/model/work';
import { seeded } from '../seeded';

const presets = new URL('../../../style/presets/', import.meta.url);

describe('a style', () => {
    it('is read from every preset, and one look becomes a list', () => {
        for (const name of readdirSync(presets).filter((file) => file.endsWith('.json'))) {
            const style = readStyle(readFileSync(new URL(name, presets), 'utf8'));
            expect(style.looks.length).toBeGreaterThan(0);
        }
    });
    it.each([
        ['{', 'no JSON'],
        ['[]', 'a style is an object in braces'],
        ['{"version": 3}', 'version: must be 1 or 2'],
        ['{"strok": {}}', 'strok: unknown key'],
        ['{"version": 2, "looks": []}', 'looks: has 0 entries'],
        ['{"version": 2, "looks": [{}], "color": "#fff"}', 'beside looks stand only'],
        [
            '{"version": 2, "looks": [{}, {"stroke": {"size": 200, "color": "#000", "position": "inside"}}]}',
            'looks[1].stroke.size: 200 is out of range, 0 to 100',
        ],
        [
            '{"stroke": {"size": "4em", "color": "#000", "position": "inside"}}',
            "stroke.size: '4em' is no length",
        ],
        ['{"stroke": {"size": 4, "position": "inside"}}', 'stroke: color is missing'],
        [
            '{"stroke": {"size": 4, "color": "red", "position": "inside"}}',
            "stroke.color: 'red' is no colour",
        ],
        ['{"outerGlow": {"size": 4}}', 'outerGlow: color or gradient is missing'],
        ['{"fill": false, "color": "#fff"}', 'color: must not stand here'],
        [
            '{"pattern": {"image": "a", "scale": 1, "width": 2}}',
            'scale and width exclude one another',
        ],
        [
            '{"innerGlow": {"size": 1, "gradient": [{"location": 1, "color": "#fff"}, {"location": 0, "color": "#fff"}]}}',
            'gradient[1].location: lies before',
        ],
        ['{"__proto__": {"color": "#fff"}}', '__proto__: unknown key'],
        ['{"toString": 1}', 'toString: unknown key'],
    ])('%s is refused', (text, reason) => {
        expect(() => readStyle(text)).toThrow(reason);
    });
});

it('refuses styles that were damaged, or reads them, and does nothing else', () => {
    const random = seeded(99);
    const pieces = ['null', '-1', '1e999', '"%"', '[]', '{}', '"#FFF"', '101', '"4em"', 'true', ''];
    const good = JSON.stringify(firstWork.style);
    let read = 0;
    for (let round = 0; round < 500; round++) {
        const values = [...good.matchAll(/:("[^"]*"|[\d.]+|[[{])/g)];
        const hit = values[Math.floor(random() * values.length)];
        const piece = pieces[Math.floor(random() * pieces.length)] ?? '';
        const at = hit?.index ?? 0;
        const text = `${good.slice(0, at)}:${piece}${good.slice(at + (hit?.[0].length ?? 0))}`;
        try {
            readStyle(text);
            read++;
        } catch (error) {
            expect(error).toBeInstanceOf(CheckError);
        }
    }
    expect(read).toBeGreaterThan(0);
    expect(read).toBeLessThan(250);
});

describe('a work', () => {
    it('is what a first visit shows', () => {
        expect(asWork(JSON.parse(JSON.stringify(firstWork)))).toEqual(firstWork);
    });
    it.each([
        [{ size: 1001 }, 'size: 1001 is out of range'],
        [{ size: null }, 'size: must be a'],
        [{ text: 'a'.repeat(5001) }, 'text: more than 5000'],
        [{ background: 'url(x)' }, 'background'],
        [
            { patterns: { a: { width: 2, height: 2, data: 'AAAA' } } },
            'patterns.a: has not the pixels',
        ],
        [
            { patterns: { a: { width: 1e9, height: 1e9, data: '' } } },
            'patterns.a: 1000000000 is out of range',
        ],
        [{ style: { version: 2, looks: [{ angle: 1 }] } }, 'looks[0].angle: unknown key'],
        [{ more: 1 }, 'more: unknown key'],
    ])('%j is refused', (wrong, reason) => {
        expect(() => asWork({ ...firstWork, ...wrong })).toThrow(reason);
    });
});
