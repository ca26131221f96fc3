import { execFileSync } from 'node:child_process';
import { mkdtempSync, readFileSync, rmSync, symlinkSync, writeFileSync } from 'node:fs';
import { tmpdir } from 'node:os';
import { basename, join, resolve } from 'node:path';
import type { Page } from '@playwright/test';
import { decode } from 'fast-png';
import { shippedFonts } from '../src/engine/fonts';
import { firstWork, type Work } from '../src/model/work';
import { expect, picture, test } from './page';

/*
 * The pictures that the page saves and shows, beside those of vorelpaint for what it exports: the style file, the
 * pictures of patterns and the command, which runs where they and the person's own font lie.
 */

const tools = resolve('../build/release/tools');
const arabic = '/usr/share/fonts/opentype/fonts-hosny-amiri/Amiri-Regular.ttf';

const scripts: Readonly<Record<string, Partial<Work> & { text: string }>> = {
    Latin: { text: 'Office, AVA\n& fjord', font: 'dejavu-sans-bold' },
    Arabic: { text: 'السلام عليكم ١٢٣', align: 'start' },
    Devanagari: { text: 'क्षत्रिय किताब', font: 'lohit-devanagari', letterSpacing: '2%' },
};

/** Few presets will do: the chosen font lacks letters that others have. */
const mixed = { text: 'Лето in हिन्दी', font: 'lobster' };

interface Pixels {
    width: number;
    height: number;
    data: Uint8Array;
}

interface SavedFile {
    name: string;
    base64: string;
}

/** The straight R, G, B, A of a PNG file, which has a palette or as few channels as will do. */
function pixelsOf(file: Uint8Array): Pixels {
    const { width, height, data, channels, palette } = decode(file);
    const pixels = new Uint8Array(4 * width * height).fill(255);
    const places = [[], [0, 0, 0], [0, 0, 0, 1], [0, 1, 2], [0, 1, 2, 3]];
    for (let at = 0; at < width * height; at++) {
        const pixel = palette?.[data[at] ?? 0] ?? data.subarray(channels * at, channels * (at + 1));
        const order = places[pixel.length] ?? [];
        order.forEach((place, i) => (pixels[4 * at + i] = pixel[place] ?? 255));
    }
    return { width, height, data: pixels };
}

/** Where the pictures differ, or an empty text; without `all`, of what is opaque in `one`. */
function difference(one: Pixels, other: Pixels, all = true): string {
    const sizes = [one, other].map(({ width, height }) => `${width} x ${height}`);
    if (sizes[0] !== sizes[1]) return sizes.join(', not ');
    const counts = (at: number) => all || one.data[at | 3] === 255;
    const at = one.data.findIndex((byte, place) => byte !== other.data[place] && counts(place));
    return at < 0 ? '' : `byte ${at}: ${one.data[at]}, not ${other.data[at]}`;
}

/** Keeps what the page hands to the browser to be saved. */
function catchFiles(page: Page): Promise<void> {
    return page.evaluate(() => {
        const blobs = new Map<string, Blob>();
        const files: { name: string; blob: Blob }[] = [];
        const create = URL.createObjectURL.bind(URL);
        URL.createObjectURL = (blob: Blob) => {
            const address = create(blob);
            blobs.set(address, blob);
            return address;
        };
        HTMLAnchorElement.prototype.click = function () {
            const blob = blobs.get(this.href);
            if (blob) files.push({ name: this.download, blob });
        };
        Object.assign(globalThis, { files });
    });
}

/** Presses the button and gives what it saves, `count` files. */
function saved(page: Page, button: string, count = 1): Promise<SavedFile[]> {
    return page.evaluate(
        async ({ button, count }) => {
            const { files } = globalThis as unknown as { files: { name: string; blob: Blob }[] };
            const found = [...document.querySelectorAll('button')].find(
                (each) => each.textContent.trim() === button,
            );
            found?.click();
            while (files.length < count) await new Promise((done) => setTimeout(done, 2));
            const bytes = files.splice(0).map(async ({ name, blob }) => {
                const binary = Array.from(new Uint8Array(await blob.arrayBuffer()), (byte) =>
                    String.fromCharCode(byte),
                );
                return { name, base64: btoa(binary.join('')) };
            });
            return Promise.all(bytes);
        },
        { button, count },
    );
}

async function savedPng(page: Page, scale: number): Promise<Pixels> {
    const [file] = await saved(page, `PNG ${scale}×`);
    return pixelsOf(Buffer.from(file?.base64 ?? '', 'base64'));
}

/** Writes what the buttons save into the folder. */
async function keep(page: Page, folder: string, button: string, count = 1): Promise<void> {
    for (const { name, base64 } of await saved(page, button, count)) {
        writeFileSync(join(folder, name), Buffer.from(base64, 'base64'));
    }
}

function painted(folder: string, command: string): Pixels {
    const env = { ...process.env, PATH: `${tools}:${process.env['PATH']}` };
    execFileSync('sh', ['-c', command], { cwd: folder, env });
    return pixelsOf(readFileSync(join(folder, 'title.png')));
}

/** What the canvas has: colours of what is translucent have gone through premultiplied ones. */
async function shown(page: Page): Promise<Pixels> {
    const { data, ...size } = await picture(page).evaluate((canvas: HTMLCanvasElement) => {
        const { width, height } = canvas;
        const pixels = canvas.getContext('2d')?.getImageData(0, 0, width, height);
        return { width, height, data: [...(pixels?.data ?? [])] };
    });
    return { ...size, data: Uint8Array.from(data) };
}

/** Opens the text in its script, with the font that the page has not, and gives the exported command. */
async function begin(page: Page, work: Partial<Work>, folder: string): Promise<string> {
    const start = { ...firstWork, font: basename(arabic), size: 40, ...work };
    await page.getByLabel('Open a font file…').setInputFiles(arabic);
    await expect(page.getByLabel('Font', { exact: true })).toHaveValue(basename(arabic));
    const buffer = Buffer.from(JSON.stringify(start));
    await page
        .getByLabel('Open work or style…')
        .setInputFiles({ name: 'start.studio.json', mimeType: 'application/json', buffer });
    await page.getByRole('tab', { name: 'Command' }).click();
    await expect(page.locator('pre code')).toContainText(`--size ${start.size}`);
    await keep(page, folder, 'title.sh');
    symlinkSync(arabic, join(folder, basename(arabic)));
    return readFileSync(join(folder, 'title.sh'), 'utf8');
}

const styleField = '[aria-labelledby=save-style] textarea';

/** Takes the preset and saves its style, and the picture of its pattern if it has one. */
async function take(page: Page, preset: string, folder: string): Promise<string> {
    const before = await page.locator(styleField).inputValue();
    await page.getByRole('button', { name: preset, exact: true }).click();
    await expect(page.locator(styleField)).not.toHaveValue(before);
    await keep(page, folder, 'Download');
    const style = readFileSync(join(folder, 'title.json'), 'utf8');
    const images = new Set([...style.matchAll(/"image": "/g)]);
    if (images.size > 0) await keep(page, folder, 'Pictures of patterns');
    return style;
}

test.describe.configure({ mode: 'parallel' });

test('names shipped fonts so that vorelpaint finds the same', () => {
    const folder = mkdtempSync(join(tmpdir(), 'studio-fonts-'));
    for (const { file, query } of shippedFonts) {
        const [own, found] = [resolve('public/fonts', file), query].map((font) =>
            painted(folder, `vorelpaint --font '${font}' -o title.png Agक`),
        );
        expect(own && found && difference(own, found), query).toBe('');
    }
    rmSync(folder, { recursive: true });
});

for (const [script, work] of Object.entries({ ...scripts, mixed })) {
    test(`saves and shows the pictures of vorelpaint, ${script}`, async ({ studio }) => {
        const folder = mkdtempSync(join(tmpdir(), 'studio-equality-'));
        await studio.getByRole('button', { name: /^Save:/ }).click();
        await catchFiles(studio);
        const command = await begin(studio, work, folder);
        const presets = await studio.locator('.preset-name').allTextContents();
        expect(presets).toHaveLength(26);
        for (const [at, preset] of presets.entries()) {
            if (work === mixed && at % 12 > 0) continue;
            const style = await take(studio, preset, folder);
            const one = await savedPng(studio, 1);
            expect(difference(one, painted(folder, command)), preset).toBe('');
            if (at % 6 > 0) continue;
            await expect
                .poll(async () => difference(one, await shown(studio), false), { message: preset })
                .toBe('');
            // Where all lengths are percent, the larger picture is that of the larger size.
            if (/"(size|distance|x|y|width)": \d/.test(style)) continue;
            for (const scale of [2, 3]) {
                const larger = `--size ${40 * scale} --padding ${8 * scale}`;
                const again = command.replace('--size 40', larger);
                expect(difference(await savedPng(studio, scale), painted(folder, again))).toBe('');
            }
        }
        rmSync(folder, { recursive: true });
    });
}
