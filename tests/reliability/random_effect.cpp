#include "random_effect.h"

#include <algorithm>
#include <cstddef>

#include "tests/support/core_compare.h"
#include "tests/support/mask_gallery.h"

namespace vorel_test {
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;

std::vector<literal::Stop> randomStops(Random& random) {
    std::vector<literal::Stop> stops(static_cast<size_t>(random.between(1, 5)));
    float location = 0.0F;
    for (literal::Stop& stop : stops) {
        // In braces the order is that of writing.
        stop = {random.next(), random.real(0.0F, 1.0F), location};
        location += random.real(0.0F, 0.5F);
    }
    return stops;
}

literal::Tile randomTile(Random& random) {
    const int width = random.between(1, 9);
    const int height = random.between(1, 9);
    literal::Tile tile{width, height, std::vector<uint8_t>(static_cast<size_t>(width * height * 4))};
    for (uint8_t& byte : tile.bytes)
        byte = random.byte();
    return tile;
}

VFBitmap bitmapOf(const literal::Tile& tile) {
    VFBitmap bitmap(static_cast<unsigned>(tile.width), static_cast<unsigned>(tile.height), 4);
    std::copy(tile.bytes.begin(), tile.bytes.end(), bitmap.mData);
    return bitmap;
}

constexpr int kPatternCall = 6;
constexpr int kBevelCall = 7;

}  // namespace

float randomOpacity(Random& random) {
    return random.real(-0.1F, 1.1F);
}

literal::Mask randomGlyph(Random& random, int width, int height) {
    literal::Mask mask = noiseMask(random, width, height, random.between(0, 90));
    if (random.chance(70)) {
        const auto radius = static_cast<float>(random.between(1, 10));
        mask = discMask(width, height, radius, radius, radius, random.chance(70));
    }
    return mask;
}

// Every number is drawn in a statement of its own: the order in which a compiler evaluates arguments is
// its own choice, and a seed stands for the same calls everywhere.
RandomEffect::RandomEffect(Random& random) : mStops(randomStops(random)) {
    mGlowStops = random.between(-1, static_cast<int>(mStops.size()));
    mAngle = random.real(-400.0F, 400.0F);
    mDistance = random.real(0.0F, 8.0F);
    mScale = random.real(0.0F, 2.5F);
    mSize = random.chance(90) ? random.real(0.0F, 5.0F) : random.real(-3.0F, 12.0F);
    mColor = random.next();
    mOpacity = randomOpacity(random);
    mCall = random.between(0, 9);
    if (mCall == kPatternCall) mTile = randomTile(random);
    if (mCall > kBevelCall) mPosition = random.between(0, 2);
    mLibraryStops = libraryStops(mStops);
    mLibraryTile = bitmapOf(mTile);
}

/// `stops` and `tile` are what the set takes for them.
template <class Set, class Stops, class Tile>
void RandomEffect::add(Set& set, Stops* stops, Tile* tile) const {
    const auto count = static_cast<int>(mStops.size());
    switch (mCall) {
        case 0:
            set.addOuterShadowText(mAngle, mDistance, mSize, mColor, mOpacity);
            break;
        case 1:
            set.addInnerShadowText(mAngle, mDistance, mSize, mColor, mOpacity);
            break;
        case 2:
            set.addOuterGlowText(mSize, mColor, mOpacity, mGlowStops, stops);
            break;
        case 3:
            set.addInnerGlowText(mSize, mColor, mOpacity, mGlowStops, stops);
            break;
        case 4:
            set.addLinearGradientText(mAngle, mScale, mOpacity, count, stops);
            break;
        case 5:
            set.addRadialGradientText(mScale, mOpacity, count, stops);
            break;
        case kPatternCall:
            set.addPatternText(tile, mScale, mOpacity);
            break;
        default:
            set.addStrokeText(mSize, mColor, mOpacity, 0, mPosition);
            break;
    }
}

void RandomEffect::addTo(VFEffect& set) {
    if (mCall == kBevelCall) {
        set.addBevelText(1, mSize, mScale, 0, 0, 2, mOpacity, mAngle, mAngle, mColor, mOpacity, mColor,
                         mOpacity);
        return;
    }
    add(set, mLibraryStops.data(), &mLibraryTile);
}

void RandomEffect::addTo(literal::Engine& set) {
    if (mCall == kBevelCall) {
        set.addKindWithoutCore();
        return;
    }
    add(set, mStops.data(), &mTile);
}

}  // namespace vorel_test
