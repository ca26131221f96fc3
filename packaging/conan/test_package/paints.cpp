#include <voreleffect/voreleffect.h>

#include <cstdio>

/// Paints one covered pixel blue.
int main() {
    VFontEffect::VFEffect look;
    look.addText(0x0000FF, 1);
    VFontEffect::VFBitmap picture(1, 1, 4);
    look.initEffect(1, 1);
    look.setDstBitmap(&picture);
    unsigned char covered = 255;
    VFontEffect::VFGlyph glyph = {&covered, 1, 1};
    look.renderEffectLayer(0, 0, &glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    const bool blue = picture.mData[0] == 0 && picture.mData[2] == 255 && picture.mData[3] == 255;
    std::printf("voreleffect %s %s\n", VOREL_VERSION_STRING, blue ? "paints" : "does not paint");
    return blue ? 0 : 1;
}
