/** The module voreleffect-text.wasm in base64; building writes it. */
export const base64: string;
