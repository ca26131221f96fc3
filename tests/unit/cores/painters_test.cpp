#include "cores/painters.h"

#include <gtest/gtest.h>

#include <cmath>
#include <cstdint>
#include <limits>
#include <utility>
#include <vector>

#include "core/effect_types.h"
#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/plans.h"

/// The cores with little working memory, and with rests: windows of all sizes down to a pixel, cut
/// anywhere, and strips of any height paint the bytes of the literal forms.
namespace {

using namespace vorel_test;
using namespace VFontEffect;
using VFontEffect::internal::EffectType;

/// A core that paints with so much working memory, and rests after every so many rows.
template <class Record>
class Painter : public VFECoreBase {
  public:
    Painter(EffectType type, int64_t workingBytes, int64_t stripRows, Record record)
        : mType(type), mWorkingBytes(workingBytes), mStripRows(stripRows), mRecord(std::move(record)) {}

    void setProperty(VFProperty* /*property*/) override {}
    VFProperty* getProperty() override { return &mRecord; }
    void doPostProcessing(ParamPostProcessing* params) override {
        paintWithin(mWorkingBytes, mStripRows, mType, mRecord, params);
    }

  private:
    EffectType mType;
    int64_t mWorkingBytes;
    int64_t mStripRows;
    Record mRecord;
};

/// From what not even a pixel is painted with, which cuts into single ones, to plenty; of large sizes,
/// where a pixel takes a while, mostly enough for some.
int64_t randomBytes(Random& random, float size) {
    const int fewest = random.chance(3) || !(size > 8.0F) ? 8 : size > 24.0F ? 17 : 14;
    return int64_t{1} << random.between(fewest, 19);
}

/// As often as not enough for all rows at once.
int64_t randomStripRows(Random& random) {
    return random.chance(50) ? 1000 : random.between(1, 40);
}

/// Sizes of all kinds: small, whole, up to the limit of the add-calls, hand-made and odd ones.
float randomSize(Random& random) {
    switch (random.between(0, 9)) {
        case 0:
            return random.real(-3.0F, 0.0F);
        case 1:
            return random.chance(80) ? random.real(30.0F, 60.0F) : random.real(60.0F, 256.0F);
        case 2:
            return std::numeric_limits<float>::quiet_NaN();
        case 3:
        case 4:
            return static_cast<float>(random.between(0, 24));
        default:
            return random.real(0.0F, 30.0F);
    }
}

/// Now and then with nothing, or everything, covered, and a destination of another size.
Scene windowedScene(Random& random) {
    Scene scene = randomScene(random, 60);
    if (random.chance(20)) {
        const uint8_t coverage = random.chance(50) ? 255 : 0;
        scene.mask = filledMask(scene.mask.width, scene.mask.height, coverage);
    }
    if (random.chance(40))
        scene.dst = randomPicture(random, random.between(1, 110), random.between(1, 90));
    return scene;
}

TEST(Painters, StrokesInWindows_AreThoseOfTheLiteralForm) {
    forSeeds(0, 1200, [](Random& random) {
        const Scene scene = windowedScene(random);
        const int position = random.between(-1, 3);
        const float size = randomSize(random);
        const uint32_t color = randomPremultiplied(random);
        const int64_t bytes = randomBytes(random, size);
        Painter<VFStrokeProperty> core(internal::kStroke, bytes, randomStripRows(random),
                                       {size, color, 1.0F, 0, position});
        EXPECT_TRUE(paintsLike(core, scene,
                               [&](Scene& expected) {
                                   literal::paintStroke(expected.dst,
                                                        expected.sub ? &*expected.sub : nullptr,
                                                        expected.mask, expected.text,
                                                        expected.useOuterLayer, size, color, position);
                               }))
            << "size " << size << ", position " << position << ", " << bytes << " bytes";
    });
}

/// A mask with room for the stroke around a box that is like no text from column `from` on.
Scene sceneUnlikeText(Random& random, int width, int height, int from, int margin) {
    literal::Mask mask = filledMask(width + 2 * margin, height + 2 * margin, 0);
    const literal::Mask before = randomMask(random, width, height);
    const literal::Mask noise = unlikeText(random, width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            const auto at = static_cast<size_t>(y * width + x);
            mask.bytes[static_cast<size_t>((y + margin) * mask.width + x + margin)] =
                x < from ? before.bytes[at] : noise.bytes[at];
        }
    }
    return sceneOf(mask, {margin, margin, margin + width, margin + height});
}

void expectTheSameInOneWindow(Random& random, const Scene& scene, float size, int position,
                              int64_t bytes) {
    const VFStrokeProperty record = {size, randomPremultiplied(random), 1.0F, 0, position};
    Painter<VFStrokeProperty> core(internal::kStroke, bytes, randomStripRows(random), record);
    Painter<VFStrokeProperty> inOne(internal::kStroke, INT32_MAX, INT32_MAX, record);
    EXPECT_TRUE(samePaint(painted(inOne, scene), painted(core, scene)))
        << "size " << size << ", position " << position << ", " << bytes << " bytes";
}

/// Tiles give large strokes of such masks up half-way, where less memory than squares need has to do.
TEST(Painters, StrokesThatTilesGiveUp_AreTheSameInWindows) {
    forSeeds(0, 80, [](Random& random) {
        const int width = random.between(200, 400);
        const int from = random.chance(50) ? 0 : random.between(0, width);
        const float size = random.real(17.0F, 50.0F);
        const int margin = random.chance(50) ? 0 : static_cast<int>(size) + 1;
        const Scene scene = sceneUnlikeText(random, width, random.between(80, 200), from, margin);
        const int64_t bytes = (int64_t{1} << random.between(17, 18)) * random.between(16, 31) / 16;
        expectTheSameInOneWindow(random, scene, size, random.between(0, 2), bytes);
    });
}

/// The last window of a row, the narrowest one, may have memory for squares where the next one, as wide
/// as the others, has none. Each of these is so at some level, where noise begins in that window.
TEST(Painters, StrokesThatTilesGiveUpInTheLastColumn_AreTheSameInWindows) {
    struct Gap {
        int width, height;
        float size;
        int position;
        int64_t bytes;
    };
    constexpr Gap kGaps[] = {{296, 231, 34.0F, 1, 131072},
                             {389, 183, 23.0F, 1, 131072},
                             {233, 177, 48.0F, 0, 262144},
                             {385, 161, 44.0F, 0, 262144},
                             {240, 152, 40.0F, 0, 262144}};
    for (const Gap& gap : kGaps) {
        const int reach = static_cast<int>(gap.position == 0 ? gap.size / 2 : gap.size);
        for (int from = gap.width / 2; from < gap.width; from += 16) {
            Random random(static_cast<uint64_t>(from));
            const Scene scene = sceneUnlikeText(random, gap.width, gap.height, from, reach + 1);
            expectTheSameInOneWindow(random, scene, gap.size, gap.position, gap.bytes);
        }
    }
}

/// Likewise with full coverage close to every pixel, so that of the two dilations of a centred stroke
/// only that of the inverse is given up.
TEST(Painters, StrokesOfWhichOneDilationIsGivenUp_AreTheSameInWindows) {
    constexpr int kWidth = 819;
    constexpr int kHeight = 478;
    constexpr int kMargin = 39;
    for (const int from : {500, 600, 700}) {
        Random random(static_cast<uint64_t>(from));
        literal::Mask mask = filledMask(kWidth + 2 * kMargin, kHeight + 2 * kMargin, 0);
        for (int y = 0; y < kHeight; ++y) {
            for (int x = 0; x < kWidth; ++x) {
                const int ramp = (x + y) % 240 + random.between(0, 15);
                const bool isFull = x < from || (x % 6 == 0 && y % 6 == 0);
                mask.bytes[static_cast<size_t>((y + kMargin) * mask.width + x + kMargin)] =
                    static_cast<uint8_t>(isFull ? 255 : 255 - ramp);
            }
        }
        const literal::Box box = {kMargin, kMargin, kMargin + kWidth, kMargin + kHeight};
        expectTheSameInOneWindow(random, sceneOf(mask, box), 76.0F, 0, 1 << 20);
    }
}

template <class Record, class LiteralForm>
void expectShadows(EffectType type, LiteralForm literalForm) {
    forSeeds(0, 800, [&](Random& random) {
        const Scene scene = windowedScene(random);
        const Record record(random.real(0.0F, 360.0F), random.real(0.0F, 30.0F), randomSize(random),
                            randomPremultiplied(random), 1.0F);
        const int64_t bytes = randomBytes(random, record.mSize);
        Painter<Record> core(type, bytes, randomStripRows(random), record);
        EXPECT_TRUE(paintsLike(core, scene,
                               [&](Scene& expected) {
                                   literalForm(expected.dst, expected.mask, expected.text, record.mAngle,
                                               record.mDistance, record.mSize, record.mColor);
                               }))
            << "size " << record.mSize << ", " << bytes << " bytes";
    });
}

TEST(Painters, OuterShadowsInWindows_AreThoseOfTheLiteralForm) {
    expectShadows<VFOuterShadowProperty>(internal::kOuterShadow, literal::paintOuterShadow);
}

TEST(Painters, InnerShadowsInWindows_AreThoseOfTheLiteralForm) {
    expectShadows<VFInnerShadowProperty>(internal::kInnerShadow, literal::paintInnerShadow);
}

template <class Record, class LiteralForm>
void expectGlows(EffectType type, LiteralForm literalForm) {
    forSeeds(0, 400, [&](Random& random) {
        const Scene scene = windowedScene(random);
        const auto stops = randomStops(random, random.chance(50) ? 0 : random.between(1, 4));
        auto array = libraryStops(stops);
        const Record record(randomSize(random), randomStraight(random), 1.0F,
                            static_cast<int>(array.size()), array.data());
        const int64_t bytes = randomBytes(random, record.mSize);
        Painter<Record> core(type, bytes, randomStripRows(random), record);
        EXPECT_TRUE(paintsLike(core, scene,
                               [&](Scene& expected) {
                                   literalForm(expected.dst, expected.mask, expected.text, record.mSize,
                                               record.mColor, stops);
                               }))
            << "size " << record.mSize << ", " << bytes << " bytes";
    });
}

TEST(Painters, OuterGlowsInWindows_AreThoseOfTheLiteralForm) {
    expectGlows<VFOuterGlowProperty>(internal::kOuterGlow, literal::paintOuterGlow);
}

TEST(Painters, InnerGlowsInWindows_AreThoseOfTheLiteralForm) {
    expectGlows<VFInnerGlowProperty>(internal::kInnerGlow, literal::paintInnerGlow);
}

}  // namespace
