import type { Glyph } from './glyphs.js';
import { explanationOf, type Explanation, type Plan, type StyleClass } from './style.js';
import { requestIn, sidesOf, type Sides, type TextEngine } from './text_engine.js';
import { TextPicture, type ToldPicture, type ToldText } from './text_picture.js';
import { requestOf, styleIn, type TextOptions } from './text_request.js';
import type { Box } from './values.js';

/** A glyph of a text that is set, with its coverage. */
export interface TextGlyph extends Glyph {
    readonly x: number;
    readonly y: number;
    /** The position of its line. */
    readonly line: number;
    /** Which of the text's words, from 0. */
    readonly word: number;
    /** The position in the text, in code points, of the first character that it stands for. */
    readonly cluster: number;
}

/** A text that is set, in pixels from its origin, where its first baseline begins. */
export interface TextLayout {
    /** Those with ink, line by line, each from left to right. */
    readonly glyphs: readonly TextGlyph[];
    /** From the top to the bottom. */
    readonly lines: readonly { readonly baseline: number; readonly box: Box }[];
    readonly ink: Box;
    readonly box: Box;
    readonly size: number;
    readonly fonts: readonly string[];
    readonly missing: readonly string[];
    readonly notes: readonly string[];
}

/** One step of painting alone. */
export interface LayerPicture {
    /** Of the look in its stack, 0 the lowest. */
    readonly look: number;
    /** The name of the effect in a style file. */
    readonly effect: string;
    /** Where it lies relative to the glyphs: "outside the text". */
    readonly place: string;
    readonly milliseconds: number;
    readonly width: number;
    readonly height: number;
    /** Premultiplied R, G, B, A, of the size of the picture. */
    readonly data: Uint8ClampedArray<ArrayBuffer>;
}

/**
 * Texts in fonts and looks. All throw TextError for a text that no character is seen of or that does not fit,
 * FontError, StyleError, VorelMemoryError, and TypeError and RangeError for options.
 */
export interface Text {
    /**
     * Paints a text: the pixels that vorelpaint of this version paints with the same fonts. Pictures of colour fonts
     * that are PNG within the font leave no mark; those of outlines are painted.
     */
    picture(text: string, options: TextOptions): TextPicture;
    /** Sets a text without painting it. */
    layout(text: string, options: TextOptions): TextLayout;
    /** How the looks of a text are painted, with the time of each effect: medians of some rounds. */
    explain(text: string, options: TextOptions): Explanation;
    /** Each effect alone, cut as it is in the picture, the lowest first. */
    layers(text: string, options: TextOptions): LayerPicture[];
}

interface ToldGlyph extends Omit<TextGlyph, 'mask'> {
    readonly width: number;
    readonly height: number;
    readonly at: number;
}

interface ToldLayout extends ToldText {
    readonly glyphs: readonly ToldGlyph[];
    readonly lines: readonly { readonly baseline: number; readonly box: Sides }[];
}

const Kind = { glyphs: 0, effect: 1 } as const;
const ROUNDS = 5;

/** Milliseconds of each effect of each look, in the order of the plan. */
type Times = number[][];

/** The texts of an instance. */
export function textsOf(engine: TextEngine, styles: StyleClass): Text {
    const picture = (text: string, options: TextOptions): TextPicture =>
        engine.scoped((scope) => {
            const request = requestIn(scope, requestOf(engine, text, options));
            const style = styleIn(engine, scope, options.look, styles);
            const given = [engine.fonts, ...request, style];
            const { told, bytes } = engine.answer<ToldPicture>('vorel_text_picture', ...given);
            return new TextPicture(told, bytes);
        });

    const layout = (text: string, options: TextOptions): TextLayout =>
        engine.scoped((scope) => {
            const request = requestIn(scope, requestOf(engine, text, options));
            styleIn(engine, scope, options.look, styles); // no layout follows a look, but a wrong one is told
            const given = [engine.fonts, ...request];
            const { told, bytes } = engine.answer<ToldLayout>('vorel_text_layout', ...given);
            return {
                ...told,
                glyphs: told.glyphs.map((glyph) => glyphOf(glyph, bytes)),
                lines: told.lines.map(({ baseline, box }) => ({ baseline, box: sidesOf(box) })),
                ink: sidesOf(told.ink),
                box: sidesOf(told.box),
            };
        });

    /** The plan of a text and `use` of the address of its steps, which are freed then. */
    const stepped = <Result>(
        text: string,
        options: TextOptions,
        use: (steps: number, plan: Plan) => Result,
    ): Result =>
        engine.scoped((scope) => {
            const request = requestIn(scope, requestOf(engine, text, options));
            const style = styleIn(engine, scope, options.look, styles);
            const steps = scope.takes(
                scope.made('vorel_steps_new', engine.fonts, ...request, style),
                'vorel_steps_free',
            );
            return use(steps, engine.answer<Plan>('vorel_steps_plan', steps).told);
        });

    const explain = (text: string, options: TextOptions): Explanation => {
        const rounds = Array.from({ length: ROUNDS }, () =>
            stepped(text, options, (steps, plan) => ({
                plan,
                times: timesOf(engine, steps, plan),
            })),
        );
        const times = rounds.map((round) => round.times);
        return explanationOf(withTimes(rounds[0]!.plan, times));
    };

    const layers = (text: string, options: TextOptions): LayerPicture[] =>
        stepped(text, options, (steps, plan) => {
            const times = timesOf(engine, steps, plan);
            return plan.looks.flatMap(({ order }, look) =>
                order
                    .map(({ effect, place }, i) => ({
                        look,
                        effect,
                        place,
                        milliseconds: times[look]![i]!,
                        ...stepPicture(engine, steps, look, i),
                    }))
                    .reverse(),
            );
        });

    return Object.freeze({ picture, layout, explain, layers });
}

function glyphOf(told: ToldGlyph, bytes: Uint8Array<ArrayBuffer>): TextGlyph {
    const { width, height, at, ...glyph } = told;
    return { ...glyph, mask: { width, height, data: bytes.slice(at, at + width * height) } };
}

function stepPicture(
    engine: TextEngine,
    steps: number,
    look: number,
    effect: number,
): Pick<LayerPicture, 'width' | 'height' | 'data'> {
    const given = [steps, Kind.effect, look, effect];
    const { told, bytes } = engine.answer<{ width: number; height: number }>(
        'vorel_steps_picture',
        ...given,
    );
    return { ...told, data: new Uint8ClampedArray(bytes.buffer) };
}

/** Paints all steps, and sums up what each effect takes in its spans. */
function timesOf(engine: TextEngine, steps: number, plan: Plan): Times {
    const times = plan.looks.map(({ order }) => order.map(() => 0));
    return engine.scoped((scope) => {
        const at = scope.words(0, 0, 0, 0);
        for (;;) {
            engine.check('vorel_steps_prepare', steps, at);
            const view = engine.view();
            const [look, , kind, effect] = [0, 4, 8, 12].map((i) => view.getInt32(at + i, true));
            if (look! < 0) return times;
            const start = performance.now();
            engine.check('vorel_steps_paint', steps);
            if (kind === Kind.effect) times[look!]![effect!]! += performance.now() - start;
        }
    });
}

function withTimes(plan: Plan, rounds: readonly Times[]): Plan {
    const looks = plan.looks.map((look, i) => ({
        ...look,
        order: look.order.map((effect, j) => ({
            ...effect,
            milliseconds: median(rounds.map((times) => times[i]![j]!)),
        })),
    }));
    return { ...plan, looks };
}

function median(numbers: readonly number[]): number {
    return [...numbers].sort((a, b) => a - b)[Math.floor(numbers.length / 2)]!;
}
