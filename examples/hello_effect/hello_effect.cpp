// The whole cycle without a font: a mask drawn by hand becomes hello_effect.ppm.
#include <voreleffect/voreleffect.h>

#include <cstdio>
#include <vector>

using namespace VFontEffect;

int main() {
    const char* const drawing[] = {"#  # #", "#  #  ", "#### #", "#  # #", "#  # #"};
    constexpr int kCell = 20, kWidth = 6 * kCell, kHeight = 5 * kCell;
    std::vector<unsigned char> coverage;
    for (int y = 0; y < kHeight; ++y)
        for (int x = 0; x < kWidth; ++x)
            coverage.push_back(drawing[y / kCell][x / kCell] == '#' ? 255 : 0);
    VFGlyph glyph = {coverage.data(), kWidth, kHeight};

    VFEffect look;
    VFGradient dawn[] = {{0xFFD75E, 1, 0}, {0xE8412C, 1, 1}};
    look.addLinearGradientText(270, 1, 1, 2, dawn);       // downwards
    look.addStrokeText(5, 0x3B1C5A, 1, 0, 1);             // 5 pixels, outside
    look.addOuterShadowText(135, 8, 10, 0x000000, 0.6F);  // light from the upper left
    look.addText(0, 1);                                   // beneath the gradient

    const int left = look.getLeftOffset(), top = look.getTopOffset();  // margins for the effects
    const int width = left + kWidth + look.getRightOffset();
    const int height = top + kHeight + look.getBottomOffset();
    VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    look.initEffect(width, height);
    look.setDstBitmap(&picture);
    look.renderEffectLayer(left, top, &glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);

    // The pixels are premultiplied R, G, B, A: laid over white, a channel becomes c + 255 - alpha.
    std::FILE* file = std::fopen("hello_effect.ppm", "wb");
    if (file == nullptr) return 1;
    std::fprintf(file, "P6 %d %d 255\n", width, height);
    for (const unsigned char* p = picture.mData; p != picture.mData + 4 * width * height; p += 4)
        for (int channel = 0; channel < 3; ++channel)
            std::fputc(p[channel] + 255 - p[3], file);
    return std::fclose(file) == 0 ? 0 : 1;
}
