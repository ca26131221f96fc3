// Paints a title a line with Skia, by the canvas of @napi-rs/canvas, in one process of JOBS threads:
//
//     skia_titles.mjs shadow|gradient|glow TITLES FOLDER JOBS
//     skia_titles.mjs --version
//
// A thread has one canvas for all pictures.
import { readFileSync, writeFileSync } from "node:fs";
import { argv } from "node:process";
import { isMainThread, Worker, workerData } from "node:worker_threads";
import { castShadow, createCanvas, GlobalFonts, printVersion } from "./skia.mjs";

const width = 1500;
const height = 130;
const centre = [width / 2, 92];

function draw(context, text, fill) {
    context.fillStyle = fill;
    context.fillText(text, ...centre);
}

function drawOutline(context, text, colour, lineWidth) {
    context.strokeStyle = colour;
    context.lineWidth = lineWidth;
    context.strokeText(text, ...centre);
}

const looks = {
    shadow(context, text) {
        castShadow(context, "rgba(0, 0, 0, 0.75)", 8, 5);
        drawOutline(context, text, "#000000", 8);
        castShadow(context, "transparent", 0, 0);
        draw(context, text, "#FFFFFF");
    },
    gradient(context, text) {
        const ramp = context.createLinearGradient(0, 18, 0, 113);
        ramp.addColorStop(0, "#FFE08A");
        ramp.addColorStop(1, "#F08A24");
        drawOutline(context, text, "#5A2A00", 8);
        draw(context, text, ramp);
    },
    glow(context, text) {
        castShadow(context, "#2090FF", 8, 0);
        drawOutline(context, text, "#2090FF", 12);
        castShadow(context, "transparent", 0, 0);
        draw(context, text, "#FFFFFF");
    },
};

function paintShare({ look, titles, folder, share, jobs }) {
    const canvas = createCanvas(width, height);
    const context = canvas.getContext("2d");
    context.font = "bold 96px Title";
    context.textAlign = "center";
    context.lineJoin = "round";
    for (let number = share; number < titles.length; number += jobs) {
        context.clearRect(0, 0, width, height);
        looks[look](context, titles[number]);
        writeFileSync(`${folder}/${number}.png`, canvas.toBuffer("image/png"));
    }
}

function main() {
    if (argv[2] === "--version") {
        printVersion();
        return;
    }
    const [look, file, folder] = argv.slice(2);
    const jobs = Number(argv[5]);
    const titles = readFileSync(file, "utf8").trimEnd().split("\n");
    GlobalFonts.registerFromPath("/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf", "Title");
    for (let share = 1; share < jobs; share++) {
        new Worker(new URL(import.meta.url), { workerData: { look, titles, folder, share, jobs } });
    }
    paintShare({ look, titles, folder, share: 0, jobs });
}

if (isMainThread) {
    main();
} else {
    paintShare(workerData);
}
