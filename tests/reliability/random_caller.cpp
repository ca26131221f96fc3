#include "random_caller.h"

#include <cstddef>
#include <cstring>

#include "random_effect.h"

namespace vorel_test {
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
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

}  // namespace

RandomCaller::RandomCaller(uint64_t seed) : mRandom(seed), mLook(std::make_unique<VFEffect>()) {}

void RandomCaller::changeLook() {
    const int choice = mRandom.between(0, 15);
    if (choice == 0) mLook = std::make_unique<VFEffect>();
    if (choice == 1) mLook->cleanAllEffect();
    if (choice == 2 || choice == 3) mLook = std::make_unique<VFEffect>(*mLook);
    if (choice == 4 || choice == 5) mLook->removeEffect(mRandom.between(0, 8));
    if (choice == 6) mLook->setTextOpacity(randomOpacity(mRandom));
    if (choice == 7) mLook->clearTextOpacity();
    for (int more = mRandom.between(1, 4); more > 0; --more)
        RandomEffect(mRandom).addTo(*mLook);
}

void RandomCaller::renderGlyph(int width, int height) {
    const int glyphWidth = mRandom.between(1, 20);
    const int glyphHeight = mRandom.between(1, 20);
    const int x = mRandom.between(-8, width);
    const int y = mRandom.between(-8, height);
    literal::Mask mask = randomGlyph(mRandom, glyphWidth, glyphHeight);
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
