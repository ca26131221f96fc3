// What the page and its worker both paint.
import { disc } from '../scenes.js';

/** An opaque page: a canvas keeps such pixels as they are. */
export const PAGE = {
    width: 90,
    height: 70,
    data: () =>
        Uint8Array.from({ length: 4 * 90 * 70 }, (_, i) => (i % 4 === 3 ? 255 : (i * 7) % 256)),
};

export function lookIn(ve) {
    return new ve.Look()
        .fill('#3366cc', 0.8)
        .outerShadow('#000', { size: 8, opacity: 0.6 })
        .stroke(4, '#fff', { opacity: 0.7 });
}

export function numbersOf(bytes) {
    return Array.from(bytes);
}

/** The pixels of a canvas that was painted onto. */
export function canvasBytes(ve, canvas) {
    const context = canvas.getContext('2d');
    const { width, height } = PAGE;
    context.putImageData(new ImageData(new Uint8ClampedArray(PAGE.data()), width, height), 0, 0);
    const box = lookIn(ve).paint(disc(), canvas, { x: 20, y: 20 });
    const away = lookIn(ve).paint(disc(), canvas, { x: 2000, y: 20 });
    return { box, away, bytes: numbersOf(context.getImageData(0, 0, width, height).data) };
}
