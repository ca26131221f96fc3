package org.voreleffect;

import androidx.annotation.NonNull;
import java.lang.ref.PhantomReference;
import java.lang.ref.ReferenceQueue;
import java.util.Collections;
import java.util.Set;
import java.util.concurrent.ConcurrentHashMap;

/**
 * The native side of an object, which is freed with it: by close, or, where that was never called, once
 * the collector has found the object unreachable. There is neither a finaliser, which would let an
 * object be used after its end, nor a thread: objects that are made free those that were forgotten, so
 * that their number stays bounded wherever it could grow.
 */
abstract class NativeSide extends PhantomReference<Object> {
    /** Native sides of unreachable objects. */
    private static final ReferenceQueue<Object> FORGOTTEN = new ReferenceQueue<>();

    /** Every one that is not free: a reference is queued only while it is reachable itself. */
    private static final Set<NativeSide> HELD =
            Collections.newSetFromMap(new ConcurrentHashMap<NativeSide, Boolean>());

    /** 0 before it is made and after it was freed. */
    private long address;

    /** Frees those that were forgotten; {@link #hold} follows. */
    NativeSide(@NonNull Object owner) {
        super(owner, FORGOTTEN);
        freeForgotten();
        HELD.add(this);
    }

    /** Takes what was made for the owner. */
    final synchronized void hold(long made) {
        address = made;
    }

    /** The address; where it was freed an {@link IllegalStateException}. */
    final long address() {
        long open = address;
        if (open == 0) throw new IllegalStateException("closed");
        return open;
    }

    /** Frees it; the second time that does nothing. */
    final synchronized void free() {
        if (address != 0) destroy(address);
        address = 0;
        clear();
        HELD.remove(this);
    }

    abstract void destroy(long made);

    private static void freeForgotten() {
        for (Object gone = FORGOTTEN.poll(); gone != null; gone = FORGOTTEN.poll()) {
            ((NativeSide) gone).free();
        }
    }
}
