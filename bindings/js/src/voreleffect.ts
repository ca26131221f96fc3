import type { Engine } from './engine.js';
import type { Glyphs } from './glyphs.js';
import { lookClassOf, type Look, type LookClass } from './look.js';
import {
    addressesOf,
    paint,
    painterClassOf,
    type PainterClass,
    type PaintTarget,
    type Place,
} from './painting.js';
import { Picture } from './picture.js';
import type { Box } from './values.js';

/** The function that paints once. */
export interface Paint {
    /**
     * Paints the coverage of glyphs in a look, or in a stack of looks, the last on top: a picture of its own, just
     * large enough. Gradients, patterns and what lies inside follow the box around all masks of a call.
     *
     * Masks are looked at during the call alone, and copied into the module's memory. Throws TypeError and RangeError
     * for arguments, VorelSizeError, VorelMemoryError; nothing is painted then. An effect that memory runs out for
     * while it paints is missing, the others are there.
     */
    (looks: Look | readonly Look[], glyphs: Glyphs): Picture;
    /**
     * Lays the painting over a target, clipped, so that the origin of the text stands at column `x` and row `y`, and
     * returns the box that was touched, an empty one where there was nothing to paint on the target.
     *
     * Onto premultiplied pixels each channel becomes over + under * (255 - alpha) / 255, rounded to nearest, at most
     * 255. Straight pixels, which an ImageData has, are multiplied with their alpha, rounded to nearest, and painted
     * onto; those that this changes have their alpha divided out again as by `Picture.straight`, and the others keep
     * their bytes. Of a canvas the part that is painted is taken out as straight pixels and put back.
     */
    (looks: Look | readonly Look[], glyphs: Glyphs, target: PaintTarget, place?: Place): Box;
}

/** The library in an instance of its own: its classes, and its memory. */
export interface Voreleffect {
    /** Of the library, as "0.9.0". */
    readonly version: string;
    readonly Look: LookClass;
    readonly Painter: PainterClass;
    readonly Picture: { readonly prototype: Picture };
    readonly paint: Paint;
}

/** The face of an instance. */
export function faceOf(engine: Engine): Voreleffect {
    const paintOnce = (
        looks: Look | readonly Look[],
        glyphs: Glyphs,
        target?: PaintTarget,
        place?: Place,
    ): Picture | Box => paint(engine, addressesOf(engine, looks), glyphs, target, place);
    return Object.freeze({
        version: engine.version,
        Look: lookClassOf(engine),
        Painter: painterClassOf(engine),
        Picture,
        paint: paintOnce as Paint,
    });
}
