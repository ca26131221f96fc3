// A line of text: HarfBuzz places the glyphs, FreeType draws their coverage, the library paints them in
// one go, so that a shadow never falls on the next letter and the gradient runs through the line.
//
//     freetype_text [TEXT [FONT_FILE [PICTURE.png]]]
#include <voreleffect/look.h>

#include <cstdio>
#include <optional>

#include "../shared/page.h"
#include "../shared/shaped_text.h"

using namespace VFontEffect;

namespace {

constexpr int kTextPixels = 96;
constexpr int kPadding = 16;

/// Beneath the text the outline lies over the shadow; inside, the light lies over the gradient.
Look metalLook() {
    const LinearGradient metal({{rgb(0x7FB4E6), 1, 0}, {rgb(0x2D6BB5), 1, 0.5F}, {rgb(0x173B73), 1, 1}});
    return Look()
        .add(OuterShadow(rgb(0x1B2A41)).angle(125).distance(8).size(12).opacity(0.65F))
        .add(Stroke(4, rgb(0xFFFFFF)))
        .add(metal.angle(270))                                                           // downwards
        .add(InnerShadow(rgb(0xFFFFFF)).angle(270).distance(2).size(2).opacity(0.55F));  // from below
}

}  // namespace

int main(int argc, char** argv) {
    const char* text = argc > 1 ? argv[1] : "Affinity, Ávila, Straße";
    const char* file = argc > 2 ? argv[2] : "/usr/share/fonts/truetype/dejavu/DejaVuSerif-Bold.ttf";
    const char* path = argc > 3 ? argv[3] : "freetype_text.png";

    const Font font(file, kTextPixels);
    if (!font.isReady()) {
        std::fprintf(stderr, "cannot read the font %s\n", file);
        return 1;
    }
    const Line line = font.line(text);
    const std::optional<Picture> picture = paint(metalLook(), line.glyphs);
    if (!picture || picture->isEmpty()) {
        std::fprintf(stderr, "the text has no pixels\n");
        return 1;
    }
    // The picture has the margins of the look; the padding is for the eye.
    Page page(picture->width() + 2 * kPadding, picture->height() + 2 * kPadding, 0xF4F1EA);
    picture->layOver(page.view(), kPadding - picture->left(), kPadding - picture->top());
    if (!page.writePng(path)) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
