import { computed, signal } from '@preact/signals';
import { keepSetting, setting } from './keep';
import * as keep from './keep';
import { notice, settle } from './notices';
import { picture, wantsFacts } from './painting';

/** How the picture is looked at: zoom, place, ground and what is drawn over it. */

export const stageSize = signal({ width: 600, height: 400 });
/** Screen pixels of a picture's pixel, or 'fit'. */
export const chosenZoom = signal<number | 'fit'>('fit');
/** Of the picture's centre from that of the stage, in screen pixels. */
export const pan = signal({ x: 0, y: 0 });

const smallest = 0.05;
const largest = 32;

/** The zoom as it is: 'fit' makes no picture larger than it is. */
export const zoom = computed(() => {
    if (chosenZoom.value !== 'fit') return chosenZoom.value;
    const shown = picture.value;
    if (!shown) return 1;
    const { width, height } = stageSize.value;
    return Math.max(
        smallest,
        Math.min(1, (width - 16) / shown.width, (height - 16) / shown.height),
    );
});

export function fit(): void {
    chosenZoom.value = 'fit';
    pan.value = { x: 0, y: 0 };
}

/** Multiplies the zoom; the place (from the stage's centre, in screen pixels) stays where it is. */
export function zoomBy(factor: number, place = { x: 0, y: 0 }): void {
    const before = zoom.value;
    const after = Math.min(largest, Math.max(smallest, before * factor));
    const moved = after / before;
    pan.value = {
        x: place.x - (place.x - pan.value.x) * moved,
        y: place.y - (place.y - pan.value.y) * moved,
    };
    chosenZoom.value = after;
}

export function panBy(x: number, y: number): void {
    pan.value = { x: pan.value.x + x, y: pan.value.y + y };
}

/** Overlays that are switched on. */
export const overlays = signal({ margins: false, box: false, lines: false });

export function turnOverlay(name: 'margins' | 'box' | 'lines'): void {
    overlays.value = { ...overlays.value, [name]: !overlays.value[name] };
    if (overlays.value.lines) wantsFacts.value = true;
}

export type Tab = 'text' | 'presets' | 'looks' | 'facts' | 'save';
export type Dock = 'facts' | 'save' | '';

/** The panel that a narrow page shows. */
export const tab = signal<Tab>('text');
/** The panel below the picture of a wide page. */
export const dock = signal<Dock>((setting('dock') ?? 'facts') as Dock);

export function openTab(name: Tab): void {
    tab.value = name;
    if (name === 'facts' || name === 'save') openDock(name);
}

export function openDock(name: Dock): void {
    dock.value = name;
    keepSetting('dock', name);
}

/** Address of the person's own ground, while there is one. */
export const groundPicture = signal('');

export async function loadGround(): Promise<void> {
    const kept = await keep.get('work', 'ground');
    if (kept instanceof Blob) groundPicture.value = URL.createObjectURL(kept);
}

/** Shows a picture file behind the text. Resolves to whether it could be read. */
export async function useGround(file: File): Promise<boolean> {
    try {
        const bitmap = await createImageBitmap(file);
        bitmap.close();
    } catch {
        notice('error', 'ground', `${file.name} is no picture that this browser can show`);
        return false;
    }
    settle('ground');
    if (groundPicture.value) URL.revokeObjectURL(groundPicture.value);
    groundPicture.value = URL.createObjectURL(file);
    await keep.put('work', 'ground', file);
    return true;
}
