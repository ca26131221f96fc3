#pragma once

#include <voreleffect/voreleffect.h>

/// Paints one covered pixel in a blue fill with a white outline of one pixel. True when both have the
/// colours that were asked for.
inline bool paintsFillAndOutline() {
    constexpr unsigned int kSide = 5;
    VFontEffect::VFEffect look;
    look.addStrokeText(1, 0xFFFFFF, 1, 0, 1);
    look.addText(0x3366CC, 1);

    VFontEffect::VFBitmap picture(kSide, kSide, 4);
    look.initEffect(kSide, kSide);
    look.setDstBitmap(&picture);
    unsigned char covered = 255;
    VFontEffect::VFGlyph glyph = {&covered, 1, 1};
    look.renderEffectLayer(2, 2, &glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);

    const unsigned char* fill = picture.mData + 4 * (2 * kSide + 2);
    const unsigned char* outline = fill + 4;
    return fill[0] == 0x33 && fill[1] == 0x66 && fill[2] == 0xCC && fill[3] == 0xFF &&
           outline[0] == 0xFF && outline[1] == 0xFF && outline[2] == 0xFF && outline[3] == 0xFF;
}
