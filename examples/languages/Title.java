import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Paths;
import org.voreleffect.Glyph;
import org.voreleffect.Look;
import org.voreleffect.PictureView;
import org.voreleffect.Stops;

/** A letter in a look, painted on a grey page: Title FILE writes the page's pixels, R, G, B, A. */
final class Title {
    private Title() {}

    public static void main(String[] arguments) throws IOException {
        byte[] letter = new byte[60 * 72]; // an H
        for (int y = 0; y < 72; ++y) {
            for (int x = 0; x < 60; ++x) {
                letter[y * 60 + x] = (byte) (x < 18 || x >= 42 || (y >= 27 && y < 45) ? 255 : 0);
            }
        }

        Look look = new Look()
                .fill(0xE8412C)
                .outerShadow(135, 6, 8, 0x1B2A41, 0.6f)
                .stroke(4, 0xFFFFFF)
                .linearGradient(270, 1, 1, Stops.builder().add(0xFFD75E, 0).add(0xFFD75E, 0, 1).build());

        byte[] page = new byte[4 * 100 * 110];
        for (int i = 0; i < page.length; ++i) page[i] = (byte) (i % 4 == 3 ? 255 : 200);
        look.paint(new Glyph(0, 0, letter, 60, 72), PictureView.of(page, 100, 110), 20, 18);
        Files.write(Paths.get(arguments[0]), page);
    }
}
