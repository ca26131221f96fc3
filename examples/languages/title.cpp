// A letter in a look, painted on a grey page: title FILE writes the page's pixels, R, G, B, A.
#include <voreleffect/look.h>

#include <cstdio>
#include <vector>

using namespace VFontEffect;

int main(int argc, char** argv) {
    std::vector<unsigned char> letter;  // an H
    for (int y = 0; y < 72; ++y)
        for (int x = 0; x < 60; ++x)
            letter.push_back(x < 18 || x >= 42 || (y >= 27 && y < 45) ? 255 : 0);

    Look look;
    look.fill(rgb(0xE8412C))
        .add(OuterShadow(rgb(0x1B2A41)).angle(135).distance(6).size(8).opacity(0.6F))
        .add(Stroke(4, rgb(0xFFFFFF)))
        .add(LinearGradient({{rgb(0xFFD75E), 1, 0}, {rgb(0xFFD75E), 0, 1}}).angle(270));

    std::vector<unsigned char> page;
    for (int pixel = 0; pixel < 100 * 110; ++pixel)
        page.insert(page.end(), {200, 200, 200, 255});
    if (!paint(look, Glyph{0, 0, letter.data(), 60, 72}, {page.data(), 100, 110}, 20, 18)) return 1;

    std::FILE* file = argc > 1 ? std::fopen(argv[1], "wb") : nullptr;
    if (file == nullptr) return 1;
    const bool isWritten = std::fwrite(page.data(), page.size(), 1, file) == 1;
    return std::fclose(file) == 0 && isWritten ? 0 : 1;
}
