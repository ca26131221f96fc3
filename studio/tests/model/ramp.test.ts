import { expect, it } from 'vitest';
import { addStop, colourAt, cssRamp, moveStop, removeStop, turned } from '../../src/model/ramp';

const ramp = [
    { location: 0, color: '#000' },
    { location: 0.5, color: '#0000FF', opacity: 0.5 },
    { location: 1, color: '#FFFFFF' },
];

it('adds a stop of the colour that is there', () => {
    const { stops, at } = addStop(ramp, 0.25);
    expect(at).toBe(1);
    expect(stops[1]).toEqual({ location: 0.25, color: '#000080', opacity: 0.75 });
    expect(addStop(ramp, 1).at).toBe(3);
});

it('keeps the order of locations', () => {
    expect(moveStop(ramp, 1, 2).map((stop) => stop.location)).toEqual([0, 1, 1]);
    expect(moveStop(ramp, 1, 0.337)[1]?.location).toBe(0.34);
    expect(moveStop(ramp, 2, 0.1)[2]?.location).toBe(0.5);
});

it('keeps the last stop', () => {
    expect(removeStop(ramp, 1)).toEqual([ramp[0], ramp[2]]);
    expect(removeStop([{ location: 0, color: '#000' }], 0)).toHaveLength(1);
});

it('turns round', () => {
    expect(turned(ramp).map((stop) => [stop.location, stop.color])).toEqual([
        [0, '#FFFFFF'],
        [0.5, '#0000FF'],
        [1, '#000'],
    ]);
});

it('is a ramp of CSS, also of one stop', () => {
    expect(cssRamp(ramp.slice(0, 1))).toBe(
        'linear-gradient(to right, rgb(0 0 0 / 1) 0%, rgb(0 0 0 / 1) 0%)',
    );
    expect(colourAt([], 0.5).color).toBe('#FFFFFF');
});
