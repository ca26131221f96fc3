const signature = [0x89, 0x50, 0x4e, 0x47, 0x0d, 0x0a, 0x1a, 0x0a];
const bytesPerPixel = 4;

/** The remainders of PNG's checksum for each byte. */
const remainders = Uint32Array.from({ length: 256 }, (_, byte) => {
    let remainder = byte;
    for (let bit = 0; bit < 8; ++bit)
        remainder = remainder & 1 ? (remainder >>> 1) ^ 0xedb88320 : remainder >>> 1;
    return remainder;
});

function checksum(bytes: Uint8Array): number {
    let sum = 0xffffffff;
    for (const byte of bytes) sum = (sum >>> 8) ^ (remainders[(sum ^ byte) & 0xff] ?? 0);
    return (sum ^ 0xffffffff) >>> 0;
}

/** A chunk: the length of its data, its type and data, their checksum. */
function chunk(type: string, data: Uint8Array): Uint8Array {
    const whole = new Uint8Array(data.length + 12);
    const view = new DataView(whole.buffer);
    view.setUint32(0, data.length);
    whole.set(new TextEncoder().encode(type), 4);
    whole.set(data, 8);
    view.setUint32(data.length + 8, checksum(whole.subarray(4, data.length + 8)));
    return whole;
}

function header(width: number, height: number): Uint8Array {
    const data = new Uint8Array(13);
    const view = new DataView(data.buffer);
    view.setUint32(0, width);
    view.setUint32(4, height);
    data.set([8, 6], 8); // bits of a channel; red, green, blue and alpha
    return chunk('IHDR', data);
}

/** The sum of the bytes as signed numbers without their signs: the smaller, the better a row is packed. */
function weight(row: Uint8Array): number {
    let sum = 0;
    for (let i = 1; i < row.length; ++i) {
        const byte = row[i] ?? 0;
        sum += byte < 128 ? byte : 256 - byte;
    }
    return sum;
}

/** What stands left above a byte in the order of PNG's predictor of the nearest of three. */
function nearest(left: number, above: number, corner: number): number {
    const toLeft = Math.abs(above - corner);
    const toAbove = Math.abs(left - corner);
    const toCorner = Math.abs(left + above - 2 * corner);
    if (toLeft <= toAbove && toLeft <= toCorner) return left;
    return toAbove <= toCorner ? above : corner;
}

/** PNG's five filters by their numbers: what is taken from a byte. */
const predictions: readonly ((left: number, above: number, corner: number) => number)[] = [
    () => 0,
    (left) => left,
    (_, above) => above,
    (left, above) => (left + above) >> 1,
    nearest,
];

/** The row behind the number of its filter. `above` are the bytes of the row before. */
function filtered(kind: number, row: ArrayLike<number>, above: ArrayLike<number>): Uint8Array {
    const predict = predictions[kind] ?? nearest;
    const result = new Uint8Array(row.length + 1);
    result[0] = kind;
    for (let i = 0; i < row.length; ++i) {
        const left = row[i - bytesPerPixel] ?? 0;
        const corner = above[i - bytesPerPixel] ?? 0;
        result[i + 1] = (row[i] ?? 0) - predict(left, above[i] ?? 0, corner);
    }
    return result;
}

/** All rows, each with the filter that leaves it the least weight; of equal ones the first. */
function filteredRows(data: Uint8ClampedArray, width: number, height: number): Uint8Array {
    const stride = width * bytesPerPixel;
    const rows = new Uint8Array((stride + 1) * height);
    let above: Uint8ClampedArray = new Uint8ClampedArray(stride);
    for (let y = 0; y < height; ++y) {
        const row = data.subarray(y * stride, (y + 1) * stride);
        const tried = predictions.map((_, kind) => filtered(kind, row, above));
        const weights = tried.map(weight);
        const best = tried[weights.indexOf(Math.min(...weights))];
        if (best) rows.set(best, y * (stride + 1));
        above = row;
    }
    return rows;
}

async function deflated(data: Uint8Array<ArrayBuffer>): Promise<Uint8Array> {
    const packed = new Blob([data]).stream().pipeThrough(new CompressionStream('deflate'));
    return new Uint8Array(await new Response(packed).arrayBuffer());
}

/**
 * A PNG of straight R, G, B, A pixels in packed rows, both sides 1 or more. It has the very bytes, those of
 * clear pixels included, which a canvas would lose, and is the same every time. Throws RangeError where the
 * data is of another size.
 */
export async function png(
    data: Uint8ClampedArray,
    width: number,
    height: number,
): Promise<Uint8Array<ArrayBuffer>> {
    const isSized = Number.isInteger(width) && Number.isInteger(height) && width > 0 && height > 0;
    if (!isSized || data.length !== width * height * bytesPerPixel) {
        throw new RangeError(`${data.length} bytes are no picture of ${width} x ${height} pixels`);
    }
    const rows = await deflated(filteredRows(data, width, height) as Uint8Array<ArrayBuffer>);
    const parts = [
        Uint8Array.from(signature),
        header(width, height),
        chunk('IDAT', rows),
        chunk('IEND', new Uint8Array()),
    ];
    return new Uint8Array(await new Blob(parts as BlobPart[]).arrayBuffer());
}
