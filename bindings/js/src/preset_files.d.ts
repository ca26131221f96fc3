/** The style files of the presets by their names, sorted; building writes them. */
export const PRESETS: Readonly<Record<string, string>>;

/** The pictures of their patterns: straight pixels in base64. */
export const PRESET_PATTERNS: Readonly<
    Record<string, { readonly width: number; readonly height: number; readonly base64: string }>
>;
