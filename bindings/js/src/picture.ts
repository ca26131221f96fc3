import { VorelError } from './errors.js';

/** The platform's ImageData; where there is none, what one is like. */
export type PlatformImageData = typeof globalThis extends { ImageData: { prototype: infer Kind } }
    ? Kind
    : {
          readonly data: Uint8ClampedArray<ArrayBuffer>;
          readonly width: number;
          readonly height: number;
      };

/** Premultiplied pixels, just large enough for the glyphs and their effects; empty when nothing is painted. */
export class Picture {
    /** @internal */
    constructor(
        /** Red, green, blue, alpha in packed rows, top row first; the picture's own copy. */
        readonly data: Uint8ClampedArray<ArrayBuffer>,
        /** Pixels of a row. */
        readonly width: number,
        /** Rows. */
        readonly height: number,
        /** Its left column, from the origin of the text. */
        readonly left: number,
        /** Its top row, from the origin of the text. */
        readonly top: number,
    ) {}

    /**
     * The pixels with alpha divided out: (255 * channel + floor(alpha / 2)) / alpha, rounded down, at most 255; 0
     * where alpha is 0.
     */
    straight(): Uint8ClampedArray<ArrayBuffer> {
        const pixels = this.data.slice();
        straighten(pixels);
        return pixels;
    }

    /** The straight pixels for a canvas. Throws VorelError of an empty picture and where there is no ImageData. */
    imageData(): PlatformImageData {
        return imageDataOf(this.straight(), this.width, this.height);
    }
}

/** Straight pixels as ImageData. Throws VorelError where there can be none. */
export function imageDataOf(
    pixels: Uint8ClampedArray<ArrayBuffer>,
    width: number,
    height: number,
): PlatformImageData {
    if (typeof ImageData === 'undefined') {
        throw new VorelError('there is no ImageData here: take straight()');
    }
    if (width === 0 || height === 0) throw new VorelError('an empty picture is no ImageData');
    return new ImageData(pixels, width, height);
}

/** Divides alpha out of premultiplied pixels in their place. */
export function straighten(pixels: Uint8Array | Uint8ClampedArray): void {
    for (let at = 0; at < pixels.length; at += 4) {
        const alpha = pixels[at + 3]!;
        if (alpha === 255) continue;
        for (let i = at; i < at + 3; ++i) pixels[i] = straightened(pixels[i]!, alpha);
    }
}

/** A channel with alpha divided out, rounded to nearest and at most 255. */
export function straightened(channel: number, alpha: number): number {
    if (alpha === 0) return 0;
    return Math.min(255, Math.floor((channel * 255 + (alpha >> 1)) / alpha));
}

/** A channel multiplied with alpha, rounded to nearest. */
export function premultiplied(channel: number, alpha: number): number {
    return Math.floor((channel * alpha + 127) / 255);
}
