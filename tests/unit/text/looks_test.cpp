#include <gtest/gtest.h>
#include <voreleffect/look.h>

#include <cstdint>
#include <string>
#include <vector>

#include "support/random.h"
#include "text/layers.h"
#include "text/utf8.h"
#include "unit/look/looks_by_hand.h"
#include "unit/text/test_font.h"

// A stack of looks painted here and in the library's modern face is the same picture, byte for byte.

namespace voreltext {
namespace {

/// The glyphs of a text with their coverage.
class Masks {
  public:
    explicit Masks(const TextLayout& text) {
        for (size_t i = 0; i < text.glyphCount(); ++i)
            mMasks.push_back(text.rasterise(i));
    }
    std::vector<VFontEffect::Glyph> glyphs() const {
        std::vector<VFontEffect::Glyph> placed;
        for (const GlyphMask& mask : mMasks) {
            placed.push_back({mask.box.left, mask.box.top, mask.coverage.data(), mask.box.width(),
                              mask.box.height()});
        }
        return placed;
    }

  private:
    std::vector<GlyphMask> mMasks;
};

TEST(Looks, OfAStack_AreThePictureOfItsLayers) {
    constexpr int kRounds = 40;
    Fonts fonts{Font(FontFile{VOREL_TEST_FONT}, 30)};
    const char* const texts[] = {"Type", "fi Ij", "H", "Ag\nzy"};
    for (int seed = 0; seed < kRounds; ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        vorel_test::Random random(static_cast<uint64_t>(seed));
        const TextLayout text(fonts, decodeUtf8(texts[seed % 4]), {});
        const vorel_test::TwoLooks below = vorel_test::randomLook(random);
        const vorel_test::TwoLooks above = vorel_test::randomLook(random);
        const std::vector<Layer> layers = {{&below.set}, {&above.set}};
        const Canvas canvas = placedOn({}, text.inkBox(), marginsOf(layers));
        const Image image = paint(layers, text, canvas);

        std::vector<uint8_t> page(image.pixels.size());
        const Masks masks(text);
        ASSERT_TRUE(VFontEffect::paint({below.look, above.look}, masks.glyphs(),
                                       {page.data(), image.width, image.height}, canvas.x, canvas.y));
        ASSERT_EQ(image.pixels, page);
    }
}

}  // namespace
}  // namespace voreltext
