// What the scripts share that paint with Skia, by the canvas of @napi-rs/canvas. RIVALS_NODE is the folder that the
// package is installed in.
import { createRequire } from "node:module";
import { resolve } from "node:path";
import { env } from "node:process";

const require = createRequire(resolve(env.RIVALS_NODE, "package.json"));

export const { createCanvas, GlobalFonts } = require("@napi-rs/canvas");

export function printVersion() {
    const { version } = require("@napi-rs/canvas/package.json");
    console.log(`Skia by napi-rs canvas ${version}`);
}

/** What is drawn next throws a shadow; twice the sigma of the blur is its size. */
export function castShadow(context, colour, size, distance) {
    context.shadowColor = colour;
    context.shadowBlur = size;
    context.shadowOffsetX = context.shadowOffsetY = distance;
}
