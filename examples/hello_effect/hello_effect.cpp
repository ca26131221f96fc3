// The whole way without a font: a mask drawn by hand becomes hello_effect.ppm.
#include <voreleffect/look.h>

#include <cstdio>
#include <optional>
#include <vector>

using namespace VFontEffect;

int main() {
    const char* const drawing[] = {"#  # #", "#  #  ", "#### #", "#  # #", "#  # #"};
    constexpr int kCell = 20, kWidth = 6 * kCell, kHeight = 5 * kCell;
    std::vector<unsigned char> coverage;
    for (int y = 0; y < kHeight; ++y)
        for (int x = 0; x < kWidth; ++x)
            coverage.push_back(drawing[y / kCell][x / kCell] == '#' ? 255 : 0);

    Look look;  // what is added last lies on top
    look.add(OuterShadow(rgb(0)).angle(135).distance(8).size(10).opacity(0.6F))  // light from upper left
        .add(Stroke(5, rgb(0x3B1C5A)))                                           // 5 pixels, outside
        .add(LinearGradient({{rgb(0xFFD75E), 1, 0}, {rgb(0xE8412C), 1, 1}}).angle(270));  // downwards

    // A picture as large as the glyph and the margins of the look.
    const std::optional<Picture> picture = paint(look, Glyph{0, 0, coverage.data(), kWidth, kHeight});
    if (!picture) return 1;

    // The pixels are premultiplied R, G, B, A: laid over white, a channel becomes c + 255 - alpha.
    std::FILE* file = std::fopen("hello_effect.ppm", "wb");
    if (file == nullptr) return 1;
    std::fprintf(file, "P6 %d %d 255\n", picture->width(), picture->height());
    const unsigned char* end = picture->data() + picture->stride() * picture->height();
    for (const unsigned char* p = picture->data(); p != end; p += 4)
        for (int channel = 0; channel < 3; ++channel)
            std::fputc(p[channel] + 255 - p[3], file);
    return std::fclose(file) == 0 ? 0 : 1;
}
