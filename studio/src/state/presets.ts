import { signal } from '@preact/signals';
import type { Painted } from '../engine/messages';
import { readStyle } from '../model/check';
import type { StyleFile } from '../model/style_file';
import { firstWork, type Work } from '../model/work';
import { engine, picture } from './painting';
import { patternsFor, withStyleAndPatterns } from './patterns';
import { replaceWork, work } from './store';
import { notice, settle } from './notices';

const files = import.meta.glob<string>('../../../style/presets/*.json', {
    query: '?raw',
    import: 'default',
    eager: true,
});

export interface Preset {
    name: string;
    style: StyleFile;
}

/** The looks that come with the library, by their names. */
export const presets: readonly Preset[] = Object.entries(files)
    .map(([path, text]) => ({
        name: path.replace(/^.*\/|\.json$/g, ''),
        style: readStyle(text),
    }))
    .sort((one, other) => one.name.localeCompare(other.name));

/** The pictures of presets that are painted so far. */
export const presetPictures = signal<ReadonlyMap<string, Painted>>(new Map());

async function paintPreset({ name, style }: Preset): Promise<void> {
    if (!engine) return;
    const patterns = await patternsFor(style, {});
    const of: Work = { ...firstWork, text: 'Ag', size: 44, padding: 4, style, patterns };
    const painted = await engine.call('sample', { work: of });
    presetPictures.value = new Map(presetPictures.value).set(name, painted);
}

/** Paints the presets one after the other, once the first picture is there. */
export function paintPresets(): void {
    const stop = picture.subscribe((first) => {
        if (!first) return;
        queueMicrotask(() => stop());
        void (async () => {
            for (const preset of presets) await paintPreset(preset).catch(() => undefined);
            // The first picture's time is that of code that was not compiled yet.
            engine?.paint(work.value);
        })();
    });
}

export async function usePreset(preset: Preset): Promise<void> {
    try {
        replaceWork(await withStyleAndPatterns(work.value, preset.style));
        settle('pattern');
    } catch (error) {
        notice('error', 'pattern', (error as Error).message);
    }
}
