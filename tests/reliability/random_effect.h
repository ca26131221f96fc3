#pragma once

#include <cstdint>
#include <vector>

#include "tests/support/literal_engine.h"
#include "tests/support/random.h"
#include "voreleffect/VFEffect.h"

namespace vorel_test {

/// The arguments of one random add-call: small sizes, now and then some out of their ranges.
class RandomEffect {
  public:
    explicit RandomEffect(Random& random);

    void addTo(VFontEffect::VFEffect& set);
    void addTo(literal::Engine& set);

  private:
    template <class Set, class Stops, class Tile>
    void add(Set& set, Stops* stops, Tile* tile) const;

    std::vector<literal::Stop> mStops;
    int mGlowStops;  ///< how many of them a glow takes; may be -1
    float mAngle;
    float mDistance;
    float mScale;
    float mSize;
    uint32_t mColor;
    float mOpacity;
    int mCall;  ///< which add-call, 0 to 9; a stroke has two chances
    literal::Tile mTile;
    int mPosition = 0;
    // Made before the call, which then takes no memory but its own.
    std::vector<VFontEffect::VFGradient> mLibraryStops;
    VFontEffect::VFBitmap mLibraryTile;
};

float randomOpacity(Random& random);

/// A disc or noise of up to 20 x 20 pixels.
literal::Mask randomGlyph(Random& random, int width, int height);

}  // namespace vorel_test
