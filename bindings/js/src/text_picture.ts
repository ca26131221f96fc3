import { imageDataOf, straighten, type PlatformImageData } from './picture.js';
import { bytesOfHex, sidesOf, type Sides } from './text_engine.js';
import type { Box, Margins } from './values.js';

/** What the module tells of a text. */
export interface ToldText {
    readonly size: number;
    readonly ink: Sides;
    readonly box: Sides;
    readonly fonts: readonly string[];
    readonly missing: readonly string[];
    readonly notes: readonly string[];
}

/** What the module tells of a picture. */
export interface ToldPicture extends ToldText {
    readonly width: number;
    readonly height: number;
    readonly premultiplied: boolean;
    readonly x: number;
    readonly y: number;
    readonly baseline: number;
    readonly margins: Sides;
    readonly key: string;
}

/** The picture of a text; boxes are in its pixels. */
export class TextPicture {
    readonly width: number;
    readonly height: number;
    /** R, G, B, A in packed rows, a copy. */
    readonly data: Uint8ClampedArray<ArrayBuffer>;
    /** Whether the colours of `data` are multiplied with their alpha. */
    readonly premultiplied: boolean;
    /** Where the origin of the text stands: where its first baseline begins. */
    readonly x: number;
    readonly y: number;
    /** The row of the first baseline. */
    readonly baseline: number;
    /** Of the font, in pixels: smaller than was asked for where the text was made to fit. */
    readonly size: number;
    /** Around the glyphs. */
    readonly ink: Box;
    /** Of the kind that was asked for. */
    readonly box: Box;
    /** How far the effects reach beyond the glyphs; the faint end of a glow may be a few pixels farther. */
    readonly margins: Margins;
    /** Of the looks, for a cache: that of their style, which does not tell the pixels of patterns. */
    readonly key: Uint8Array<ArrayBuffer>;
    /** The names of the fonts that have a glyph in it. */
    readonly fonts: readonly string[];
    /** The characters that no font has. */
    readonly missing: readonly string[];
    /** What is odd about it. */
    readonly notes: readonly string[];

    /** @internal */
    constructor(told: ToldPicture, bytes: Uint8Array<ArrayBuffer>) {
        this.width = told.width;
        this.height = told.height;
        this.data = new Uint8ClampedArray(bytes.buffer);
        this.premultiplied = told.premultiplied;
        this.x = told.x;
        this.y = told.y;
        this.baseline = told.baseline;
        this.size = told.size;
        this.ink = sidesOf(told.ink);
        this.box = sidesOf(told.box);
        this.margins = sidesOf(told.margins);
        this.key = bytesOfHex(told.key);
        this.fonts = told.fonts;
        this.missing = told.missing;
        this.notes = told.notes;
    }

    /** The straight pixels for a canvas. Throws VorelError where there is no ImageData. */
    imageData(): PlatformImageData {
        const pixels = this.data.slice();
        if (this.premultiplied) straighten(pixels);
        return imageDataOf(pixels, this.width, this.height);
    }
}
