import { expect, it } from 'vitest';
import { begin, change, maxSteps, oneStep, redo, undo } from '../../src/model/history';

it('takes back and gives again', () => {
    const two = change(change(begin('a'), 'b', '', 1), 'c', '', 2);
    const back = undo(undo(two));
    expect(back.now).toBe('a');
    expect(undo(back)).toBe(back);
    expect(redo(redo(back)).now).toBe('c');
});

it('makes one step of changes of one thing that follow at once', () => {
    let history = change(begin(0), 1, 'size', 1000);
    history = change(history, 2, 'size', 1000 + oneStep - 1);
    expect(undo(history).now).toBe(0);
    history = change(history, 3, 'size', 5000);
    expect(undo(history).now).toBe(2);
    expect(undo(change(history, 4, 'angle', 5001)).now).toBe(3);
});

it('forgets what was taken back when something new is made', () => {
    const history = change(undo(change(begin('a'), 'b', '', 1)), 'c', '', 2);
    expect(redo(history)).toBe(history);
});

it('keeps a bounded number of steps', () => {
    let history = begin(0);
    for (let at = 1; at < 500; at++) history = change(history, at, '', at);
    expect(history.past).toHaveLength(maxSteps);
});
