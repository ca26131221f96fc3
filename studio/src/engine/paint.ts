import type { Font, Style, TextOptions, VoreleffectText } from 'voreleffect/text';
import type { ExportEngine } from '../export';
import { fromBase64 } from '../model/base64';
import type { StyleFile } from '../model/style_file';
import type { PatternPixels, Work } from '../model/work';
import { fallbackFonts, shippedFonts } from './fonts';
import type { Box, Facts, Layer, Painted } from './messages';

/** The engine's answers of works, in plain objects that can be sent to the page. */
export class Studio {
    private readonly names = new Set<string>();
    private readonly fonts = new Map<string, Promise<Font>>();
    /** Text and font for which the chosen font alone was not enough. */
    private lacking = '';
    private styled:
        { style: StyleFile; patterns: Readonly<Work['patterns']>; value: Style } | undefined;
    private readonly pixels = new WeakMap<PatternPixels, Pixels>();

    /** `fontsAt` is the address of the folder of shipped fonts. */
    constructor(
        private readonly engine: VoreleffectText,
        private readonly fontsAt: URL,
    ) {}

    /** Takes a font of the person's own under its name. Throws where the bytes are none. */
    addFont(name: string, bytes: Uint8Array): string {
        const font = this.made(bytes, name);
        void this.fonts.get(name)?.then((before) => before.free());
        this.fonts.set(name, Promise.resolve(font));
        this.lacking = '';
        return font.family;
    }

    /** A font under its name, or under one of its own where a font before it has the name. */
    private made(bytes: Uint8Array | ArrayBuffer, name: string): Font {
        const own = this.names.has(name) ? `${name} (${this.names.size})` : name;
        const font = new this.engine.Font(bytes, { name: own });
        this.names.add(own);
        return font;
    }

    /** Paints the work, on nothing or on a ground of the colour '#rrggbb'. */
    async paint(work: Work, ground?: string): Promise<Painted> {
        const options = {
            ...(await this.options(work)),
            ...(ground ? { background: ground } : {}),
        };
        const began = performance.now();
        const picture = this.engine.Text.picture(work.text, options);
        const milliseconds = performance.now() - began;
        if (picture.missing.length > 0 && this.lacking !== lackingKey(work)) {
            this.lacking = lackingKey(work);
            return this.paint(work, ground);
        }
        return {
            data: new Uint8ClampedArray(picture.data),
            width: picture.width,
            height: picture.height,
            milliseconds,
            origin: { x: picture.x, y: picture.y },
            margins: plainBox(picture.margins),
            ink: plainBox(picture.ink),
            box: plainBox(picture.box),
            missing: picture.missing.map(String),
            notes: [...picture.notes],
            fonts: [...picture.fonts],
        };
    }

    async facts(work: Work, measured: boolean): Promise<Facts> {
        const options = await this.options(work);
        const explained = measured
            ? this.engine.Text.explain(work.text, options)
            : this.style(work.style, work.patterns).explain(work.size);
        const layout = this.engine.Text.layout(work.text, options);
        return {
            looks: explained.looks.toReversed().map((look) => ({
                ...look,
                order: look.order.map((step) => ({ ...step })),
            })),
            key: explained.key.map(({ name, meaning }) => ({ name, meaning })),
            keyBytes: explained.keyBytes.length,
            lines: layout.lines.map(({ baseline, box }) => ({ baseline, box: plainBox(box) })),
        };
    }

    async layers(work: Work): Promise<Layer[]> {
        const options = await this.options(work);
        return this.engine.Text.layers(work.text, options).map((layer) => ({
            look: layer.look,
            effect: layer.effect,
            place: layer.place,
            milliseconds: layer.milliseconds,
            data: straight(layer.data),
            width: layer.width,
            height: layer.height,
        }));
    }

    /** The style of a work; one that was read a moment ago is not read again. Throws the engine's StyleError. */
    style(style: StyleFile, patterns: Readonly<Record<string, PatternPixels>>): Style {
        if (this.styled && this.styled.style === style && this.styled.patterns === patterns) {
            return this.styled.value;
        }
        const images = Object.fromEntries(
            Object.entries(patterns).map(([name, pixels]) => [name, this.pixelsOf(pixels)]),
        );
        this.styled?.value.free();
        this.styled = undefined;
        const value = this.engine.Style.fromJSON(JSON.stringify(style), { name: 'style', images });
        this.styled = { style, patterns, value };
        return value;
    }

    /** What the writers of code ask the engine. */
    exportEngine(): ExportEngine {
        return {
            toCpp: (style, size, { name, patterns, ...options }) =>
                this.style(style, patterns).toCpp(name, size, options),
            fontNames: (work) =>
                this.fontIds(work).map(
                    (id) => shippedFonts.find((font) => font.id === id)?.query ?? id,
                ),
        };
    }

    private pixelsOf(pattern: PatternPixels): Pixels {
        const known = this.pixels.get(pattern);
        if (known) return known;
        const data = new Uint8ClampedArray(fromBase64(pattern.data).buffer);
        const pixels = { data, width: pattern.width, height: pattern.height };
        this.pixels.set(pattern, pixels);
        return pixels;
    }

    private async options(work: Work): Promise<TextOptions> {
        return {
            fonts: await this.fontsOf(work),
            size: work.size,
            look: this.style(work.style, work.patterns),
            markup: work.markup,
            align: work.align,
            lineHeight: work.lineHeight,
            letterSpacing: work.letterSpacing,
            padding: work.padding,
            ...(work.opacity < 1 ? { opacity: work.opacity } : {}),
        };
    }

    /** The chosen font, and those that have what it lacks. */
    private fontIds(work: Work): string[] {
        const more = this.lacking === lackingKey(work) ? fallbackFonts : [];
        return [...new Set([work.font, ...more])];
    }

    private fontsOf(work: Work): Promise<Font[]> {
        return Promise.all(this.fontIds(work).map((name) => this.font(name)));
    }

    private font(name: string): Promise<Font> {
        const known = this.fonts.get(name);
        if (known) return known;
        const font = this.fetched(name);
        this.fonts.set(name, font);
        font.catch(() => this.fonts.delete(name));
        return font;
    }

    private async fetched(name: string): Promise<Font> {
        const shipped = shippedFonts.find((font) => font.id === name);
        if (!shipped)
            throw new Error(`the font '${name}' is not here; choose another or open its file`);
        const response = await fetch(new URL(shipped.file, this.fontsAt));
        if (!response.ok) throw new Error(`the font ${shipped.label} could not be loaded`);
        return this.made(await response.arrayBuffer(), shipped.label);
    }
}

interface Pixels {
    data: Uint8ClampedArray<ArrayBuffer>;
    width: number;
    height: number;
}

function lackingKey(work: Work): string {
    return `${work.font}\n${work.text}`;
}

function plainBox({ left, top, right, bottom }: Box): Box {
    return { left, top, right, bottom };
}

/** Premultiplied pixels with straight alpha, for showing. */
function straight(pixels: Uint8ClampedArray): Uint8ClampedArray<ArrayBuffer> {
    const result = new Uint8ClampedArray(pixels);
    for (let at = 0; at < result.length; at += 4) {
        const alpha = result[at + 3] ?? 0;
        if (alpha === 0 || alpha === 255) continue;
        for (let channel = 0; channel < 3; channel++) {
            result[at + channel] = Math.round(((result[at + channel] ?? 0) * 255) / alpha);
        }
    }
    return result;
}
