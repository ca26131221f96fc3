import { computed, effect, signal } from '@preact/signals';
import { Engine } from '../engine/engine';
import { shippedFonts } from '../engine/fonts';
import type { Facts, Layer, Painted } from '../engine/messages';
import { missingSupport } from '../engine/support';
import type { Work } from '../model/work';
import * as keep from './keep';
import { notice } from './notices';
import { announce, work } from './store';

/** The picture of the work and what is known of it. */

/** The last picture that came out well, and the work that it shows. */
export const picture = signal<Painted | undefined>(undefined);
export const pictured = signal<Work | undefined>(undefined);
/** Why the work as it stands is not painted; empty when it is. */
export const failure = signal('');
/** Whether the worker has been at something for a while. */
export const isSlow = signal(false);
/** Why this browser cannot paint at all. */
export const unsupported = signal(missingSupport());
export const facts = signal<Facts | undefined>(undefined);
export const layers = signal<Layer[]>([]);
/** Number of the layer that is shown alone, or -1 for the picture. */
export const shownLayer = signal(-1);
/** Whether facts and layers are looked at, and so are worth asking for. */
export const wantsFacts = signal(false);
export const wantsLayers = signal(false);

/** Names of the person's own fonts. */
export const ownFonts = signal<string[]>([]);

export const engine: Engine | undefined = unsupported.value ? undefined : startEngine();

function startEngine(): Engine {
    const start = () => {
        const name = `painter ${crypto.randomUUID()}`;
        const worker = new Worker(new URL('../engine/worker.ts', import.meta.url), {
            type: 'module',
            name,
        });
        worker.addEventListener('message', () => watch(worker, name), { once: true });
        return worker;
    };
    return new Engine(start, {
        painted(result, of) {
            picture.value = result;
            pictured.value = of;
            failure.value = '';
            askFacts(of);
        },
        failed(reason, dead) {
            const told = dead ? startedAnew(reason) : reason;
            // What shows the work as it is needs no newer work to be true again.
            if (dead && pictured.value === work.value) notice('info', 'painter', told);
            else failure.value = told;
            announce(told);
        },
        slow(slow) {
            isSlow.value = slow;
        },
        restarted: () => void sendOwnFonts(),
    });
}

function startedAnew(reason: string): string {
    const stays = picture.value ? '; the last picture stays' : '';
    return `${reason.replace(/\.$/, '')}. Painting was started anew${stays}.`;
}

/** A worker holds the lock of its name as long as it lives: who gets it finds that the worker has ended. */
function watch(worker: Worker, name: string): void {
    const ended = () => worker.dispatchEvent(new ErrorEvent('error', { cancelable: true }));
    if ('locks' in navigator) navigator.locks.request(name, ended).catch(() => undefined);
}

let factsTimer: ReturnType<typeof setTimeout> | undefined;

/** Pixels of a picture up to which its steps are measured and shown one by one: larger ones keep the worker busy. */
export const mostMeasured = 4_000_000;

export const isMeasured = computed(() => {
    const shown = picture.value;
    return shown !== undefined && shown.width * shown.height <= mostMeasured;
});

/** Facts follow when the hand rests: a slider that moves shall not wait for them. */
function askFacts(of: Work): void {
    clearTimeout(factsTimer);
    factsTimer = setTimeout(() => {
        if (wantsFacts.value) void ask('facts', of);
        if (wantsLayers.value) void ask('layers', of);
    }, 180);
}

async function ask(what: 'facts' | 'layers', of: Work): Promise<void> {
    try {
        const measured = isMeasured.value;
        if (what === 'facts') facts.value = await engine?.newest('facts', { work: of, measured });
        else layers.value = measured ? ((await engine?.newest('layers', { work: of })) ?? []) : [];
    } catch {
        // Overtaken by a newer work, or the painting has already told why it failed.
    }
}

effect(() => {
    if (!wantsLayers.value) shownLayer.value = -1;
    if ((wantsFacts.value || wantsLayers.value) && pictured.peek())
        askFacts(pictured.peek() as Work);
});

/** Paints whenever the work changes. */
export function startPainting(): void {
    effect(() => engine?.paint(work.value));
}

async function sendOwnFonts(): Promise<void> {
    for (const [name, bytes] of await keep.all('fonts')) {
        if (bytes instanceof ArrayBuffer) await sendFont(name, bytes).catch(() => undefined);
    }
}

function sendFont(name: string, bytes: ArrayBuffer) {
    return (
        engine?.call('font', { name, bytes: new Uint8Array(bytes.slice(0)) }) ??
        Promise.reject(new Error())
    );
}

/** The fonts of earlier visits. */
export async function loadOwnFonts(): Promise<void> {
    const kept = await keep.all('fonts');
    ownFonts.value = kept.map(([name]) => name);
    await sendOwnFonts();
}

/** Forgets a font of the person's own. */
export async function forgetFont(name: string): Promise<void> {
    ownFonts.value = ownFonts.value.filter((each) => each !== name);
    await keep.remove('fonts', name);
}

/** Takes a font file, keeps it in this browser and gives its name. Rejects with a sentence for the reader. */
export async function addFont(file: File): Promise<string> {
    if (file.size > 32 * 1024 * 1024) throw new Error(`${file.name} has more than 32 MiB`);
    const bytes = await file.arrayBuffer();
    // With its ending, as a command takes the file where it lies.
    const isShipped = shippedFonts.some(({ id }) => id === file.name);
    const name = isShipped ? `${file.name}.font` : file.name;
    try {
        await sendFont(name, bytes);
    } catch (error) {
        throw new Error(`${file.name} is no font that can be read: ${(error as Error).message}`, {
            cause: error,
        });
    }
    ownFonts.value = [...new Set([...ownFonts.value, name])];
    if (!(await keep.put('fonts', name, bytes))) {
        notice(
            'error',
            'kept fonts',
            `${file.name} could not be kept, and is there until the page is left.`,
        );
    }
    return name;
}
