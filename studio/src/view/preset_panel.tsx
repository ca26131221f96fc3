import { presetPictures, presets, usePreset, type Preset } from '../state/presets';
import { announce } from '../state/store';
import { Pixels } from './pixels';

/** Every preset as a picture of itself. */
export function PresetPanel() {
    return (
        <ul class="presets">
            {presets.map((preset) => (
                <li key={preset.name}>
                    <PresetButton preset={preset} />
                </li>
            ))}
        </ul>
    );
}

function PresetButton({ preset }: { preset: Preset }) {
    const painted = presetPictures.value.get(preset.name);
    const use = () => {
        void usePreset(preset);
        announce(`Preset ${preset.name}`);
    };
    return (
        <button type="button" class="preset" title={preset.style.description} onClick={use}>
            <span class={`preset-picture ground-${grounds[preset.name] ?? 'mid'}`}>
                {painted && (
                    <Pixels data={painted.data} width={painted.width} height={painted.height} />
                )}
            </span>
            <span class="preset-name">{preset.name}</span>
        </button>
    );
}

/** Grounds that presets are made for, where the common one does not show them. */
const grounds: Record<string, 'dark' | 'board' | 'paper' | 'stone'> = {
    aurora: 'dark',
    chalk: 'board',
    embossed: 'paper',
    engraved: 'stone',
    glass: 'dark',
    graffiti: 'dark',
    lava: 'dark',
    neon: 'dark',
    'neon-sign': 'dark',
    spotlight: 'dark',
};
