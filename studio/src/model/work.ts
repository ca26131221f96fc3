import type { StyleFile } from './style_file';

/** Pixels of a pattern: base64 of width * height * 4 bytes, red, green, blue and straight alpha. */
export interface PatternPixels {
    width: number;
    height: number;
    data: string;
}

export type Align = 'left' | 'center' | 'right' | 'start' | 'end';

/** All that a person makes in the studio. A value: what changes it makes another one. */
export interface Work {
    text: string;
    /** Whether `<c #RRGGBB>word</c>` in the text colours words. */
    markup: boolean;
    /** Id of a shipped font, or the file's name of the person's own. */
    font: string;
    /** Whole pixels, 1 to 1000. */
    size: number;
    align: Align;
    /** In line heights of the font, 0.5 to 10: 1 is the font's own. */
    lineHeight: number;
    /** Pixels, or percent of the size: '0', '2', '5%'; 200 at most to either side. */
    letterSpacing: string;
    /** Version 2, always with `looks`. */
    style: StyleFile;
    /** By the names under which the patterns of the style ask for them. */
    patterns: Record<string, PatternPixels>;
    /** Of the text: 1 leaves each look its own. */
    opacity: number;
    /** Pixels around the ink and its effects, 0 to 1000. */
    padding: number;
    /** 'transparent', 'checkerboard', 'picture' or '#rrggbb'. */
    background: string;
}

/** What a first visit shows. */
export const firstWork: Work = {
    text: 'Voreleffect',
    markup: false,
    font: 'dejavu-sans-bold',
    size: 96,
    align: 'center',
    lineHeight: 1,
    letterSpacing: '0',
    style: {
        version: 2,
        looks: [
            {
                description: 'Edge and shadow',
                color: '#1B2A6B',
                outerShadow: {
                    angle: 120,
                    distance: '8%',
                    size: '9%',
                    color: '#0A1033',
                    opacity: 0.55,
                },
                stroke: { size: '6%', color: '#1B2A6B', position: 'outside' },
            },
            {
                description: 'Sunset',
                span: 'line',
                linearGradient: {
                    angle: 90,
                    gradient: [
                        { location: 0, color: '#FF4E50' },
                        { location: 0.5, color: '#FC913A' },
                        { location: 1, color: '#F9E26B' },
                    ],
                },
                innerShadow: {
                    angle: 270,
                    distance: '2%',
                    size: '3%',
                    color: '#FFFFFF',
                    opacity: 0.7,
                },
            },
        ],
    },
    patterns: {},
    opacity: 1,
    padding: 8,
    background: 'checkerboard',
};
