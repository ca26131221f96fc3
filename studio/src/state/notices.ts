import { signal } from '@preact/signals';

/** What a sentence is about: a newer one about the same takes its place, and a success makes it untrue. */
export type Matter =
    | 'copy'
    | 'png'
    | 'file'
    | 'font'
    | 'pattern'
    | 'ground'
    | 'keeping'
    | 'kept fonts'
    | 'work'
    | 'painter';

/** Sentences for the reader. Those that tell of an error stay until they are closed or settled. */
export interface Notice {
    kind: 'info' | 'error';
    about: Matter;
    text: string;
}

export const notices = signal<Notice[]>([]);

export function notice(kind: Notice['kind'], about: Matter, text: string): void {
    const others = notices.value.filter(
        (each) => each.about !== about && (kind === 'error' || each.kind === 'error'),
    );
    notices.value = [...others, { kind, about, text }];
    if (kind === 'info') setTimeout(() => close(text), 8000);
}

export function close(text: string): void {
    notices.value = notices.value.filter((each) => each.text !== text);
}

/** What was told of an error does not hold any more. */
export function settle(about: Matter): void {
    notices.value = notices.value.filter((each) => each.kind === 'info' || each.about !== about);
}
