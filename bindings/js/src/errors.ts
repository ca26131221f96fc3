/** What the library reports; arguments of the wrong kind are a TypeError or a RangeError instead. */
export class VorelError extends Error {
    static {
        this.prototype.name = 'VorelError';
    }
}

/** Memory has run out: nothing was painted, and the instance can be used on. */
export class VorelMemoryError extends VorelError {
    static {
        this.prototype.name = 'VorelMemoryError';
    }
}

/** A layer or a pattern of 2^31 bytes and more, or a picture whose left or top is below -2^31. */
export class VorelSizeError extends VorelError {
    static {
        this.prototype.name = 'VorelSizeError';
    }
}

/** Something is wrong with a style, or with the markup of a text; the message tells the path of the key. */
export class StyleError extends VorelError {
    static {
        this.prototype.name = 'StyleError';
    }
}

/** A text cannot be painted as it is asked for. */
export class TextError extends VorelError {
    static {
        this.prototype.name = 'TextError';
    }
}

/** A font cannot be read, or has not what is asked of it. */
export class FontError extends TextError {
    static {
        this.prototype.name = 'FontError';
    }
}
