import { convertIndexedToRgb, decode, type DecodedPng } from 'fast-png';
import { toBase64 } from '../model/base64';
import { limits } from '../model/check';
import type { PatternPixels } from '../model/work';

/**
 * Reads the PNG file of a pattern. A canvas would lose colours where a picture is translucent, so the file is
 * decoded here. Throws with a sentence for the reader.
 */
export function readPattern(bytes: Uint8Array): PatternPixels {
    const size = pngSize(bytes);
    if (!size) throw new Error('this is no PNG file; a pattern is a PNG');
    if (Math.max(size.width, size.height) > limits.patternSide) {
        throw new Error(
            `the picture is ${size.width} × ${size.height} pixels; a pattern has at most ${limits.patternSide} on a side`,
        );
    }
    const { width, height } = size;
    return { width, height, data: toBase64(rgbaOf(decoded(bytes))) };
}

/** Width and height from the head of a PNG file. */
function pngSize(bytes: Uint8Array): { width: number; height: number } | undefined {
    const head = [137, 80, 78, 71, 13, 10, 26, 10];
    if (bytes.length < 33 || head.some((byte, at) => bytes[at] !== byte)) return undefined;
    const view = new DataView(bytes.buffer, bytes.byteOffset, bytes.byteLength);
    return { width: view.getUint32(16), height: view.getUint32(20) };
}

function decoded(bytes: Uint8Array): DecodedPng {
    try {
        return decode(bytes);
    } catch {
        throw new Error('the PNG file is damaged');
    }
}

/** Four bytes a pixel of whatever kind the file has: grey, colour, palette, 1 to 16 bits. */
function rgbaOf(png: DecodedPng): Uint8Array {
    const { data, channels } = png.palette ? indexed(png) : eightBits(png);
    const count = png.width * png.height;
    const result = new Uint8Array(count * 4);
    for (let at = 0; at < count; at++) {
        const from = at * channels;
        const grey = channels < 3;
        for (let channel = 0; channel < 3; channel++) {
            result[at * 4 + channel] = data[from + (grey ? 0 : channel)] ?? 0;
        }
        const hasAlpha = channels === 2 || channels === 4;
        result[at * 4 + 3] = hasAlpha
            ? (data[from + channels - 1] ?? 0)
            : keyed(png, from)
              ? 0
              : 255;
    }
    return result;
}

function indexed(png: DecodedPng) {
    const channels = png.palette?.[0]?.length ?? 3;
    return { data: convertIndexedToRgb(png), channels };
}

function eightBits(png: DecodedPng) {
    const { channels, depth } = png;
    if (depth === 8) return { data: png.data, channels };
    if (depth === 16) return { data: Uint8Array.from(png.data, (value) => value >> 8), channels };
    return { data: unpacked(png, depth), channels };
}

/** Grey of 1, 2 or 4 bits, whose rows begin at whole bytes. */
function unpacked(png: DecodedPng, depth: number): Uint8Array {
    const most = (1 << depth) - 1;
    const perByte = 8 / depth;
    const stride = Math.ceil(png.width / perByte);
    return Uint8Array.from({ length: png.width * png.height }, (_, at) => {
        const column = at % png.width;
        const byte =
            png.data[Math.floor(at / png.width) * stride + Math.floor(column / perByte)] ?? 0;
        const shift = 8 - depth * ((column % perByte) + 1);
        return (((byte >> shift) & most) * 255) / most;
    });
}

/** Whether the pixel has the one colour that the file calls transparent. */
function keyed(png: DecodedPng, from: number): boolean {
    const key = png.transparency;
    if (!key || png.depth < 8) return false;
    return Array.from({ length: png.channels }, (_, at) => png.data[from + at] === key[at]).every(
        Boolean,
    );
}
