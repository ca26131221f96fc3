/**
 * The shortest spelling of a number that is read as the same float of 32 bits: '0.6', '100'.
 */
export function spelled(value: number): string {
    const float = Math.fround(value);
    for (let digits = 1; digits < 9; ++digits) {
        const short = Number(float.toPrecision(digits));
        if (Math.fround(short) === float) return String(short);
    }
    return String(Number(float.toPrecision(9)));
}

/** The same as a literal of C++, C or Java: whole numbers as they are, others with the suffix of a float. */
export function floatLiteral(value: number, suffix: 'F' | 'f'): string {
    const digits = spelled(value);
    return /[.e]/.test(digits) ? digits + suffix : digits;
}

/** 'RRGGBB' of '#RGB' or '#RRGGBB', in capitals. */
export function sixDigits(colour: string): string {
    const digits = colour.slice(1).toUpperCase();
    return digits.length === 3 ? digits.replace(/./g, '$&$&') : digits;
}
