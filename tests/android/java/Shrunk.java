import java.nio.ByteBuffer;
import java.security.MessageDigest;
import org.voreleffect.Glyph;
import org.voreleffect.Look;
import org.voreleffect.Painter;
import org.voreleffect.Picture;
import org.voreleffect.PictureView;
import org.voreleffect.Position;
import org.voreleffect.Stops;
import org.voreleffect.VorelEffect;

/** Calls of every class, to be shrunk with them; prints a hash of what was painted. */
public final class Shrunk {
    private Shrunk() {}

    public static void main(String[] arguments) throws Exception {
        MessageDigest hash = MessageDigest.getInstance("SHA-256");
        byte[] coverage = new byte[30 * 20];
        for (int i = 0; i < coverage.length; ++i) coverage[i] = (byte) (i * 3);
        Glyph glyph = new Glyph(5, 5, coverage, 30, 20);
        Look look =
                new Look()
                        .fill(0x3366CC)
                        .linearGradient(30, 1, 1, Stops.of(0xFF0000, 0x0000FF))
                        .stroke(3, 0xFFFFFF, Position.CENTRE);
        Picture picture = look.paint(glyph);
        hash.update(picture.pixels());
        hash.update(look.key().getBytes("ISO-8859-1"));
        int[] page = new int[50 * 40];
        try (Painter painter = new Painter(look, look.noFill())) {
            hash.update((byte) painter.margins().left);
            painter.paint(glyph, PictureView.of(page, 50, 40), 2, 3);
        }
        picture.layOver(PictureView.of(page, 50, 40), 7, 1);
        for (int word : page) hash.update((byte) (word >> 8));
        hash.update(classes(coverage));
        StringBuilder text = new StringBuilder("painted ");
        for (byte b : hash.digest()) text.append(String.format("%02x", b));
        System.out.print(text);
    }

    private static ByteBuffer classes(byte[] coverage) {
        ByteBuffer mask = ByteBuffer.allocateDirect(coverage.length);
        mask.put(coverage);
        mask.position(0);
        ByteBuffer pixels = ByteBuffer.allocateDirect(50 * 40 * 4);
        try (VorelEffect look = new VorelEffect();
                VorelEffect run = look.copy()) {
            run.addStrokeText(3, 0xFFFFFF, 1, 0, VorelEffect.STROKE_OUTSIDE);
            run.getMapKey(0x3366CC);
            run.begin(50, 40, pixels);
            run.glyph(5, 5, mask, 30, 20);
            run.finish();
        }
        return pixels;
    }
}
