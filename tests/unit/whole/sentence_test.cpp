#include <gtest/gtest.h>
#include <voreleffect/VFEffect.h>

#include <algorithm>
#include <string>

#include "tests/support/compare.h"
#include "tests/support/engine.h"
#include "tests/support/file_bytes.h"
#include "tests/support/random.h"

using namespace VFontEffect;
using namespace vorel_test;

// A real sentence, painted as plain text by the effect set and, pixel by pixel, by the rules told
// literally below.

namespace {

struct PlacedGlyph {
    int x;
    int y;
    int width;
    int height;
    std::vector<uint8_t> coverage;
};

/// Reads the numbers of the glyph file, least significant byte first.
class ByteReader {
  public:
    explicit ByteReader(const char* path) {
        if (const auto bytes = vorel_test::bytesOfFile(path)) mBytes = *bytes;
    }

    uint32_t number(int bytes) {
        uint32_t value = 0;
        for (int i = 0; i < bytes; ++i)
            value |= static_cast<uint32_t>(take()) << (8 * i);
        return value;
    }

    uint8_t take() { return mAt < mBytes.size() ? static_cast<uint8_t>(mBytes[mAt++]) : uint8_t{0}; }
    bool atEnd() const { return mAt == mBytes.size(); }

  private:
    std::string mBytes;
    size_t mAt = 0;
};

/// The glyphs of the sentence, each struck twice, one pixel apart, so that masks overlap.
std::vector<PlacedGlyph> readSentence() {
    ByteReader reader(VOREL_GLYPH_MASKS);
    std::vector<PlacedGlyph> glyphs;
    for (uint32_t count = reader.number(4); count > 0; --count) {
        PlacedGlyph glyph = {};
        glyph.x = static_cast<int>(reader.number(4));
        glyph.y = static_cast<int>(reader.number(4));
        glyph.width = static_cast<int>(reader.number(2));
        glyph.height = static_cast<int>(reader.number(2));
        glyph.coverage.resize(static_cast<size_t>(glyph.width) * static_cast<size_t>(glyph.height));
        for (uint8_t& m : glyph.coverage)
            m = reader.take();
        glyphs.push_back(glyph);
        ++glyph.x;
        glyphs.push_back(glyph);
    }
    EXPECT_TRUE(reader.atEnd()) << VOREL_GLYPH_MASKS;
    return glyphs;
}

struct Pixel {
    int c[4];  ///< R, G, B, A
};

Pixel premultiplied(unsigned colour, int alpha) {
    const auto channel = [&](int shift) {
        return alpha * (static_cast<int>(colour >> shift & 0xFF) + 1) >> 8;
    };
    return {{channel(16), channel(8), channel(0), alpha}};
}

int saturated(int value) {
    return std::min(value, 255);
}

/// The colour under the picture, then the whole pixel cut to the coverage.
Pixel underAndClipped(const Pixel& d, int m, const Pixel& colour) {
    if (m == 0) return {};
    const int inv = 255 - d.c[3];
    const int alpha = saturated(m * (colour.c[3] + 1) >> 8);
    Pixel out = {};
    for (int i = 0; i < 3; ++i) {
        const int scaled = m * (colour.c[i] + 1) >> 8;
        if (d.c[3] == 0) {
            out.c[i] = saturated(scaled);
        } else if (m == 255) {
            out.c[i] = saturated(d.c[i] + (inv * (colour.c[i] + 1) >> 8));
        } else if (d.c[3] == 255) {
            out.c[i] = saturated((d.c[i] + 1) * m >> 8);
        } else {
            out.c[i] = saturated((d.c[i] + ((scaled + 1) * inv >> 8) + 1) * m >> 8);
        }
    }
    if (d.c[3] == 0) {
        out.c[3] = alpha;
    } else if (m == 255) {
        out.c[3] = saturated(d.c[3] + (inv * (alpha + 1) >> 8));
    } else if (d.c[3] == 255) {
        out.c[3] = m;
    } else {
        out.c[3] = saturated((d.c[3] + (inv * (alpha + 1) >> 8) + 1) * m >> 8);
    }
    return out;
}

/// The full colour under the picture wherever there is coverage.
Pixel underGated(const Pixel& d, int m, const Pixel& colour) {
    if (d.c[3] == 255 || m == 0) return d;
    if (d.c[3] == 0) return colour;
    Pixel out = {};
    for (int i = 0; i < 4; ++i)
        out.c[i] = saturated(d.c[i] + ((255 - d.c[3]) * (colour.c[i] + 1) >> 8));
    return out;
}

/// The composite with an outer layer that nothing was painted into: all its bytes are 0.
Pixel withEmptyOuterLayer(const Pixel& d, int m) {
    Pixel out = {};
    for (int i = 0; i < 4; ++i)
        out.c[i] = saturated(((0 + 1) * (255 - m) >> 8) + ((d.c[i] + 1) * m >> 8));
    return out;
}

class Sentence : public ::testing::Test {
  protected:
    static constexpr int kMargin = 3;

    void SetUp() override {
        glyphs = readSentence();
        ASSERT_GT(glyphs.size(), 20U);
        for (const PlacedGlyph& glyph : glyphs) {
            width = std::max(width, glyph.x + glyph.width + kMargin);
            height = std::max(height, glyph.y + glyph.height + kMargin);
        }
        mask.resize(pixelCount());
        for (const PlacedGlyph& glyph : glyphs) {
            for (int y = 0; y < glyph.height; ++y) {
                for (int x = 0; x < glyph.width; ++x) {
                    if (glyph.x + x < 0 || glyph.y + y < 0) continue;
                    uint8_t& m = mask[static_cast<size_t>((glyph.y + y) * width + glyph.x + x)];
                    m = std::max(m, glyph.coverage[static_cast<size_t>(y * glyph.width + x)]);
                }
            }
        }
    }

    size_t pixelCount() const { return static_cast<size_t>(width) * static_cast<size_t>(height); }

    /// A transparent picture, or one of random premultiplied pixels: transparent, opaque and between.
    std::vector<uint8_t> makePicture(bool painted) const {
        std::vector<uint8_t> picture(pixelCount() * 4);
        Random random(32);
        for (size_t i = 0; painted && i < picture.size(); i += 4) {
            const int alpha = random.chance(50) ? random.byte() : random.chance(50) ? 0 : 255;
            for (size_t c = 0; c < 3; ++c)
                picture[i + c] = static_cast<uint8_t>(random.between(0, alpha));
            picture[i + 3] = static_cast<uint8_t>(alpha);
        }
        return picture;
    }

    template <class Rule>
    std::vector<uint8_t> literally(std::vector<uint8_t> picture, Rule rule) const {
        for (size_t i = 0; i < mask.size(); ++i) {
            uint8_t* const bytes = picture.data() + 4 * i;
            const Pixel out = rule(Pixel{{bytes[0], bytes[1], bytes[2], bytes[3]}}, int{mask[i]});
            for (int c = 0; c < 4; ++c)
                bytes[c] = static_cast<uint8_t>(out.c[c]);
        }
        return picture;
    }

    std::vector<uint8_t> painted(const std::vector<uint8_t>& before, float textOpacity) {
        VFEffect set;
        VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
        std::copy(before.begin(), before.end(), picture.mData);
        set.setTextOpacity(textOpacity);
        delete[] set.getMapKey(kColour);
        set.initEffect(width, height);
        set.setDstBitmap(&picture);
        for (PlacedGlyph& glyph : glyphs) {
            VFGlyph handed = {glyph.coverage.data(), static_cast<unsigned short>(glyph.width),
                              static_cast<unsigned short>(glyph.height)};
            set.renderEffectLayer(glyph.x, glyph.y, &handed);
        }
        EXPECT_TRUE(sameBytes(mask.data(), set.getSrcBitmap()->mData, width, height, 1));
        set.doEffectPostProcessing();
        set.compositeLayers(&picture);
        return bytesOf(picture);
    }

    void expectSame(const std::vector<uint8_t>& expected, const std::vector<uint8_t>& actual) const {
        ASSERT_EQ(expected.size(), actual.size());
        EXPECT_TRUE(sameBytes(expected.data(), actual.data(), width, height, 4));
    }

    static constexpr unsigned kColour = 0x3366CC;

    std::vector<PlacedGlyph> glyphs;
    std::vector<uint8_t> mask;
    int width = 0;
    int height = 0;
};

TEST_F(Sentence, HasEveryKindOfCoverage) {
    EXPECT_GT(std::count(mask.begin(), mask.end(), 0), 100);
    EXPECT_GT(std::count(mask.begin(), mask.end(), 255), 100);
    EXPECT_GT(std::count_if(mask.begin(), mask.end(), [](uint8_t m) { return m > 0 && m < 255; }), 100);
}

TEST_F(Sentence, AtFullTextOpacity_IsTheLiteralPicture) {
    const Pixel colour = premultiplied(kColour, 255);
    for (const bool onPaint : {false, true}) {
        const auto before = makePicture(onPaint);
        const auto expected =
            literally(before, [&](const Pixel& d, int m) { return underAndClipped(d, m, colour); });
        expectSame(expected, painted(before, 1));
    }
}

TEST_F(Sentence, AtHalfTextOpacity_IsTheLiteralPicture) {
    const Pixel colour = premultiplied(kColour, 128);
    for (const bool onPaint : {false, true}) {
        const auto before = makePicture(onPaint);
        const auto expected = literally(before, [&](const Pixel& d, int m) {
            return withEmptyOuterLayer(underGated(d, m, colour), m);
        });
        expectSame(expected, painted(before, 0.5F));
    }
}

}  // namespace
