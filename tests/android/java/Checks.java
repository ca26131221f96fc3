import java.lang.ref.PhantomReference;
import java.lang.ref.ReferenceQueue;
import java.lang.reflect.InvocationTargetException;
import java.lang.reflect.Method;
import java.nio.file.Files;
import java.nio.file.Paths;
import java.io.IOException;
import java.util.AbstractList;
import java.util.List;
import org.voreleffect.Glyph;
import org.voreleffect.Painter;

/** What the tests of the Java side share. Each method whose name starts with "test" is a test. */
abstract class Checks {
    /** Runs the tests and ends the program, with 1 when one of them failed. */
    final void run() throws IllegalAccessException {
        int run = 0;
        int failed = 0;
        for (Method method : getClass().getDeclaredMethods()) {
            if (!method.getName().startsWith("test")) continue;
            ++run;
            try {
                method.invoke(this);
            } catch (InvocationTargetException e) {
                ++failed;
                System.err.println("FAILED " + method.getName());
                e.getCause().printStackTrace();
            }
        }
        System.out.println(run + " tests, " + failed + " failed");
        System.exit(run > 0 && failed == 0 ? 0 : 1);
    }

    static void refused(Runnable call) {
        expect(IllegalArgumentException.class, call);
    }

    static void misplaced(Runnable call) {
        expect(IllegalStateException.class, call);
    }

    static void expect(Class<? extends Throwable> kind, Runnable call) {
        try {
            call.run();
        } catch (RuntimeException | OutOfMemoryError e) {
            check(e.getClass() == kind, kind.getSimpleName() + " expected, not " + e);
            return;
        }
        throw new AssertionError(kind.getSimpleName() + " expected");
    }

    static void check(boolean holds, String what) {
        if (!holds) throw new AssertionError(what);
    }

    /** One glyph in a list that closes the painter when it is asked for it. */
    static List<Glyph> closing(Painter painter, Glyph glyph) {
        return new AbstractList<Glyph>() {
            @Override
            public Glyph get(int index) {
                painter.close();
                return glyph;
            }

            @Override
            public int size() {
                return 1;
            }
        };
    }

    /** Collects, and waits for the thread that queues what was found: under load it runs late. */
    static void collect() throws InterruptedException {
        ReferenceQueue<Object> found = new ReferenceQueue<>();
        PhantomReference<Object> gone = new PhantomReference<>(new Object(), found);
        System.gc();
        for (int seconds = 0; seconds < 10 && found.remove(1000) != gone; ++seconds) {}
    }

    static long residentKb() throws IOException {
        for (String line : Files.readAllLines(Paths.get("/proc/self/status"))) {
            if (line.startsWith("VmRSS:")) return Long.parseLong(line.replaceAll("[^0-9]", ""));
        }
        throw new AssertionError("no VmRSS");
    }
}
