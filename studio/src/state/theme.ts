import { effect, signal } from '@preact/signals';
import { keepSetting, setting } from './keep';

export const themes = ['system', 'light', 'dark'] as const;
export type Theme = (typeof themes)[number];

function isTheme(value: unknown): value is Theme {
    return themes.some((theme) => theme === value);
}

const kept = setting('theme');
export const theme = signal<Theme>(isTheme(kept) ? kept : 'system');

effect(() => {
    keepSetting('theme', theme.value);
    document.documentElement.dataset['theme'] = theme.value;
});

/** The next of system, light, dark. */
export function turnTheme(): void {
    theme.value = themes[(themes.indexOf(theme.value) + 1) % themes.length] ?? 'system';
}
