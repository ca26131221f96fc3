// Paints the pictures of voreleffect_costs with Skia, in this process, into a canvas that is kept:
//
//     skia_costs.mjs PICTURES.json SECONDS [FOLDER]    a line a figure: row, Skia, seconds of the fastest call.
//                                                      FOLDER gets the pictures as well
//     skia_costs.mjs --version
//
// Each look gets SECONDS on a picture. Glyphs stay in Skia's caches from call to call.
import { readFileSync, writeFileSync } from "node:fs";
import process, { argv } from "node:process";
import { castShadow, createCanvas, GlobalFonts, printVersion } from "./skia.mjs";

const tileSide = 32;
const tileScale = 1.5;

/** The tile of bench/fill_paint.h. */
function makeTile() {
    const tile = createCanvas(tileSide, tileSide);
    const context = tile.getContext("2d");
    const image = context.createImageData(tileSide, tileSide);
    for (let y = 0; y < tileSide; y++) {
        for (let x = 0; x < tileSide; x++) {
            const slope = Math.floor(((x + y) * 255) / (2 * tileSide - 2));
            const weave = ((Math.floor(x / 8) + Math.floor(y / 8)) % 2) * 160 + 40;
            image.data.set([slope, weave, 255 - slope, 255], 4 * (y * tileSide + x));
        }
    }
    context.putImageData(image, 0, 0);
    return tile;
}

function patternOf(context) {
    const pattern = context.createPattern(makeTile(), "repeat");
    pattern.setTransform({ a: tileScale, b: 0, c: 0, d: tileScale, e: 0, f: 0 });
    return pattern;
}

/** The stops of bench/fill_paint.h, from the bottom of the text to its top. */
function rampOf(context, picture) {
    const ramp = context.createLinearGradient(0, picture.height - picture.margin, 0, picture.margin);
    ramp.addColorStop(0, "#FFD000");
    ramp.addColorStop(0.5, "#E02010");
    ramp.addColorStop(1, "#2030C0");
    return ramp;
}

/** A canvas with all texts of a picture, and where each stands. */
class Page {
    constructor(picture) {
        this.canvas = createCanvas(picture.width, picture.height);
        this.context = this.canvas.getContext("2d");
        this.context.lineJoin = "round";
        this.ramp = rampOf(this.context, picture);
        this.pattern = patternOf(this.context);
        this.lines = picture.lines.map((line) => this.placed(line));
    }

    /** The baseline that brings the extents of the text to their place. */
    placed({ text, font, size, left, top }) {
        const css = `${size}px "${font}"`;
        this.context.font = css;
        const extents = this.context.measureText(text);
        const x = left + extents.actualBoundingBoxLeft;
        return { text, css, x, y: top + extents.actualBoundingBoxAscent };
    }

    clear() {
        this.context.clearRect(0, 0, this.canvas.width, this.canvas.height);
    }

    fill(style) {
        this.context.fillStyle = style;
        for (const { text, css, x, y } of this.lines) {
            this.context.font = css;
            this.context.fillText(text, x, y);
        }
    }

    stroke(colour, lineWidth) {
        this.context.strokeStyle = colour;
        this.context.lineWidth = lineWidth;
        for (const { text, css, x, y } of this.lines) {
            this.context.font = css;
            this.context.strokeText(text, x, y);
        }
    }

    castShadow(colour, size, distance) {
        castShadow(this.context, colour, size, distance);
    }

    /** Canvases record what they are told; reading a pixel makes them paint it. */
    finish() {
        this.context.getImageData(0, 0, 1, 1);
    }
}

const noShadow = ["transparent", 0, 0];

const looks = {
    /** Stroke of 4 outside, shadow of 8 at a distance of 6 to the lower right, gradient. */
    A(page) {
        page.castShadow("rgba(0, 0, 0, 0.6)", 8, 6 * Math.SQRT1_2);
        page.stroke("#FFFFFF", 8);
        page.castShadow(...noShadow);
        page.fill(page.ramp);
    },
    /** A glow of 16 pixels: a wide stroke and the shadow around it. */
    B(page) {
        page.castShadow("#FFC040", 9, 0);
        page.stroke("#FFC040", 14);
        page.castShadow(...noShadow);
        page.fill("#3060A0");
    },
    /** Pattern and centred stroke. The shadow inside is left out, for a canvas has none. */
    C(page) {
        page.fill(page.pattern);
        page.stroke("#102030", 6);
    },
};

function paint(page, look) {
    page.clear();
    look(page);
    page.finish();
}

/** In seconds; for calls from a millisecond on the processor's time, which stops when another process has the core. */
function clockFor(fastest) {
    if (fastest < 1e-3) {
        return () => performance.now() / 1e3;
    }
    return () => {
        const { user, system } = process.cpuUsage();
        return (user + system) / 1e6;
    };
}

/** The seconds of the fastest call; the first one, which fills the caches, does not count. */
function fastestCall(page, look, seconds) {
    paint(page, look);
    let fastest = Infinity;
    let taken = 0;
    for (let calls = 0; calls < 3 || taken < seconds; calls++) {
        const now = clockFor(calls > 0 ? fastest : 0);
        const before = now();
        paint(page, look);
        const call = now() - before;
        taken += call;
        fastest = Math.min(fastest, call);
    }
    return fastest;
}

function measure(picture, seconds, folder) {
    const page = new Page(picture);
    for (const [name, look] of Object.entries(looks)) {
        console.log(`look/${name}/${picture.name} Skia ${fastestCall(page, look, seconds).toFixed(9)}`);
        if (folder) {
            writeFileSync(`${folder}/${picture.name}-${name}.png`, page.canvas.toBuffer("image/png"));
        }
    }
}

function main() {
    if (argv[2] === "--version") {
        printVersion();
        return;
    }
    const [file, seconds, folder] = argv.slice(2);
    const pictures = JSON.parse(readFileSync(file, "utf8"));
    for (const font of new Set(pictures.flatMap((picture) => picture.lines.map((line) => line.font)))) {
        GlobalFonts.registerFromPath(font, font);
    }
    for (const picture of pictures) {
        measure(picture, Number(seconds), folder);
    }
}

main();
