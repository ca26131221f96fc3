/** The smallest module that has an instruction on 128-bit vectors. */
const vectors = Uint8Array.of(
    0,
    97,
    115,
    109,
    1,
    0,
    0,
    0,
    1,
    5,
    1,
    96,
    0,
    1,
    123,
    3,
    2,
    1,
    0,
    10,
    10,
    1,
    8,
    0,
    65,
    0,
    253,
    15,
    253,
    98,
    11,
);

/** Why the page cannot paint here in one sentence, or an empty text. */
export function missingSupport(): string {
    if (typeof Worker === 'undefined')
        return 'This browser has no workers, in which the studio paints.';
    if (typeof WebAssembly === 'undefined') {
        return 'This browser runs no WebAssembly, or it is switched off; the studio paints with it.';
    }
    if (!WebAssembly.validate(vectors)) {
        return 'This browser’s WebAssembly has no vector instructions (SIMD); a version from 2023 or later has them.';
    }
    if (typeof CompressionStream === 'undefined') {
        return 'This browser cannot compress (CompressionStream); a version from 2023 or later can.';
    }
    return '';
}
