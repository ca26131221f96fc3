#pragma once

#include <cstdint>
#include <memory>

#include "tests/support/random.h"
#include "voreleffect/VFEffect.h"

namespace vorel_test {

/// A caller of the library that keeps one look: between runs it adds, updates and removes effects,
/// replaces the look by a copy or a new one, changes the opacity and asks for keys. Everything follows
/// from the seed.
class RandomCaller {
  public:
    explicit RandomCaller(uint64_t seed);

    /// One change of the look and one run on small layers. Returns a hash of the picture, the key,
    /// the margins and the text box.
    uint64_t run();

  private:
    void changeLook();
    void renderGlyph(int width, int height);

    Random mRandom;
    std::unique_ptr<VFontEffect::VFEffect> mLook;
};

}  // namespace vorel_test
