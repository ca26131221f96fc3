import type { Exported } from '../export';
import type { PatternPixels, Work } from '../model/work';
import type { StyleFile } from '../model/style_file';

/** What the page and the worker say to one another. Coordinates are pixels of the picture, y downwards. */

/** Half-open. */
export interface Box {
    left: number;
    top: number;
    right: number;
    bottom: number;
}

/** A painted work; its pixels are red, green, blue and straight alpha. */
export interface Painted {
    data: Uint8ClampedArray<ArrayBuffer>;
    width: number;
    height: number;
    /** Milliseconds of layout and painting in the worker. */
    milliseconds: number;
    /** Of the text, where its first baseline begins. */
    origin: { x: number; y: number };
    margins: Box;
    ink: Box;
    /** What gradients and patterns fill. */
    box: Box;
    /** Characters that no font has. */
    missing: string[];
    notes: string[];
    fonts: string[];
}

export interface Step {
    effect: string;
    place: string;
    reason: string;
    milliseconds?: number;
}

/** How a look is painted: whether in two layers, where it stands, and its steps, the topmost first. */
export interface PlannedLook {
    layered: boolean;
    reason: string;
    place: string;
    placeReason: string;
    order: Step[];
}

/** How the looks are painted, the topmost first, and the cache key as readable fragments. */
export interface Facts {
    looks: PlannedLook[];
    key: { name: string; meaning: string }[];
    keyBytes: number;
    /** From the origin of the text. */
    lines: { baseline: number; box: Box }[];
}

/** One step of painting alone, of the size of the picture; straight alpha. */
export interface Layer {
    look: number;
    effect: string;
    place: string;
    milliseconds: number;
    data: Uint8ClampedArray<ArrayBuffer>;
    width: number;
    height: number;
}

/** The work in another language, by an exporter of the page. */
export interface Code extends Exported {
    format: string;
    label: string;
}

export interface NamedFile {
    name: string;
    bytes: Uint8Array<ArrayBuffer>;
}

/** What each kind of question carries and is answered with. */
export interface Calls {
    paint: { ask: { work: Work }; answer: Painted };
    /** As paint, of a work beside the one that is made. */
    sample: { ask: { work: Work }; answer: Painted };
    /** `measured`: with the time of each effect, for which it is painted several times. */
    facts: { ask: { work: Work; measured: boolean }; answer: Facts };
    layers: { ask: { work: Work }; answer: Layer[] };
    /** `onGround`: with the colour of the background beneath the text, where it is a colour. */
    png: {
        ask: { work: Work; scale: number; onGround: boolean };
        answer: { bytes: Uint8Array<ArrayBuffer>; notes: string[] };
    };
    exports: { ask: { work: Work }; answer: Code[] };
    /** Whether the engine reads the style: it answers as it was asked, or with an error. */
    style: { ask: { style: StyleFile; patterns: Record<string, PatternPixels> }; answer: null };
    font: { ask: NamedFile; answer: { family: string } };
    pattern: { ask: NamedFile; answer: PatternPixels };
}

export type CallName = keyof Calls;

export type Ask<Name extends CallName = CallName> = {
    [Key in Name]: { id: number; call: Key } & Calls[Key]['ask'];
}[Name];

/** `dead` when the engine cannot go on: the worker is to be started anew. */
export type Answer = { id: number; value: unknown } | { id: number; error: string; dead: boolean };
