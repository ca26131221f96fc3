// The scenes of tests/determinism/hashes.cpp in the words of this face, for node and for pages.

const WIDTH = 72;
const HEIGHT = 60;
const PLACE = { x: 19, y: 15 };
const INK = 0x3060a0;

const STOPS = [
    ['#FFD000', 0],
    ['#E02010', 0.5],
    ['#2030C0', 1, 0.8],
];

/** A 4 x 4 checker of an opaque and a translucent colour. */
const TILE = {
    width: 4,
    height: 4,
    data: Uint8Array.from(
        Array.from({ length: 16 }, (_, i) => {
            const isTranslucent = (Math.floor((i % 4) / 2) + Math.floor(i / 8)) % 2;
            return isTranslucent ? [40, 80, 240, 160] : [240, 80, 40, 255];
        }).flat(),
    ),
};

/** A sweep paints one look for each value of its range. */
const SWEEPS = [
    ['text opacity', 0, 20, 1, (look, i) => look.textOpacity(i / 20)],
    ...['outside', 'inside', 'centre'].map((position) => [
        `stroke ${position} size`,
        ...[0, 40, 1],
        (look, i) => look.stroke(i, 0xe03020, { position, opacity: 0.9 }),
    ]),
    ...[
        ['outer', 17, 5],
        ['inner', 5, 3],
    ].flatMap(([side, far, near]) => {
        const add = (look, angle, distance, size) =>
            look[`${side}Shadow`](0x201008, { angle, distance, size, opacity: 0.8 });
        return [
            [`${side} shadow angle`, 0, 359, 1, (look, i) => add(look, i, far, 2)],
            [`${side} shadow size`, 0, 100, 1, (look, i) => add(look, 30, near, i)],
        ];
    }),
    ['outer glow size', 0, 100, 4, (look, i) => look.outerGlow(i, 0xffc000, { opacity: 0.9 })],
    [
        'outer glow stops size',
        ...[0, 40, 2],
        (look, i) => look.outerGlow(i, 0, { stops: STOPS, opacity: 0.9 }),
    ],
    ['inner glow size', 0, 100, 4, (look, i) => look.innerGlow(i, 0xffc000, { opacity: 0.9 })],
    [
        'linear gradient angle',
        ...[0, 359, 1],
        (look, i) => look.linearGradient(STOPS, { angle: i, opacity: 0.9 }),
    ],
    [
        'linear gradient scale',
        ...[0, 40, 1],
        (look, i) => look.linearGradient(STOPS, { angle: 37, scale: i / 20 }),
    ],
    [
        'radial gradient scale',
        ...[0, 40, 1],
        (look, i) => look.radialGradient(STOPS, { scale: i / 20, opacity: 0.9 }),
    ],
    ['pattern scale', 0, 100, 1, (look, i) => look.pattern(TILE, { scale: i / 10, opacity: 0.9 })],
    ['all layered', 0, 10, 1, everything],
];

/** Every kind of effect but the radial gradient at once. */
function everything(look, i) {
    return look
        .textOpacity(i / 20)
        .outerShadow(0, { angle: 40 * i, distance: 6, size: 3, opacity: 0.6 })
        .outerGlow(i, 0x00c0ff, { opacity: 0.8 })
        .stroke(i, 0xffffff, { position: ['centre', 'outside', 'inside'][i % 3] })
        .linearGradient(STOPS, { angle: 33 * i, opacity: 0.7 })
        .pattern(TILE, { scale: 1.5, opacity: 0.5 })
        .innerGlow(1, 0xffffff, { opacity: 0.5 })
        .innerShadow(0x400000, { angle: 300, distance: 2, size: 1, opacity: 0.8 });
}

/** A disc whose rim is one pixel of falling coverage. */
function disc() {
    const [width, height] = [34, 26];
    const f = Math.fround;
    const data = Uint8Array.from({ length: width * height }, (_, i) => {
        const [dx, dy] = [(i % width) - 16.5, Math.floor(i / width) - 13];
        const inside = f(12 - f(Math.sqrt(f(f(dx * dx) + f(dy * dy)))));
        return f(Math.min(Math.max(inside, 0), 1) * 255);
    });
    return { width, height, data };
}

/** The generator of tests/support/random.h. */
function* random(seed) {
    let state = BigInt.asUintN(64, seed * 2685821657736338717n + 88172645463325252n);
    for (;;) {
        state ^= state >> 12n;
        state = BigInt.asUintN(64, state ^ (state << 25n));
        state ^= state >> 27n;
        yield Number(BigInt.asUintN(64, state * 2685821657736338717n) >> 32n);
    }
}

/** Every pixel random, 60 of 100 empty. */
function noise() {
    const [width, height] = [29, 17];
    const numbers = random(7n);
    const next = () => numbers.next().value;
    const data = Uint8Array.from({ length: width * height }, () =>
        1 + (next() % 100) <= 60 ? 0 : next() >>> 24,
    );
    return { width, height, data };
}

/** FNV-1a of 64 bits in two halves of 32. */
class Hash {
    #high = 0xcbf29ce4;
    #low = 0x84222325;

    add(bytes) {
        for (const byte of bytes) {
            const low = (this.#low ^ byte) >>> 0;
            // times 2^40 + 0x1b3
            const product = low * 0x1b3;
            const carry = Math.floor(product / 2 ** 32);
            this.#high = (Math.imul(this.#high, 0x1b3) + carry + (low << 8)) >>> 0;
            this.#low = product >>> 0;
        }
    }
    toString() {
        return [this.#high, this.#low].map((half) => half.toString(16).padStart(8, '0')).join('');
    }
}

function hashOf(ve, [, first, last, step, add], mask, filled) {
    const hash = new Hash();
    for (let i = first; i <= last; i += step) {
        const page = { width: WIDTH, height: HEIGHT, data: new Uint8Array(4 * WIDTH * HEIGHT) };
        const look = add(new ve.Look().fill(filled), i);
        look.paint(mask, page, PLACE);
        look.free();
        hash.add(page.data);
    }
    return String(hash);
}

/** The lines of the table, as tests/determinism/hashes.txt has them. */
export function linesOf(ve) {
    const masks = { disc: disc(), noise: noise() };
    const lines = Object.entries(masks).flatMap(([name, mask]) =>
        SWEEPS.map((sweep) => [`${sweep[0]}, ${name}`, hashOf(ve, sweep, mask, INK)]),
    );
    return lines.sort(([a], [b]) => (a < b ? -1 : 1)).map(([scene, hash]) => `${hash}  ${scene}`);
}

export { disc, everything, noise, STOPS, TILE };
