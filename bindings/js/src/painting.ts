/// <reference lib="esnext.disposable" preserve="true" />
import { disposeByFree, type Engine, type Handle, type Scope } from './engine.js';
import { PlacedGlyphs, type Glyphs, type Sides } from './glyphs.js';
import { Look, marginsBy, sidesAt } from './look.js';
import { Picture, type PlatformImageData } from './picture.js';
import { Rows, type Target } from './targets.js';
import { integer, kindOf, options, type Box, type Margins } from './values.js';

/** Where the origin of the text stands on a target; 0 without them. */
export interface Place {
    readonly x?: number | undefined;
    readonly y?: number | undefined;
}

/** An OffscreenCanvas or a canvas of a page, as far as it is painted onto. */
export interface CanvasLike {
    readonly width: number;
    readonly height: number;
    // eslint-disable-next-line @typescript-eslint/no-explicit-any -- contexts of many kinds
    getContext(kind: '2d'): any;
}

/** What is painted onto. */
export type PaintTarget = Target | PlatformImageData | CanvasLike;

/** What constructs painters of one instance. */
export interface PainterClass {
    /** Of one look, or of several, the last on top. Throws TypeError for what are no looks. */
    new (looks: Look | readonly Look[]): Painter;
    readonly prototype: Painter;
}

/**
 * Paints in a look, or in a stack of looks, again and again: every time the same picture for the same masks. It
 * keeps its layers for the next time, as large as the largest so far, and copies of its looks.
 */
export class Painter {
    readonly #engine: Engine;
    readonly #handle: Handle;

    /** @internal */
    constructor(engine: Engine, looks: Look | readonly Look[]) {
        this.#engine = engine;
        this.#handle = engine.scoped((scope) => {
            const painter = painterOf(scope, addressesOf(engine, looks));
            return engine.keep(this, 'painter', painter, 'vorel_painter_free');
        });
    }

    /** How far the looks paint beyond the glyphs, all of them together. */
    get margins(): Margins {
        return marginsBy(this.#engine, 'vorel_painter_margins', this.#handle.address);
    }

    /** Paints a picture of its own; see the function `paint`. */
    paint(glyphs: Glyphs): Picture;
    /** Paints onto a target; see the function `paint`. */
    paint(glyphs: Glyphs, target: PaintTarget, place?: Place): Box;
    paint(glyphs: Glyphs, target?: PaintTarget, place?: Place): Picture | Box {
        const painter = (): number => this.#handle.address;
        return this.#engine.scoped((scope) => paintBy(scope, painter, glyphs, target, place));
    }

    /** Gives back its memory; the painter cannot be used any more. A second time it does nothing. */
    free(): void {
        this.#handle.free();
    }

    /** As `free`, for `using`. */
    declare [Symbol.dispose]: () => void;

    static {
        disposeByFree(this);
    }
}

/** The class of the painters of an instance. */
export function painterClassOf(engine: Engine): PainterClass {
    class PainterOfInstance extends Painter {
        constructor(looks: Look | readonly Look[]) {
            super(engine, looks);
        }
    }
    return Object.defineProperty(PainterOfInstance, 'name', { value: 'Painter' });
}

/** Where looks lie in memory. Throws TypeError for what are no looks of the instance. */
export function addressesOf(engine: Engine, looks: Look | readonly Look[]): number[] {
    // Read before the first address is asked for: what reads them may free some.
    const stack: unknown[] = Array.isArray(looks) ? Array.from(looks) : [looks];
    return stack.map((look) => Look.addressIn(engine, look));
}

/** Paints once; the looks lie at these addresses. */
export function paint(
    engine: Engine,
    looks: readonly number[],
    glyphs: Glyphs,
    target?: PaintTarget,
    place?: Place,
): Picture | Box {
    return engine.scoped((scope) => {
        const painter = scope.takes(painterOf(scope, looks), 'vorel_painter_free');
        return paintBy(scope, () => painter, glyphs, target, place);
    });
}

function painterOf(scope: Scope, looks: readonly number[]): number {
    return scope.made('vorel_painter_new', scope.words(...looks), looks.length);
}

/** Where a painter lies; what is read of arguments may have freed it, which this throws. */
type PainterAddress = () => number;

function paintBy(
    scope: Scope,
    painter: PainterAddress,
    given: Glyphs,
    target: PaintTarget | undefined,
    place: Place = {},
): Picture | Box {
    const glyphs = new PlacedGlyphs(given);
    const { x = 0, y = 0 } = options(place, ['x', 'y']);
    const origin = { x: integer(x, 'x'), y: integer(y, 'y') };
    if (target === undefined) return pictureBy(scope, painter, glyphs);
    if (typeof target !== 'object' || (target as unknown) === null) {
        throw new TypeError(`a target, not ${kindOf(target)}`);
    }
    if ('getContext' in target) return onCanvas(scope, painter, glyphs, target, origin);
    return onRows(scope, painter, glyphs, new Rows(target), origin);
}

function pictureBy(scope: Scope, painter: PainterAddress, glyphs: PlacedGlyphs): Picture {
    const { engine } = scope;
    const made = scope.made(
        'vorel_painter_picture',
        painter(),
        glyphs.copiedTo(scope),
        glyphs.count,
    );
    const picture = scope.takes(made, 'vorel_picture_free');
    const part = (name: string): number => engine.call(`vorel_picture_${name}`, picture);
    const [width, height] = [part('width'), part('height')];
    const at = part('data') >>> 0;
    const data = new Uint8ClampedArray(4 * width * height);
    data.set(engine.bytes().subarray(at, at + data.length));
    return new Picture(data, width, height, part('left'), part('top'));
}

const NOTHING: Box = Object.freeze({ left: 0, top: 0, right: 0, bottom: 0 });

/** What of a box lies on a target. */
function clipped({ left, top, right, bottom }: Sides, width: number, height: number): Box {
    const column = (x: number): number => Math.min(Math.max(x, 0), width);
    const row = (y: number): number => Math.min(Math.max(y, 0), height);
    return { left: column(left), top: row(top), right: column(right), bottom: row(bottom) };
}

interface Origin {
    readonly x: number;
    readonly y: number;
}

/** The part of a target that may be painted: the glyphs with the margins around them. */
function reachOf(scope: Scope, painter: PainterAddress, glyphs: PlacedGlyphs, at: Origin): Sides {
    const { left, top, right, bottom } = glyphs.sides ?? NOTHING;
    const around = marginsBy(scope.engine, 'vorel_painter_margins', painter());
    return {
        left: at.x + left - around.left,
        top: at.y + top - around.top,
        right: at.x + right + around.right,
        bottom: at.y + bottom + around.bottom,
    };
}

function onRows(
    scope: Scope,
    painter: PainterAddress,
    glyphs: PlacedGlyphs,
    rows: Rows,
    at: Origin,
): Box {
    const { engine } = scope;
    const box = clipped(reachOf(scope, painter, glyphs, at), rows.width, rows.height);
    const list = glyphs.copiedTo(scope);
    const touched = scope.words(0, 0, 0, 0);
    const part = rows.part(scope, box);
    const place = [at.x - box.left, at.y - box.top] as const;
    engine.check(
        'vorel_painter_paint',
        painter(),
        list,
        glyphs.count,
        part.view,
        ...place,
        touched,
    );
    part.finish();
    return movedBy(sidesAt(engine, touched), box.left, box.top);
}

function movedBy(box: Box, x: number, y: number): Box {
    if (box.right <= box.left) return box;
    const { left, top, right, bottom } = box;
    return Object.freeze({ left: left + x, top: top + y, right: right + x, bottom: bottom + y });
}

/** A canvas gives and takes straight pixels: the part that is painted is taken out and put back. */
function onCanvas(
    scope: Scope,
    painter: PainterAddress,
    glyphs: PlacedGlyphs,
    canvas: CanvasLike,
    at: Origin,
): Box {
    const { width, height } = canvas;
    const context = canvas.getContext('2d') as OffscreenCanvasRenderingContext2D | null;
    if (context === null) throw new TypeError('a canvas whose context is not of 2d');
    const { left, top, right, bottom } = clipped(
        reachOf(scope, painter, glyphs, at),
        width,
        height,
    );
    if (right === left || bottom === top) return NOTHING;
    const pixels = context.getImageData(left, top, right - left, bottom - top);
    const moved = { x: at.x - left, y: at.y - top };
    const touched = onRows(scope, painter, glyphs, new Rows(pixels), moved);
    context.putImageData(pixels, left, top);
    return movedBy(touched, left, top);
}
