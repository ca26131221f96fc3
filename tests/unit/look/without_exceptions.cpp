// The header alone, without exceptions and run-time type information, in the first of two sources that
// use it.
#include "tests/unit/look/without_exceptions.h"

#include <voreleffect/look.h>

int main() {
    using namespace VFontEffect;
    constexpr int kSide = 5;
    unsigned char page[4 * kSide * kSide] = {};
    const unsigned char covered = 255;
    const Glyph glyph = {2, 2, &covered, 1, 1};
    if (!paint(outlined(), glyph, {page, kSide, kSide})) return 1;
    const unsigned char* const fill = page + 4 * (2 * kSide + 2);
    if (fill[0] != 0x33 || fill[1] != 0x66 || fill[2] != 0xCC || fill[3] != 0xFF) return 1;
    if (fill[4] != 0xFF || fill[7] != 0xFF) return 1;
    Painter painter(outlined());
    const Glyph none = {0, 0, nullptr, 1, 1};
    if (painter.paint(none) || painter.failure() != Failure::badArgument) return 1;
    return outlined().key().empty() ? 1 : 0;
}
