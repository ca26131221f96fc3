#include <voreleffect/look.h>

#include <cstdio>
#include <optional>

#include "painted.h"

namespace {

/// The same by the modern face, which is in its header alone.
bool looksLikeFillAndOutline() {
    using namespace VFontEffect;
    const Look look = Look().fill(rgb(0x3366CC)).add(Stroke(1, rgb(0xFFFFFF)));
    const unsigned char covered = 255;
    const std::optional<Picture> picture = paint(look, Glyph{0, 0, &covered, 1, 1});
    if (!picture || picture->left() != -1 || picture->width() != 3) return false;
    const unsigned char* fill = picture->data() + picture->stride() + 4;
    return fill[0] == 0x33 && fill[2] == 0xCC && fill[4] == 0xFF && fill[7] == 0xFF;
}

}  // namespace

/// A program outside the project: prints the version of the headers when the library paints.
int main() {
    if (!paintsFillAndOutline() || !looksLikeFillAndOutline()) return 1;
    // The log reaches into the C library, which a static library leaves to the program.
    VFontEffect::VFLog::setPrintLogLevel(0);
    VFontEffect::VFLog::printLog(VFontEffect::VFLogError, "consumer", "%s", "silenced");
    std::puts(VOREL_VERSION_STRING);
    return 0;
}
