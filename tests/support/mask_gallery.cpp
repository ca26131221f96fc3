#include "mask_gallery.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <utility>

#include "file_bytes.h"

namespace vorel_test {
namespace {

using literal::Mask;

uint8_t& pixel(Mask& mask, int x, int y) {
    return mask.bytes[static_cast<size_t>(y) * static_cast<size_t>(mask.width) + static_cast<size_t>(x)];
}

void coverBox(Mask& mask, literal::Box box, uint8_t coverage) {
    for (int y = std::max(box.top, 0); y < std::min(box.bottom, mask.height); ++y) {
        for (int x = std::max(box.left, 0); x < std::min(box.right, mask.width); ++x) {
            pixel(mask, x, y) = coverage;
        }
    }
}

/// Keeps the larger coverage, as glyphs laid over each other do.
void lay(Mask& onto, const Mask& piece, int left, int top) {
    for (int y = 0; y < piece.height; ++y) {
        for (int x = 0; x < piece.width; ++x) {
            if (left + x < 0 || top + y < 0 || left + x >= onto.width || top + y >= onto.height)
                continue;
            const auto at =
                static_cast<size_t>(y) * static_cast<size_t>(piece.width) + static_cast<size_t>(x);
            uint8_t& target = pixel(onto, left + x, top + y);
            target = std::max(target, piece.bytes[at]);
        }
    }
}

Mask letterR() {
    return maskFromRows({"................",  //
                         "..########......",  //
                         "..#########+....",  //
                         "..###...-###....",  //
                         "..###....+##+...",  //
                         "..###....###....",  //
                         "..#########-....",  //
                         "..#######+......",  //
                         "..###..###......",  //
                         "..###...###.....",  //
                         "..###...+###....",  //
                         "..###....+###...",  //
                         "................"});
}

Mask letterO() {
    return maskFromRows({"...+####+...",  //
                         ".+########+.",  //
                         "+###-..-###+",  //
                         "###......###",  //
                         "###......###",  //
                         "###......###",  //
                         "+###-..-###+",  //
                         ".+########+.",  //
                         "...+####+..."});
}

Mask diagonals(int width, int height) {
    Mask mask = filledMask(width, height, 0);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            if ((x + y) % 17 == 0) pixel(mask, x, y) = 255;
            if ((x - 2 * y) % 31 == 0) pixel(mask, x, y) = 130;
        }
    }
    return mask;
}

Mask cross(int width, int height) {
    Mask mask = filledMask(width, height, 0);
    coverBox(mask, {width / 2, 0, width / 2 + 1, height}, 255);
    coverBox(mask, {0, height / 2, width, height / 2 + 1}, 255);
    return mask;
}

Mask rampMask(int width, int height) {
    Mask mask = filledMask(width, height, 0);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x)
            pixel(mask, x, y) = static_cast<uint8_t>((x * 3 + y) & 0xFF);
    }
    return mask;
}

Mask page() {
    Mask mask = filledMask(300, 200, 0);
    for (int row = 0; row < 4; ++row) {
        for (int column = 0; column < 8; ++column) {
            const bool round = (row + column) % 2 == 0;
            lay(mask, round ? letterO() : letterR(), 6 + column * 36, 8 + row * 40);
        }
    }
    lay(mask, discMask(80, 80, 40.0F, 40.0F, 33.5F, true), 110, 60);
    return mask;
}

std::vector<NamedMask> makeGallery() {
    Random random(20240229);
    std::vector<NamedMask> gallery{
        {"one covered pixel", filledMask(1, 1, 255)},
        {"one faint pixel", filledMask(1, 1, 1)},
        {"one empty pixel", filledMask(1, 1, 0)},
        {"row of 300", rampMask(300, 1)},
        {"column of 300", rampMask(1, 300)},
        {"two rows", noiseMask(random, 41, 2, 30)},
        {"two columns", noiseMask(random, 2, 41, 30)},
        {"nothing", filledMask(23, 17, 0)},
        {"everything", filledMask(23, 17, 255)},
        {"letter R", letterR()},
        {"letter O", letterO()},
        {"hard disc", discMask(33, 31, 16.0F, 15.0F, 12.0F, false)},
        {"smooth disc", discMask(37, 40, 18.3F, 19.6F, 14.2F, true)},
        {"cross", cross(35, 27)},
        {"diagonals", diagonals(64, 48)},
        {"ramp", rampMask(67, 19)},
        {"noise", noiseMask(random, 45, 33, 0)},
        {"sparse noise", noiseMask(random, 80, 60, 97)},
        {"page", page()},
    };
    if (glyphLine().width > 0) gallery.push_back({"line of glyphs", glyphLine()});
    return gallery;
}

/// Reads little-endian numbers and pixels one after the other; past the end everything is 0.
class ByteReader {
  public:
    explicit ByteReader(std::vector<uint8_t> bytes) : mBytes(std::move(bytes)) {}

    uint32_t number(int bytes) {
        uint32_t value = 0;
        for (int i = 0; i < bytes; ++i)
            value |= uint32_t{next()} << (8 * i);
        return value;
    }
    uint8_t next() { return mAt < mBytes.size() ? mBytes[mAt++] : uint8_t{0}; }
    size_t left() const { return mBytes.size() - mAt; }

  private:
    std::vector<uint8_t> mBytes;
    size_t mAt = 0;
};

std::string glyphFile() {
    if (const char* path = std::getenv("VOREL_GLYPH_MASKS")) return path;
#ifdef VOREL_GLYPH_MASKS
    return VOREL_GLYPH_MASKS;
#else
    return {};
#endif
}

Mask readGlyphLine() {
    const std::string path = glyphFile();
    if (path.empty()) return {};
    const auto bytes = bytesOfFile(path);
    if (!bytes) {
        std::fprintf(stderr, "cannot read the glyph masks in %s\n", path.c_str());
        std::abort();
    }
    ByteReader reader({bytes->begin(), bytes->end()});

    struct Piece {
        int x, y;
        Mask mask;
    };
    std::vector<Piece> pieces;
    int right = 0;
    int bottom = 0;
    const uint32_t count = reader.number(4);
    for (uint32_t i = 0; i < count && reader.left() > 0; ++i) {
        Piece piece{};
        piece.x = static_cast<int>(reader.number(4));
        piece.y = static_cast<int>(reader.number(4));
        piece.mask.width = static_cast<int>(reader.number(2));
        piece.mask.height = static_cast<int>(reader.number(2));
        const size_t pixels =
            static_cast<size_t>(piece.mask.width) * static_cast<size_t>(piece.mask.height);
        for (size_t p = 0; p < pixels; ++p)
            piece.mask.bytes.push_back(reader.next());
        right = std::max(right, piece.x + piece.mask.width);
        bottom = std::max(bottom, piece.y + piece.mask.height);
        pieces.push_back(std::move(piece));
    }
    Mask line = filledMask(right, bottom, 0);
    for (const Piece& piece : pieces)
        lay(line, piece.mask, piece.x, piece.y);
    return line;
}

}  // namespace

const std::vector<NamedMask>& maskGallery() {
    static const std::vector<NamedMask> gallery = makeGallery();
    return gallery;
}

const Mask& glyphLine() {
    static const Mask line = readGlyphLine();
    return line;
}

Mask filledMask(int width, int height, uint8_t coverage) {
    const size_t pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
    return {width, height, std::vector<uint8_t>(pixels, coverage)};
}

Mask maskFromRows(std::initializer_list<const char*> rows) {
    Mask mask;
    mask.height = static_cast<int>(rows.size());
    for (const char* row : rows) {
        const std::string line = row;
        mask.width = static_cast<int>(line.size());
        for (char c : line) {
            mask.bytes.push_back(static_cast<uint8_t>(c == '#'   ? 255
                                                      : c == '+' ? 128
                                                      : c == '-' ? 1
                                                                 : 0));
        }
    }
    return mask;
}

Mask discMask(int width, int height, float centreX, float centreY, float radius, bool smooth) {
    Mask mask = filledMask(width, height, 0);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const float dx = static_cast<float>(x) - centreX;
            const float dy = static_cast<float>(y) - centreY;
            const float inside = radius + 0.5F - std::sqrt(dx * dx + dy * dy);
            const float share = smooth ? std::clamp(inside, 0.0F, 1.0F) : (inside > 0.5F ? 1.0F : 0.0F);
            pixel(mask, x, y) = static_cast<uint8_t>(share * 255.0F);
        }
    }
    return mask;
}

Mask noiseMask(Random& random, int width, int height, int emptyPercent) {
    Mask mask = filledMask(width, height, 0);
    for (uint8_t& c : mask.bytes)
        c = random.chance(emptyPercent) ? uint8_t{0} : random.byte();
    return mask;
}

Mask randomMask(Random& random, int width, int height) {
    switch (random.between(0, 8)) {
        case 0:
            return filledMask(width, height, 255);
        case 1:
            return filledMask(width, height, random.chance(50) ? uint8_t{0} : random.byte());
        case 2:
            return noiseMask(random, width, height, 0);
        case 3:
            return noiseMask(random, width, height, 95);
        case 4: {
            Mask mask = filledMask(width, height, 0);
            const int left = random.between(0, width - 1);
            const int top = random.between(0, height - 1);
            coverBox(mask, {left, top, random.between(left + 1, width), random.between(top + 1, height)},
                     255);
            return mask;
        }
        case 5:
            return cross(width, height);
        case 6: {
            Mask mask = filledMask(width, height, 0);
            lay(mask, random.chance(50) ? letterR() : letterO(), random.between(-8, width - 1),
                random.between(-6, height - 1));
            return mask;
        }
        default: {
            const auto w = static_cast<float>(width);
            const auto h = static_cast<float>(height);
            return discMask(width, height, random.real(0.0F, w), random.real(0.0F, h),
                            random.real(0.0F, std::max(w, h)), random.chance(70));
        }
    }
}

Mask unlikeText(Random& random, int width, int height) {
    Mask mask = noiseMask(random, width, height, random.chance(50) ? 0 : random.between(50, 99));
    const int step = random.between(0, 5);
    const int grain = random.between(1, 256);
    for (int y = 0; y < height && step > 0; ++y) {
        for (int x = 0; x < width; ++x) {
            uint8_t& value = mask.bytes[static_cast<size_t>(y * width + x)];
            value = static_cast<uint8_t>(std::min((x * step + y) % 240 + value % grain, 255));
        }
    }
    return mask;
}

}  // namespace vorel_test
