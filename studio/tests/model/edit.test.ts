import { describe, expect, it } from 'vitest';
import * as edit from '../../src/model/edit';
import { effectsOf, type LookStyle, type StyleFile } from '../../src/model/style_file';

const look: LookStyle = {
    color: '#112233',
    stroke: { size: 2, color: '#000000', position: 'outside' },
    innerGlow: { size: 3, color: '#FFFFFF' },
};
const style: StyleFile = { version: 2, looks: [look, { color: '#FFFFFF' }] };

describe('looks', () => {
    it('are added on top and up to 32', () => {
        let many = style;
        for (let at = 0; at < 40; at++) many = edit.addLook(many);
        expect(many.looks).toHaveLength(32);
        expect(many.looks[0]).toBe(look);
    });
    it('keep the last one', () => {
        const one = edit.removeLook(style, 1);
        expect(one.looks).toEqual([look]);
        expect(edit.removeLook(one, 0)).toBe(one);
    });
    it('move without a change of the value before', () => {
        expect(edit.moveLook(style, 0, 1).looks[1]).toBe(look);
        expect(style.looks[0]).toBe(look);
    });
});

describe('effects', () => {
    it('stand in the order of the keys', () => {
        expect(effectsOf(edit.moveEffect(look, 'innerGlow', 0))).toEqual(['innerGlow', 'stroke']);
        expect(effectsOf(edit.addEffect(look, 'outerGlow'))).toEqual([
            'stroke',
            'innerGlow',
            'outerGlow',
        ]);
    });
    it('keep their place when a field changes', () => {
        const wide = edit.setField(look, 'stroke', 'size', '9%');
        expect(effectsOf(wide)).toEqual(['stroke', 'innerGlow']);
        expect(wide.stroke?.size).toBe('9%');
    });
    it('hand the colour of the fill to the effect text and back', () => {
        const filled = edit.addEffect(look, 'text');
        expect(filled.text).toEqual({ color: '#112233' });
        expect('color' in filled).toBe(false);
        expect(edit.removeEffect(filled, 'text').color).toBe('#112233');
    });
    it('leave the fill and take its colour along', () => {
        const bare = edit.setFill({ ...look, textOpacity: 0.5 }, false);
        expect(bare.fill).toBe(false);
        expect('color' in bare || 'textOpacity' in bare).toBe(false);
        expect('fill' in edit.setFill(bare, true)).toBe(false);
    });
});
