package org.voreleffect;

/** The native libraries, loaded by the first class that needs them. */
final class Library {
    static {
        System.loadLibrary("voreleffect");
        System.loadLibrary("voreleffect_jni");
    }

    private Library() {}

    /** Loads them; an {@link UnsatisfiedLinkError} where they are not found. */
    static void load() {
        // The static block has done it.
    }
}
