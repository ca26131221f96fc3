#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "tests/support/compare.h"
#include "tests/support/guarded.h"
#include "tests/support/literal_engine.h"
#include "tests/support/pixel_cases.h"
#include "tests/support/random.h"
#include "tests/support/thinned.h"
#include "voreleffect/VFBitmap.h"
#include "voreleffect/VFECore.h"
#include "voreleffect/VFEffect.h"
#include "voreleffect/VFProperty.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFBitmap;
using VFontEffect::VFECore;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
using VFontEffect::VFGradient;
using VFontEffect::VFRect;

using Kinds = std::vector<int>;

const Kinds kTextOnly = {literal::kText};
const Kinds kEveryKind = {literal::kOuterShadow, literal::kInnerShadow,    literal::kOuterGlow,
                          literal::kInnerGlow,   literal::kLinearGradient, literal::kRadialGradient,
                          literal::kStroke,      literal::kPattern,        literal::kText};

/// The key as a string; the library's buffer is released.
std::string taken(char* key) {
    const std::string copy = key == nullptr ? "(null)" : key;
    delete[] key;
    return copy;
}

/// One look in both forms. Every step is taken by both, and what can be seen of them is compared.
class Pair {
  public:
    Pair(Random& random, const Kinds& kinds)
        : mRandom(random),
          mKinds(kinds),
          mReal(std::make_unique<VFEffect>()),
          mLiteral(std::make_unique<literal::Engine>()) {}

    /// Adds or updates one effect of a random kind with random arguments.
    void addOne() { addKind(mKinds[pick(mKinds.size())]); }

    /// One random change of the look other than adding an effect.
    void changeLook() {
        const int choice = mRandom.between(0, 9);
        if (choice == 0) removeOne();
        if (choice == 1) setTextOpacity(oneOf(mRandom, {1.0F, 1.0F, 0.5F, 0.0F, 2.0F, -1.0F}));
        if (choice == 2) setTextOpacity(mRandom.real(0.0F, 1.2F));
        if (choice == 3) clearTextOpacity();
        if (choice == 4) replaceByCopy();
        if (choice == 5) addKindWithoutCore();
        if (choice == 6) addTextWithId(mRandom.between(0, 9));
        if (choice == 7 && mRandom.chance(20)) releaseEffects();
        if (choice >= 8) compareKeys(randomColor(mRandom));
    }

    void addKind(int kind);
    void setTextOpacity(float opacity) {
        mReal->setTextOpacity(opacity);
        mLiteral->setTextOpacity(opacity);
        EXPECT_EQ(mReal->getTextOpacity(), mLiteral->getTextOpacity());
    }
    void clearTextOpacity() {
        mReal->clearTextOpacity();
        mLiteral->clearTextOpacity();
    }
    void removeOne() {
        const int id = mRandom.between(-1, 9);
        EXPECT_EQ(mReal->removeEffect(id), mLiteral->removeEffect(id)) << id;
    }
    void releaseEffects() {
        if (mRandom.chance(50))
            mReal->releaseEffect();
        else
            mReal->cleanAllEffect();
        mLiteral->releaseEffect();
    }
    void replaceByCopy() {
        mReal = std::make_unique<VFEffect>(*mReal);
        mLiteral = std::make_unique<literal::Engine>(*mLiteral);
    }
    void addKindWithoutCore() {
        EXPECT_EQ(mReal->addBevelText(0, 1, 1, 0, 0, 1, 1, 30, 30, 0, 1, 0, 1),
                  mLiteral->addKindWithoutCore());
        EXPECT_EQ(mReal->addEmbossText(0, 1, 1, 0, 0, 1, 1, 30, 30, 0, 1, 0, 1),
                  mLiteral->addKindWithoutCore());
    }
    void addTextWithId(int id) {
        literal::Effect text;
        text.kind = literal::kText;
        text.color = randomColor(mRandom);
        text.opacity = 1.0F;
        VFontEffect::VFTextProperty record(text.color, text.opacity);
        EXPECT_EQ(mReal->addEffect(id, literal::kText, &record), mLiteral->addEffect(id, text));
    }

    /// Registers the fill, as a caller does before each run.
    void compareKeys(uint32_t color) {
        EXPECT_EQ(taken(mReal->getMapKey(color)), mLiteral->getMapKey(color));
    }

    /// A run on small layers: the same glyphs, then the destination, the text box, the offsets and
    /// the keys are compared.
    void run();

    void compareState() {
        EXPECT_EQ(taken(mReal->getMapKey()), mLiteral->getMapKey());
        EXPECT_EQ(mReal->hasEffects(), mLiteral->hasEffects());
        const literal::Margins margins = mLiteral->margins();
        EXPECT_EQ(mReal->getLeftOffset(), margins.left);
        EXPECT_EQ(mReal->getRightOffset(), margins.right);
        EXPECT_EQ(mReal->getTopOffset(), margins.top);
        EXPECT_EQ(mReal->getBottomOffset(), margins.bottom);
        for (int kind = 0; kind <= 14; ++kind) {
            VFECore* const core = mReal->getEffect(kind);
            const literal::Effect* const effect = mLiteral->getEffect(kind);
            ASSERT_EQ(core != nullptr, effect != nullptr) << kind;
            if (core == nullptr) continue;
            EXPECT_EQ(core->getId(), effect->id) << kind;
            EXPECT_EQ(mReal->isUnderEffect(core), mLiteral->isUnderEffect(*effect)) << kind;
            EXPECT_EQ(core->getProperty()->mColor, effect->color) << kind;
            EXPECT_EQ(core->getProperty()->mOpacity, effect->opacity) << kind;
        }
    }

  private:
    struct Layers {
        int width, height;
    };

    size_t pick(size_t count) {
        return static_cast<size_t>(mRandom.between(0, static_cast<int>(count) - 1));
    }

    // Arguments: mostly plain ones, some at and beyond the limits.
    float opacity() {
        return mRandom.chance(60) ? mRandom.real(0.0F, 1.0F)
                                  : oneOf(mRandom, {1.0F, 1.0F, 0.0F, 0.5F, 1.7F, -0.3F, -0.0F});
    }
    float angle() {
        if (mRandom.chance(5)) return oneOf(mRandom, {1e12F, -1e12F, 2147483648.0F});
        return mRandom.chance(80) ? mRandom.real(-800.0F, 800.0F)
                                  : oneOf(mRandom, {0.0F, -0.9F, 90.0F, 180.0F, 359.9F, 360.0F, 720.0F});
    }
    float size() {
        return mRandom.chance(85) ? mRandom.real(0.0F, 8.0F)
                                  : oneOf(mRandom, {-4.0F, 0.0F, 0.9F, 1.0F, 12.5F, 20.0F});
    }
    float distance() {
        return mRandom.chance(85) ? mRandom.real(0.0F, 12.0F) : oneOf(mRandom, {-4.0F, 0.0F, 150.0F});
    }
    float gradientScale() {
        return mRandom.chance(80) ? mRandom.real(0.05F, 2.0F)
                                  : oneOf(mRandom, {-1.0F, 0.0F, 0.1F, 1.0F, 2.0F, 3.5F});
    }
    float patternScale() {
        return mRandom.chance(80) ? mRandom.real(0.05F, 3.0F)
                                  : oneOf(mRandom, {-1.0F, 0.0F, 0.1F, 0.5F, 1.0F, 2.0F, 10.0F, 12.0F});
    }

    /// Stops at ascending places, some of them equal, some outside 0..1.
    std::vector<literal::Stop> stops(int count) {
        std::vector<literal::Stop> all;
        float location = mRandom.chance(50) ? 0.0F : mRandom.real(-0.3F, 0.6F);
        for (int i = 0; i < count; ++i) {
            all.push_back(literal::Stop{randomColor(mRandom), opacity(), location});
            location += mRandom.chance(20) ? 0.0F : mRandom.real(0.0F, 2.0F / static_cast<float>(count));
        }
        return all;
    }
    int stopCount(int least) {
        return mRandom.chance(95) ? mRandom.between(least, 5) : oneOf(mRandom, {256, 300});
    }
    static std::vector<VFGradient> realStops(const std::vector<literal::Stop>& stops) {
        std::vector<VFGradient> real;
        for (const literal::Stop& stop : stops)
            real.push_back(VFGradient{stop.color, stop.opacity, stop.location});
        return real;
    }

    literal::Mask randomGlyph();
    void render(const Layers& layers);
    void comparePictures(const literal::Picture& expected, GuardedBitmap& actual) {
        ASSERT_TRUE(sameBytes(expected.bytes.data(), actual.pixels().data(), expected.width,
                              expected.height, 4));
    }

    Random& mRandom;
    const Kinds& mKinds;
    std::unique_ptr<VFEffect> mReal;
    std::unique_ptr<literal::Engine> mLiteral;
};

void Pair::addKind(int kind) {
    const float o = opacity();
    const float s = size();
    const float a = angle();
    const float d = distance();
    const uint32_t color = randomColor(mRandom);
    unsigned real = 0;
    unsigned expected = 1;
    if (kind == literal::kText) {
        real = mReal->addText(color, o);
        expected = mLiteral->addText(color, o);
    }
    if (kind == literal::kOuterShadow) {
        real = mReal->addOuterShadowText(a, d, s, color, o);
        expected = mLiteral->addOuterShadowText(a, d, s, color, o);
    }
    if (kind == literal::kInnerShadow) {
        real = mReal->addInnerShadowText(a, d, s, color, o);
        expected = mLiteral->addInnerShadowText(a, d, s, color, o);
    }
    if (kind == literal::kStroke) {
        const int style = mRandom.between(-3, 200);
        const int position = oneOf(mRandom, {0, 1, 1, 2, 2, 3, -1});
        real = mReal->addStrokeText(s, color, o, style, position);
        expected = mLiteral->addStrokeText(s, color, o, style, position);
    }
    if (kind == literal::kOuterGlow || kind == literal::kInnerGlow) {
        const std::vector<literal::Stop> all = stops(stopCount(0));
        std::vector<VFGradient> reals = realStops(all);
        const int count = all.empty() ? mRandom.between(-5, 0) : static_cast<int>(all.size());
        if (kind == literal::kOuterGlow) {
            real = mReal->addOuterGlowText(s, color, o, count, reals.data());
            expected = mLiteral->addOuterGlowText(s, color, o, count, all.data());
        } else {
            real = mReal->addInnerGlowText(s, color, o, count, reals.data());
            expected = mLiteral->addInnerGlowText(s, color, o, count, all.data());
        }
    }
    if (kind == literal::kLinearGradient || kind == literal::kRadialGradient) {
        const std::vector<literal::Stop> all = stops(stopCount(1));
        std::vector<VFGradient> reals = realStops(all);
        const int count = static_cast<int>(all.size());
        const float scale = gradientScale();
        if (kind == literal::kLinearGradient) {
            real = mReal->addLinearGradientText(a, scale, o, count, reals.data());
            expected = mLiteral->addLinearGradientText(a, scale, o, count, all.data());
        } else {
            real = mReal->addRadialGradientText(scale, o, count, reals.data());
            expected = mLiteral->addRadialGradientText(scale, o, count, all.data());
        }
    }
    if (kind == literal::kPattern) {
        literal::Tile tile;
        tile.width = mRandom.between(1, 9);
        tile.height = mRandom.between(1, 9);
        VFBitmap bitmap(static_cast<unsigned>(tile.width), static_cast<unsigned>(tile.height), 4);
        fillColour(mRandom, bitmap.mData, bitmap.mWidth * bitmap.mHeight, 0);
        tile.bytes = bytesOf(bitmap);
        const float scale = patternScale();
        const bool missing = mRandom.chance(5);
        real = mReal->addPatternText(missing ? nullptr : &bitmap, scale, o);
        expected = mLiteral->addPatternText(missing ? nullptr : &tile, scale, o);
    }
    EXPECT_EQ(real, expected) << "kind " << kind;
}

/// A solid box, a blob with soft edges, or noise.
literal::Mask Pair::randomGlyph() {
    literal::Mask glyph;
    glyph.width = mRandom.between(0, 28);
    glyph.height = mRandom.between(0, 24);
    glyph.bytes.resize(static_cast<size_t>(glyph.width) * static_cast<size_t>(glyph.height));
    const int style = mRandom.between(0, 2);
    if (style == 0) glyph.bytes.assign(glyph.bytes.size(), mRandom.chance(70) ? 255 : 90);
    if (style == 1) {
        const float rx = static_cast<float>(glyph.width) / 2.0F;
        const float ry = static_cast<float>(glyph.height) / 2.0F;
        for (size_t i = 0; i < glyph.bytes.size(); ++i) {
            const auto across = static_cast<size_t>(glyph.width);
            const float dx = (static_cast<float>(i % across) + 0.5F - rx) / rx;
            const float dy = (static_cast<float>(i / across) + 0.5F - ry) / ry;
            const float inside = 3.0F * (1.0F - std::sqrt(dx * dx + dy * dy));
            glyph.bytes[i] = static_cast<uint8_t>(255.0F * std::fmin(std::fmax(inside, 0.0F), 1.0F));
        }
    }
    if (style == 2) fillMask(mRandom, glyph.bytes.data(), glyph.bytes.size());
    return glyph;
}

void Pair::render(const Layers& layers) {
    for (int left = mRandom.between(0, 20) / 4; left > 0; --left) {
        literal::Mask glyph = randomGlyph();
        int x = mRandom.between(-2, layers.width - 1);
        int y = mRandom.between(-2, layers.height - 1);
        if (mRandom.chance(25)) {
            x = mRandom.between(-40, layers.width + 40);
            y = mRandom.between(-40, layers.height + 40);
        }
        VFGlyph real{glyph.bytes.data(), static_cast<unsigned short>(glyph.width),
                     static_cast<unsigned short>(glyph.height)};
        mReal->renderEffectLayer(x, y, &real);
        mLiteral->renderEffectLayer(x, y, &glyph);
    }
    if (mRandom.chance(10)) {
        mReal->renderEffectLayer(1, 1, nullptr);
        mLiteral->renderEffectLayer(1, 1, nullptr);
    }
}

void Pair::run() {
    const Layers layers{mRandom.between(1, 90), mRandom.between(1, 60)};
    GuardedBitmap destination(layers.width, layers.height, 4, randomEdge(mRandom));
    if (mRandom.chance(50)) fillColour(mRandom, destination.pixels());
    literal::Picture expected{layers.width, layers.height, bytesOf(destination.pixels())};

    compareState();
    mReal->initEffect(layers.width, layers.height);
    mLiteral->initEffect(layers.width, layers.height);
    compareState();
    if (mRandom.chance(97)) {
        mReal->setDstBitmap(destination.bitmap());
        mLiteral->setDstBitmap(&expected);
    }
    if (mRandom.chance(10)) changeLook();  // after planning: paints in the order of the list
    for (int pass = mRandom.chance(15) ? 2 : 1; pass > 0; --pass) {
        if (!mLiteral->hasMask()) return;  // a copied look has no run
        render(layers);
        mReal->doEffectPostProcessing();
        mLiteral->doEffectPostProcessing();
        const VFRect* const box = mReal->getTextRect();
        EXPECT_EQ(box->mLeft, mLiteral->textRect().left);
        EXPECT_EQ(box->mTop, mLiteral->textRect().top);
        EXPECT_EQ(box->mRight, mLiteral->textRect().right);
        EXPECT_EQ(box->mBottom, mLiteral->textRect().bottom);
        comparePictures(expected, destination);
    }
    mReal->compositeLayers(destination.bitmap());
    mLiteral->compositeLayers(expected);
    comparePictures(expected, destination);
    EXPECT_EQ(mReal->getSrcBitmap(), nullptr);
    compareState();
}

/// A random life of one look: effects come in random order, runs and changes follow each other.
void liveOnce(uint64_t seed, const Kinds& kinds) {
    SCOPED_TRACE(testing::Message() << "seed " << seed);
    Random random(seed);
    Pair pair(random, kinds);
    for (int left = random.between(0, 6); left > 0; --left)
        pair.addOne();
    if (random.chance(50)) pair.changeLook();
    for (int left = random.between(1, 4); left > 0 && !testing::Test::HasFailure(); --left) {
        if (random.chance(60)) pair.compareKeys(randomColor(random));
        if (random.chance(40)) pair.addOne();
        if (random.chance(40)) pair.changeLook();
        pair.run();
    }
}

TEST(WholeRun, TextFillAloneMatchesTheLiteralEngine) {
    for (uint64_t seed = 0; seed < thinned(2000U) && !HasFailure(); ++seed)
        liveOnce(seed, kTextOnly);
}

TEST(WholeRun, EachKindWithTheTextFillMatchesTheLiteralEngine) {
    for (const int kind : kEveryKind) {
        SCOPED_TRACE(testing::Message() << "kind " << kind);
        const Kinds kinds = {kind, kind, literal::kText};
        for (uint64_t seed = 0; seed < thinned(200U) && !HasFailure(); ++seed)
            liveOnce(seed, kinds);
    }
}

TEST(WholeRun, AllKindsMatchTheLiteralEngine) {
    for (uint64_t seed = 0; seed < thinned(1000U) && !HasFailure(); ++seed)
        liveOnce(seed, kEveryKind);
}

TEST(WholeRun, EveryKindAtOncePaintsInEveryOrder) {
    for (uint64_t seed = 0; seed < thinned(250U) && !HasFailure(); ++seed) {
        SCOPED_TRACE(testing::Message() << "seed " << seed);
        Random random(seed);
        Pair pair(random, kEveryKind);
        for (Kinds left = kEveryKind; !left.empty();) {
            const int at = random.between(0, static_cast<int>(left.size()) - 1);
            pair.addKind(left[static_cast<size_t>(at)]);
            left.erase(left.begin() + at);
        }
        pair.run();
        pair.compareKeys(randomColor(random));  // re-arms the ordering: the next run flips it
        pair.run();
    }
}

TEST(WholeRun, SecondRunAfterTheSameKeyFlipsTheOrder) {
    VFEffect look;
    look.addInnerShadowText(0, 3, 2, 0xFF0000, 1);
    look.addStrokeText(1, 0x00FF00, 1, 0, 2);
    const std::string added = taken(look.getMapKey(0x0000FF));
    ASSERT_EQ(added.substr(0, 1), "I");
    look.initEffect(8, 8);
    EXPECT_EQ(taken(look.getMapKey()).substr(0, 1), "K");  // the newest first
    look.compositeLayers(nullptr);
    look.initEffect(8, 8);
    EXPECT_EQ(taken(look.getMapKey()).substr(0, 1), "K");  // nothing was added since
    look.compositeLayers(nullptr);
    taken(look.getMapKey(0x0000FF));
    look.initEffect(8, 8);
    EXPECT_EQ(taken(look.getMapKey()).substr(0, 1), "I");
}

TEST(WholeRun, GlyphsAtTheEndsOfAnIntPaintNothing) {
    std::vector<uint8_t> coverage(16, 255);
    VFGlyph glyph{coverage.data(), 4, 4};
    for (const int x : {INT_MIN, 0, INT_MAX}) {
        for (const int y : {INT_MIN, 0, INT_MAX}) {
            if (x == 0 && y == 0) continue;
            VFEffect look;
            look.addText(0xFFFFFF, 1);
            look.initEffect(8, 8);
            GuardedBitmap destination(8, 8, 4);
            memset(destination.pixels().data(), 99, destination.pixels().size());
            look.setDstBitmap(destination.bitmap());
            look.renderEffectLayer(x, y, &glyph);
            look.doEffectPostProcessing();
            look.compositeLayers(destination.bitmap());
            EXPECT_EQ(bytesOf(destination.pixels()), std::vector<uint8_t>(256, 99)) << x << ", " << y;
        }
    }
}

TEST(WholeRun, NoNumberIsRefused) {
    const float nan = std::numeric_limits<float>::quiet_NaN();
    const float infinite = std::numeric_limits<float>::infinity();
    for (const float odd : {nan, infinite, -infinite, 1e30F, -1e30F}) {
        SCOPED_TRACE(testing::Message() << odd);
        VFEffect look;
        literal::Engine expected;
        literal::Stop stop{0x123456, odd, odd};
        VFGradient gradient{0x123456, odd, odd};
        look.addOuterShadowText(odd, odd, odd, 0x804020, odd);
        expected.addOuterShadowText(odd, odd, odd, 0x804020, odd);
        look.addInnerShadowText(odd, odd, odd, 0x804020, odd);
        expected.addInnerShadowText(odd, odd, odd, 0x804020, odd);
        look.addOuterGlowText(odd, 0x804020, odd, 1, &gradient);
        expected.addOuterGlowText(odd, 0x804020, odd, 1, &stop);
        look.addInnerGlowText(odd, 0x804020, 0.5F, 1, &gradient);
        expected.addInnerGlowText(odd, 0x804020, 0.5F, 1, &stop);
        look.addLinearGradientText(odd, odd, 0.5F, 1, &gradient);
        expected.addLinearGradientText(odd, odd, 0.5F, 1, &stop);
        look.addRadialGradientText(odd, odd, 1, &gradient);
        expected.addRadialGradientText(odd, odd, 1, &stop);
        look.addStrokeText(odd, 0x804020, odd, INT_MIN, INT_MAX);
        expected.addStrokeText(odd, 0x804020, odd, INT_MIN, INT_MAX);
        look.addPatternText(nullptr, odd, odd);
        expected.addPatternText(nullptr, odd, odd);
        look.addText(0x804020, odd);
        expected.addText(0x804020, odd);
        EXPECT_EQ(taken(look.getMapKey()), expected.getMapKey());
        look.setTextOpacity(odd);
        expected.setTextOpacity(odd);
        EXPECT_EQ(look.getTextOpacity(), expected.getTextOpacity());
        EXPECT_EQ(taken(look.getMapKey(0x804020)), expected.getMapKey(0x804020));
    }
}

}  // namespace
