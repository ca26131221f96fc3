package org.voreleffect;

import androidx.annotation.NonNull;
import androidx.annotation.Nullable;
import java.nio.ByteBuffer;

/**
 * Memory that a caller hands over: an array, or a buffer as one of our own, whose position and limit
 * nobody moves. It is checked once to be large enough; what is checked cannot shrink.
 */
final class Memory {
    /** How the native side reaches it: the same numbers as there. */
    static final int DIRECT = 0;

    static final int BYTES = 1;
    static final int WORDS = 2;

    /** One of the three. */
    final int kind;

    /** A direct ByteBuffer, a byte[] or an int[]. */
    @NonNull final Object object;

    /** Where the caller's part starts. */
    final int offset;

    private Memory(int kind, @NonNull Object object, int offset) {
        this.kind = kind;
        this.object = object;
        this.offset = offset;
    }

    /** The bytes of an array; {@code count} of them are used. */
    @NonNull
    static Memory of(@NonNull String name, @Nullable byte[] bytes, long count) {
        if (bytes == null) throw new IllegalArgumentException(name + ": null");
        checkLength(name, bytes.length, count);
        return new Memory(BYTES, bytes, 0);
    }

    /** The words of an array; {@code count} of them are used. */
    @NonNull
    static Memory of(@NonNull String name, @Nullable int[] words, long count) {
        if (words == null) throw new IllegalArgumentException(name + ": null");
        checkLength(name, words.length, count);
        return new Memory(WORDS, words, 0);
    }

    /** The bytes of a buffer from its position on, whose position and limit are read once. */
    @NonNull
    static Memory of(@NonNull String name, @Nullable ByteBuffer buffer, long count) {
        if (buffer == null) throw new IllegalArgumentException(name + ": null");
        int start = buffer.position();
        checkLength(name, buffer.limit() - start, count);
        if (buffer.isDirect()) return new Memory(DIRECT, whole(buffer), start);
        if (!buffer.hasArray()) {
            throw new IllegalArgumentException(name + ": neither direct nor with an array to write to");
        }
        return new Memory(BYTES, buffer.array(), start + buffer.arrayOffset());
    }

    /** Reads the first byte: where the memory was closed that fails here, and not on the native side. */
    void touch() {
        if (kind == DIRECT && ((ByteBuffer) object).capacity() > offset) ((ByteBuffer) object).get(offset);
    }

    private static ByteBuffer whole(ByteBuffer buffer) {
        ByteBuffer ours = buffer.duplicate();
        ours.clear();
        return ours;
    }

    private static void checkLength(String name, int length, long count) {
        if (length < count) {
            throw new IllegalArgumentException(
                    name + ": " + length + ", fewer than the " + count + " used");
        }
    }
}
