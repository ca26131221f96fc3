// A double outline. A look has one effect of a kind: a second stroke would take the place of the first.
// So there are two looks, painted one over the other in one call.
//
//     stacked_looks [TEXT [FONT_FILE [PICTURE.png]]]
#include <voreleffect/look.h>

#include <cstdio>
#include <vector>

#include "../shared/page.h"
#include "../shared/shaped_text.h"

using namespace VFontEffect;

namespace {

constexpr int kTextPixels = 120;
constexpr int kLetterSpacing = 8;

/// The last one on top.
std::vector<Look> twoRims() {
    const Look outer =
        Look().fill(rgb(0x1D2A44)).add(Stroke(14, rgb(0x1D2A44)));  // seen around the inner
    const Look inner =
        Look()
            .add(Stroke(6, rgb(0xFFFFFF)))
            .add(LinearGradient({{rgb(0xFFE27A), 1, 0}, {rgb(0xFF7E5F), 1, 1}}).angle(270));
    return {outer, inner};
}

}  // namespace

int main(int argc, char** argv) {
    const char* text = argc > 1 ? argv[1] : "Two rims";
    const char* file = argc > 2 ? argv[2] : "/usr/share/fonts/truetype/dejavu/DejaVuSans-Bold.ttf";
    const char* path = argc > 3 ? argv[3] : "stacked_looks.png";

    const Font font(file, kTextPixels);
    if (!font.isReady()) {
        std::fprintf(stderr, "cannot read the font %s\n", file);
        return 1;
    }
    const Line line = font.line(text, kLetterSpacing);
    Painter painter(twoRims());
    const Margins margins = painter.margins();
    Page page(margins.left + line.width + margins.right,
              margins.top + font.lineHeight() + margins.bottom, 0x2F9E8F);
    if (!painter.paint(line.glyphs, page.view(), margins.left, margins.top + font.ascent())) {
        std::fprintf(stderr, "the text is too large\n");
        return 1;
    }
    if (!page.writePng(path)) {
        std::fprintf(stderr, "cannot write %s\n", path);
        return 1;
    }
    return 0;
}
