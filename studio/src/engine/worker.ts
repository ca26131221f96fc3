import { load } from 'voreleffect/text';
import wasm from 'voreleffect/voreleffect-text.wasm?url';
import { exporters, png } from '../export';
import { scaledWork } from '../model/scale';
import type { Work } from '../model/work';
import type { Answer, Ask, CallName, Calls, Code } from './messages';
import { Studio } from './paint';
import { readPattern } from './pattern';

/** The worker: it has the engine and answers the questions of the page, one after the other. */

const scope = globalThis as unknown as DedicatedWorkerGlobalScope;

async function begin(): Promise<Studio> {
    const engine = await load(new URL(wasm, scope.location.href));
    // The worker's own file lies in a folder of the page, as that of the fonts does.
    return new Studio(engine, new URL('../fonts/', scope.location.href));
}

const studio = begin();

// Held for life, so that the page gets it when this worker ends.
if ('locks' in navigator) {
    navigator.locks.request(scope.name, () => new Promise(() => undefined)).catch(() => undefined);
}

type Answers = { [Name in CallName]: (ask: Calls[Name]['ask']) => Promise<Calls[Name]['answer']> };

const answers: Answers = {
    paint: async ({ work }) => (await studio).paint(work),
    sample: async ({ work }) => (await studio).paint(work),
    facts: async ({ work, measured }) => (await studio).facts(work, measured),
    layers: async ({ work }) => (await studio).layers(work),
    style: async ({ style, patterns }) => {
        (await studio).style(style, patterns);
        return null;
    },
    font: async ({ name, bytes }) => ({ family: (await studio).addFont(name, bytes) }),
    pattern: ({ bytes }) => Promise.resolve(readPattern(bytes)),
    png: async ({ work, scale, onGround }) => pngOf(scaledWork(work, scale), onGround),
    exports: async ({ work }) => codeOf(await studio, work),
};

async function pngOf(work: Work, onGround: boolean) {
    const colour = work.background.startsWith('#') ? work.background : undefined;
    const picture = await (await studio).paint(work, onGround ? colour : undefined);
    const bytes = await png(picture.data, picture.width, picture.height);
    return { bytes: new Uint8Array(bytes), notes: picture.notes };
}

const labels: Record<string, string> = {
    style: 'Style file',
    'cpp-look': 'C++',
    'cpp-classes': 'C++, classes',
    c: 'C',
    java: 'Java',
    python: 'Python',
    javascript: 'JavaScript',
    command: 'Command',
};

function codeOf(from: Studio, work: Work): Code[] {
    const engine = from.exportEngine();
    return Object.entries(exporters).map(([format, exporter]) => ({
        format,
        label: labels[format] ?? format,
        ...exporter(work, engine),
    }));
}

function transfersOf(value: unknown): Transferable[] {
    const list = Array.isArray(value) ? (value as unknown[]) : [value];
    return list.flatMap((item) => {
        const { data, bytes } = (item ?? {}) as { data?: unknown; bytes?: unknown };
        return [data, bytes].flatMap((array) =>
            ArrayBuffer.isView(array) ? [array.buffer as ArrayBuffer] : [],
        );
    });
}

/** After a trap, or without memory, the instance is of no use any more. */
function isDeadly(error: unknown): boolean {
    if (error instanceof WebAssembly.RuntimeError) return true;
    const name = error instanceof Error ? error.name : '';
    return name === 'VorelMemoryError' || name === 'VorelError';
}

scope.onmessage = async ({ data: ask }: MessageEvent<Ask>) => {
    try {
        const answer = answers[ask.call] as (ask: Ask) => Promise<unknown>;
        const value = await answer(ask);
        scope.postMessage({ id: ask.id, value } satisfies Answer, transfersOf(value));
    } catch (error) {
        const reason = error instanceof Error ? error.message : String(error);
        scope.postMessage({ id: ask.id, error: reason, dead: isDeadly(error) } satisfies Answer);
    }
};
