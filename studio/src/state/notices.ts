import { signal } from '@preact/signals';

/** Sentences for the reader that stay until they are closed or a newer one of their kind comes. */
export interface Notice {
    kind: 'info' | 'error';
    text: string;
}

export const notices = signal<Notice[]>([]);

export function notice(kind: Notice['kind'], text: string): void {
    const others = notices.value.filter((each) => each.kind !== kind);
    notices.value = [...others, { kind, text }];
    if (kind === 'info') setTimeout(() => close(text), 8000);
}

export function close(text: string): void {
    notices.value = notices.value.filter((each) => each.text !== text);
}
