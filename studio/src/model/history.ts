/** What was, what is and what was taken back, of values that are never changed in place. */
export interface History<T> {
    past: readonly T[];
    now: T;
    future: readonly T[];
    /** What the last change was of, and when in milliseconds: changes of one thing that follow one another are one step. */
    last: { what: string; at: number };
}

export const maxSteps = 200;
/** Milliseconds within which changes of the same thing become one step. */
export const oneStep = 900;

export function begin<T>(now: T): History<T> {
    return { past: [], now, future: [], last: { what: '', at: 0 } };
}

/**
 * `what` names the thing that changes, as 'looks.0.stroke.size'; an empty name is always a step of its own. With
 * `goesOn` the change is of one step with that of the same thing before, however long ago that was.
 */
export function change<T>(
    history: History<T>,
    now: T,
    what: string,
    at: number,
    goesOn = false,
): History<T> {
    if (now === history.now) return history;
    const isSoon = goesOn || at - history.last.at < oneStep;
    const same = what !== '' && what === history.last.what && isSoon;
    const past = same ? history.past : [...history.past, history.now].slice(-maxSteps);
    return { past, now, future: [], last: { what, at } };
}

export function undo<T>(history: History<T>): History<T> {
    const before = history.past.at(-1);
    if (before === undefined) return history;
    return {
        past: history.past.slice(0, -1),
        now: before,
        future: [history.now, ...history.future],
        last: { what: '', at: 0 },
    };
}

export function redo<T>(history: History<T>): History<T> {
    const [after, ...future] = history.future;
    if (after === undefined) return history;
    return { past: [...history.past, history.now], now: after, future, last: { what: '', at: 0 } };
}
