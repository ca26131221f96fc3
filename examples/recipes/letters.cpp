// Each letter in a colour of its own, all of them with one outline and one shadow.
#include <algorithm>
#include <iterator>
#include <optional>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

constexpr unsigned int kColors[] = {0xE8412C, 0xF59E22, 0x3FAE5A, 0x2F7FD6, 0x7A4BC2};

Look letterLook(std::size_t letter) {
    const Color color = rgb(kColors[letter % std::size(kColors)]);
    const InnerShadow light(rgb(0xFFFFFF));  // along the lower edges
    return Look().fill(color).add(light.angle(270).distance(3).size(2).opacity(0.6F));
}

/// The outline goes beneath all letters at once: painted with each of them, it would lie over the letter
/// before. It is filled, so that no page is seen between a letter's soft edge and the outline.
void paintLetters(const Line& line, const PictureView& view, int x, int y) {
    Look outline;
    outline.fill(rgb(0xFFFFFF))
        .add(OuterShadow(rgb(0x1B2A41)).angle(125).distance(7).size(6).opacity(0.7F))
        .add(Stroke(11, rgb(0xFFFFFF)));
    paint(outline, line.glyphs, view, x, y);
    for (std::size_t i = 0; i < line.glyphs.size(); ++i)
        paint(letterLook(i), line.glyphs[i], view, x, y);
}

/// Where a letter is opaque, nothing of the outline or of another letter is seen. The origin of the text
/// is the page's (x, y).
void checkLetter(const PictureView& page, const Picture& letter, int x, int y) {
    for (int row = 0; row < letter.height(); ++row)
        for (int column = 0; column < letter.width(); ++column) {
            const unsigned char* painted = letter.data() + row * letter.stride() + 4 * column;
            const int at = (y + letter.top() + row) * page.width + x + letter.left() + column;
            const bool isSame = std::equal(painted, painted + 4, page.data + 4 * at);
            if (painted[3] == 255) check(isSame, "nothing over a letter");
        }
}

}  // namespace

int main() {
    const Line line = Font(kFont, 80).line("Rainbow");
    Page page(430, 130, 0x9FD8E8);
    paintLetters(line, page.view(), 28, 90);
    check(page.writePng("letters.png"), "a PNG");
    for (std::size_t i = 0; i < line.glyphs.size(); ++i) {
        const std::optional<Picture> letter = paint(letterLook(i), line.glyphs[i]);
        check(letter.has_value(), "a letter");
        checkLetter(page.view(), *letter, 28, 90);
    }
    return 0;
}
