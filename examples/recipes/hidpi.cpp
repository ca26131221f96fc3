// The same look on screens of other densities, and a stroke that is wider than 100 pixels.
#include <algorithm>
#include <cmath>
#include <optional>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

/// The library cuts sizes and distances to whole pixels, 4.5 to 4: rounded before, they are as near as
/// can be, and what is there at a scale of 1 does not go at 0.75.
float scaled(float size, float scale) {
    return size <= 0 ? 0 : std::max(1.0F, std::round(size * scale));
}

/// The look for a screen of so many pixels to a point. Angles, opacities and the lengths of gradients
/// are no pixels: they stay.
Look lookAt(float scale) {
    return Look()
        .add(LinearGradient({{rgb(0xFFE27A), 1, 0}, {rgb(0xFF5E7E), 1, 1}}).angle(270))
        .add(OuterShadow(rgb(0x20123A))
                 .angle(120)
                 .distance(scaled(6, scale))
                 .size(scaled(5, scale))
                 .opacity(0.7F))
        .add(Stroke(scaled(3, scale), rgb(0x3A1C6E)));
}

/// One stroke is 100 pixels wide at most. A wider one is made of several: what one has painted is the
/// coverage of the next. Nothing where there is no memory.
std::optional<Picture> wideStroke(Glyphs glyphs, int size, Color color) {
    const auto widened = [color](Glyphs by, int pixels) {
        return paint(Look().fill(color).add(Stroke(static_cast<float>(pixels), color)), by);
    };
    std::optional<Picture> wide = widened(glyphs, std::min(size, 100));
    for (int left = size - 100; wide && left > 0; left -= 100) {
        std::vector<unsigned char> coverage;  // the alpha of the pixels
        for (int i = 3; i < wide->stride() * wide->height(); i += 4)
            coverage.push_back(wide->data()[i]);
        wide = widened(Glyph{wide->left(), wide->top(), coverage.data(), wide->width(), wide->height()},
                       std::min(left, 100));
    }
    return wide;
}

/// The same words at three densities. Letters are rasterised at the scale: coverage that is enlarged
/// would have soft edges.
void paintAtScales() {
    Page page(610, 120, 0xEFE9F7);
    int x = 15;
    for (const float scale : {1.0F, 1.5F, 2.0F}) {
        const Line line = Font(kFont, static_cast<int>(std::lround(40 * scale))).line("HiDPI");
        check(paint(lookAt(scale), line.glyphs, page.view(), x, 90).has_value(), "painted");
        x += static_cast<int>(132 * scale);
    }
    check(page.writePng("hidpi.png"), "a PNG");
}

/// Around a square the stroke is all that lies within 240 pixels of it, round corners included.
void checkWideStroke() {
    const std::vector<unsigned char> full(20 * 20, 255);
    const std::optional<Picture> wide = wideStroke(Glyph{0, 0, full.data(), 20, 20}, 240, rgb(0x3A1C6E));
    check(wide.has_value(), "a wide stroke");
    for (int y = 0; y < wide->height(); ++y)
        for (int x = 0; x < wide->width(); ++x) {
            const int alpha = wide->data()[y * wide->stride() + x * 4 + 3];
            const int column = wide->left() + x;
            const int row = wide->top() + y;
            const double distance =
                std::hypot(std::max({0, -column, column - 19}), std::max({0, -row, row - 19}));
            if (distance < 238) check(alpha == 255, "covered");
            if (distance > 242) check(alpha == 0, "clear");
        }
    check(wide->left() == -240 && wide->width() == 500, "240 pixels on each side");
}

}  // namespace

int main() {
    paintAtScales();
    checkWideStroke();
    return 0;
}
