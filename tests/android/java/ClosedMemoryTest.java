import java.nio.ByteBuffer;
import java.util.Arrays;
import jdk.incubator.foreign.MemorySegment;
import jdk.incubator.foreign.ResourceScope;
import org.voreleffect.Glyph;
import org.voreleffect.Look;
import org.voreleffect.Painter;
import org.voreleffect.Picture;
import org.voreleffect.PictureView;
import org.voreleffect.VorelEffect;

/**
 * Buffers whose memory is closed by its owner: what the virtual machine knows to be gone is refused, and
 * the object goes on painting.
 */
public final class ClosedMemoryTest {
    // So large that the C library gives them back to the system: to touch one that is closed is a crash.
    private static final int WIDTH = 1024;
    private static final int HEIGHT = 512;

    private ClosedMemoryTest() {}

    public static void main(String[] arguments) {
        destinationClosedBeforeTheRun();
        destinationClosedWithinTheRun();
        coverageClosedWithinTheRun();
        coverageOfAGlyphThatIsClosed();
        memoryOfAViewThatIsClosed();
        System.out.println("what is closed is refused");
    }

    private static void destinationClosedBeforeTheRun() {
        try (VorelEffect look = look()) {
            refused(() -> look.begin(WIDTH, HEIGHT, closed(WIDTH * HEIGHT * 4)));
            paintsAsEver(look);
        }
    }

    private static void destinationClosedWithinTheRun() {
        try (VorelEffect look = look()) {
            try (ResourceScope scope = ResourceScope.newConfinedScope()) {
                look.begin(WIDTH, HEIGHT, buffer(WIDTH * HEIGHT * 4, scope));
                look.glyph(0, 0, coverage(), WIDTH, HEIGHT);
            }
            refused(look::finish);
            refused(look::finish); // the run is still open: nothing has changed
            paintsAsEver(look);
        }
    }

    private static void coverageClosedWithinTheRun() {
        ByteBuffer picture = ByteBuffer.allocateDirect(WIDTH * HEIGHT * 4);
        try (VorelEffect look = look()) {
            look.begin(WIDTH, HEIGHT, picture);
            refused(() -> look.glyph(0, 0, closed(WIDTH * HEIGHT), WIDTH, HEIGHT));
            look.glyph(0, 0, coverage(), WIDTH, HEIGHT);
            look.finish();
        }
        check(picture.equals(painted()), "the run goes on");
    }

    private static void coverageOfAGlyphThatIsClosed() {
        try (Painter painter = new Painter(new Look())) {
            Glyph glyph;
            try (ResourceScope scope = ResourceScope.newConfinedScope()) {
                glyph = new Glyph(0, 0, buffer(WIDTH * HEIGHT, scope), WIDTH, HEIGHT);
            }
            refused(() -> painter.paint(glyph));
            refused(() -> painter.paint(glyph, PictureView.of(new int[1], 1, 1), 0, 0));
            Glyph open = new Glyph(0, 0, coverage(), WIDTH, HEIGHT);
            check(painter.paint(open).width() == WIDTH, "the next picture");
        }
    }

    private static void memoryOfAViewThatIsClosed() {
        Picture picture = new Look().paint(new Glyph(0, 0, coverage(), WIDTH, HEIGHT));
        PictureView view;
        try (ResourceScope scope = ResourceScope.newConfinedScope()) {
            view = PictureView.of(buffer(WIDTH * HEIGHT * 4, scope), WIDTH, HEIGHT);
        }
        refused(() -> picture.layOver(view, 0, 0));
        refused(() -> new Look().paint(new Glyph(0, 0, coverage(), WIDTH, HEIGHT), view, 0, 0));
    }

    private static VorelEffect look() {
        VorelEffect look = new VorelEffect();
        look.addText(0x3366CC, 1);
        return look;
    }

    private static ByteBuffer coverage() {
        byte[] inside = new byte[WIDTH * HEIGHT];
        Arrays.fill(inside, (byte) 255);
        return ByteBuffer.allocateDirect(inside.length).put(inside).rewind();
    }

    private static ByteBuffer painted() {
        ByteBuffer picture = ByteBuffer.allocateDirect(WIDTH * HEIGHT * 4);
        for (int i = 0; i < WIDTH * HEIGHT; ++i) picture.putInt(0x3366CCFF);
        return picture.rewind();
    }

    private static void paintsAsEver(VorelEffect look) {
        ByteBuffer picture = ByteBuffer.allocateDirect(WIDTH * HEIGHT * 4);
        look.begin(WIDTH, HEIGHT, picture);
        look.glyph(0, 0, coverage(), WIDTH, HEIGHT);
        look.finish();
        check(picture.equals(painted()), "the next run");
    }

    private static ByteBuffer buffer(int bytes, ResourceScope scope) {
        return MemorySegment.allocateNative(bytes, scope).asByteBuffer();
    }

    private static ByteBuffer closed(int bytes) {
        try (ResourceScope scope = ResourceScope.newConfinedScope()) {
            return buffer(bytes, scope);
        }
    }

    private static void refused(Runnable call) {
        try {
            call.run();
        } catch (IllegalStateException e) {
            return;
        }
        throw new AssertionError("closed memory was taken");
    }

    private static void check(boolean holds, String what) {
        if (!holds) throw new AssertionError(what);
    }
}
