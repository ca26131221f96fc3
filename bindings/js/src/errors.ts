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
