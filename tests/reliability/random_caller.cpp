#include "random_caller.h"

#include <cstddef>
#include <cstring>
#include <vector>

#include "tests/support/mask_gallery.h"

namespace vorel_test {
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
using VFontEffect::VFGradient;
using VFontEffect::VFRect;

/// FNV-1a over bytes and whole numbers.
class Hash {
  public:
    void bytes(const void* data, size_t count) {
        const auto* const from = static_cast<const unsigned char*>(data);
        for (size_t i = 0; i < count; ++i)
            mValue = (mValue ^ from[i]) * 1099511628211ULL;
    }
    void number(int value) { bytes(&value, sizeof value); }
    uint64_t value() const { return mValue; }

  private:
    uint64_t mValue = 14695981039346656037ULL;
};

float randomOpacity(Random& random) {
    return random.real(-0.1F, 1.1F);
}

std::vector<VFGradient> randomStops(Random& random) {
    std::vector<VFGradient> stops(static_cast<size_t>(random.between(1, 5)));
    float location = 0.0F;
    for (VFGradient& stop : stops) {
        // In braces the order is that of writing.
        stop = {random.next(), random.real(0.0F, 1.0F), location};
        location += random.real(0.0F, 0.5F);
    }
    return stops;
}

VFBitmap randomPattern(Random& random) {
    const int width = random.between(1, 9);
    const int height = random.between(1, 9);
    VFBitmap pattern(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    for (unsigned i = 0; i < pattern.mWidth * pattern.mHeight * 4; ++i)
        pattern.mData[i] = random.byte();
    return pattern;
}

}  // namespace

RandomCaller::RandomCaller(uint64_t seed) : mRandom(seed), mLook(std::make_unique<VFEffect>()) {}

// Every number is drawn in a statement of its own: the order in which a compiler evaluates arguments is
// its own choice, and a seed stands for the same calls everywhere.
void RandomCaller::addEffect() {
    std::vector<VFGradient> stops = randomStops(mRandom);
    const int count = static_cast<int>(stops.size());
    const int glowCount = mRandom.between(-1, count);
    const float angle = mRandom.real(-400.0F, 400.0F);
    const float distance = mRandom.real(0.0F, 8.0F);
    const float scale = mRandom.real(0.0F, 2.5F);
    const float size = mRandom.chance(90) ? mRandom.real(0.0F, 5.0F) : mRandom.real(-3.0F, 12.0F);
    const uint32_t color = mRandom.next();
    const float opacity = randomOpacity(mRandom);
    switch (mRandom.between(0, 9)) {
        case 0:
            mLook->addOuterShadowText(angle, distance, size, color, opacity);
            break;
        case 1:
            mLook->addInnerShadowText(angle, distance, size, color, opacity);
            break;
        case 2:
            mLook->addOuterGlowText(size, color, opacity, glowCount, stops.data());
            break;
        case 3:
            mLook->addInnerGlowText(size, color, opacity, glowCount, stops.data());
            break;
        case 4:
            mLook->addLinearGradientText(angle, scale, opacity, count, stops.data());
            break;
        case 5:
            mLook->addRadialGradientText(scale, opacity, count, stops.data());
            break;
        case 6: {
            VFBitmap pattern = randomPattern(mRandom);
            mLook->addPatternText(&pattern, scale, opacity);
            break;
        }
        case 7:
            mLook->addBevelText(1, size, scale, 0, 0, 2, opacity, angle, angle, color, opacity, color,
                                opacity);
            break;
        default:
            mLook->addStrokeText(size, color, opacity, 0, mRandom.between(0, 2));
            break;
    }
}

void RandomCaller::changeLook() {
    const int choice = mRandom.between(0, 15);
    if (choice == 0) mLook = std::make_unique<VFEffect>();
    if (choice == 1) mLook->cleanAllEffect();
    if (choice == 2 || choice == 3) mLook = std::make_unique<VFEffect>(*mLook);
    if (choice == 4 || choice == 5) mLook->removeEffect(mRandom.between(0, 8));
    if (choice == 6) mLook->setTextOpacity(randomOpacity(mRandom));
    if (choice == 7) mLook->clearTextOpacity();
    for (int more = mRandom.between(1, 4); more > 0; --more)
        addEffect();
}

void RandomCaller::renderGlyph(int width, int height) {
    const int glyphWidth = mRandom.between(1, 20);
    const int glyphHeight = mRandom.between(1, 20);
    const int x = mRandom.between(-8, width);
    const int y = mRandom.between(-8, height);
    literal::Mask mask = noiseMask(mRandom, glyphWidth, glyphHeight, mRandom.between(0, 90));
    if (mRandom.chance(70)) {
        const auto radius = static_cast<float>(mRandom.between(1, 10));
        mask = discMask(glyphWidth, glyphHeight, radius, radius, radius, mRandom.chance(70));
    }
    VFGlyph glyph{mask.bytes.data(), static_cast<unsigned short>(glyphWidth),
                  static_cast<unsigned short>(glyphHeight)};
    mLook->renderEffectLayer(x, y, &glyph);
}

uint64_t RandomCaller::run() {
    changeLook();
    Hash hash;
    char* const key = mLook->getMapKey(mRandom.next());
    hash.bytes(key, std::strlen(key));
    delete[] key;
    for (const int margin : {mLook->getLeftOffset(), mLook->getRightOffset(), mLook->getTopOffset(),
                             mLook->getBottomOffset()}) {
        hash.number(margin);
    }

    const int width = mRandom.between(1, 64);
    const int height = mRandom.between(1, 40);
    VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    std::memset(picture.mData, mRandom.chance(50) ? 0 : 255, picture.mWidth * picture.mHeight * 4);
    mLook->initEffect(width, height);
    mLook->setDstBitmap(&picture);
    for (int glyphs = mRandom.between(0, 4); glyphs > 0; --glyphs)
        renderGlyph(width, height);
    mLook->doEffectPostProcessing();
    const VFRect& box = *mLook->getTextRect();
    for (const int side : {box.mLeft, box.mTop, box.mRight, box.mBottom})
        hash.number(side);
    // A run may be given up: the next initEffect drops its layers.
    if (mRandom.chance(90)) mLook->compositeLayers(&picture);
    hash.bytes(picture.mData, picture.mWidth * picture.mHeight * 4);
    return hash.value();
}

}  // namespace vorel_test
