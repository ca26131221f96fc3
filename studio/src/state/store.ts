import { computed, signal } from '@preact/signals';
import * as history from '../model/history';
import { changeLook } from '../model/edit';
import type { EffectName, LookStyle } from '../model/style_file';
import { firstWork, type Work } from '../model/work';

/** What the page is about: the work with its history, and what of it is being edited. */

const steps = signal(history.begin<Work>(firstWork));

export const work = computed(() => steps.value.now);
export const canUndo = computed(() => steps.value.past.length > 0);
export const canRedo = computed(() => steps.value.future.length > 0);

/** The look that is open, counted from the lowest. */
export const openLook = signal(firstWork.style.looks.length - 1);
/** The effect of it that is open. */
export const openEffect = signal<EffectName | 'fill' | ''>('linearGradient');

/** What is said politely to those who do not see the page. */
export const announced = signal('');

export function announce(text: string): void {
    announced.value = text;
}

/** Changes the work; changes of one `what` that follow at once, or where it `goesOn`, are one step to undo. */
export function edit(change: (work: Work) => Work, what = '', goesOn = false): void {
    const now = change(steps.value.now);
    steps.value = history.change(steps.value, now, what, Date.now(), goesOn);
    openLook.value = Math.min(openLook.value, now.style.looks.length - 1);
}

export function editLook(index: number, change: (look: LookStyle) => LookStyle, what = ''): void {
    edit(
        (now) => ({ ...now, style: changeLook(now.style, index, change) }),
        what && `looks.${index}.${what}`,
    );
}

/** Another work in place of this one, which can be taken back. */
export function replaceWork(now: Work): void {
    edit(() => now);
    openLook.value = now.style.looks.length - 1;
    openEffect.value = '';
}

/** The work of the visit before: no step to undo. */
export function beginWith(now: Work): void {
    steps.value = history.begin(now);
    openLook.value = now.style.looks.length - 1;
}

export function undo(): void {
    if (!canUndo.value) return;
    steps.value = history.undo(steps.value);
    announce('Undone');
}

export function redo(): void {
    if (!canRedo.value) return;
    steps.value = history.redo(steps.value);
    announce('Redone');
}
