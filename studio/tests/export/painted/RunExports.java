import java.io.ByteArrayInputStream;
import java.io.DataInputStream;
import java.io.IOException;
import java.nio.file.Files;
import java.nio.file.Path;
import java.nio.file.Paths;
import java.util.ArrayList;
import java.util.List;
import java.util.Map;
import java.util.TreeMap;
import org.voreleffect.Glyph;
import org.voreleffect.PictureView;

/** Paints every case by its export for Java: RunExports FOLDER; what is in it tells run_exports.cpp. */
final class RunExports {
    /** An exported class with a text and a page. */
    interface Case {
        void paint(Text text, PictureView page, int x, int y);
    }

    /** A text in its spans, and the pixels of patterns. */
    static final class Text {
        final List<Glyph> glyphs = new ArrayList<>();
        final Map<Long, List<Glyph>> byLine = new TreeMap<>();
        final Map<Long, List<Glyph>> byWord = new TreeMap<>();
        final Map<Long, List<Glyph>> byCluster = new TreeMap<>();
        final List<int[]> patterns = new ArrayList<>();
        final List<Integer> widths = new ArrayList<>();
        final List<Integer> heights = new ArrayList<>();

        List<List<Glyph>> lines() {
            return new ArrayList<>(byLine.values());
        }

        List<List<Glyph>> words() {
            return new ArrayList<>(byWord.values());
        }

        List<List<Glyph>> letters() {
            return new ArrayList<>(byCluster.values());
        }

        private static void add(Map<Long, List<Glyph>> parts, long line, long place, Glyph glyph) {
            parts.computeIfAbsent(line << 32 | place, key -> new ArrayList<>()).add(glyph);
        }

        void readMasks(DataInputStream in) throws IOException {
            for (int count = in.readInt(); count > 0; --count) {
                int x = in.readInt();
                int y = in.readInt();
                int width = in.readInt();
                int height = in.readInt();
                int line = in.readInt();
                int word = in.readInt();
                int cluster = in.readInt();
                byte[] coverage = new byte[width * height];
                in.readFully(coverage);
                Glyph glyph = new Glyph(x, y, coverage, width, height);
                glyphs.add(glyph);
                add(byLine, line, 0, glyph);
                add(byWord, line, word, glyph);
                add(byCluster, line, cluster, glyph);
            }
        }

        /** Words of 0xAARRGGBB of bytes R, G, B, A. */
        void readPatterns(DataInputStream in) throws IOException {
            for (int count = in.readInt(); count > 0; --count) {
                widths.add(in.readInt());
                heights.add(in.readInt());
                int[] pixels = new int[widths.get(widths.size() - 1) * heights.get(heights.size() - 1)];
                for (int i = 0; i < pixels.length; ++i) pixels[i] = Integer.rotateRight(in.readInt(), 8);
                patterns.add(pixels);
            }
        }
    }

    private RunExports() {}

    private static DataInputStream open(Path file) throws IOException {
        return new DataInputStream(new ByteArrayInputStream(Files.readAllBytes(file)));
    }

    public static void main(String[] arguments) throws IOException {
        Path folder = Paths.get(arguments[0]);
        for (String line : Files.readAllLines(folder.resolve("pages.txt"))) {
            String[] words = line.split(" ");
            int width = Integer.parseInt(words[1]);
            int height = Integer.parseInt(words[2]);
            Text text = new Text();
            text.readMasks(open(folder.resolve(words[0] + ".masks")));
            text.readPatterns(open(folder.resolve(words[0] + ".patterns")));
            byte[] page = new byte[4 * width * height];
            PictureView view = PictureView.of(page, width, height);
            Cases.named(words[0]).paint(text, view, Integer.parseInt(words[3]), Integer.parseInt(words[4]));
            Files.write(folder.resolve(words[0] + ".java.rgba"), page);
        }
    }
}
