#pragma once

#include <gtest/gtest.h>

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>

#include "tests/support/literal_engine.h"
#include "tests/support/random.h"
#include "voreleffect/VFEffect.h"

namespace vorel_test {

/// Random public calls in random order on several sets that share their destinations. The library's sets
/// and literal ones get the same calls. Everything follows from the seed.
class CallSequence {
  public:
    /// Whether the library's calls are refused memory now and then. What a refused call has left undone
    /// is then done again, or, where that cannot be, the run is given up.
    enum class Memory { kPlenty, kRefused };

    CallSequence(uint64_t seed, Memory memory);

    /// One call, and whether all destinations, and what the set says of itself, are those of the literal
    /// form.
    ::testing::AssertionResult step();

    /// Calls so far that were refused memory.
    int refused() const { return mRefusedCalls; }

  private:
    /// A destination in its two forms.
    struct Shared {
        VFontEffect::VFBitmap real;
        literal::Picture literal;
    };

    /// A look in its two forms, the numbers of its open run.
    struct Look {
        std::unique_ptr<VFontEffect::VFEffect> real;
        std::unique_ptr<literal::Engine> literal;
        Shared* destination = nullptr;
        int width = 0;
        int height = 0;
    };

    template <class Call>
    bool refusedIn(Call call);
    template <class Call>
    void retried(Call call);

    Shared& anyShared();
    void addEffect(Look& look);
    void change(Look& look);
    void replace(Look& look);
    void plan(Look& look);
    void direct(Look& look);
    void renderGlyph(Look& look);
    void postProcess(Look& look);
    void composite(Look& look, Shared* into);
    void wholeRun(Look& look);
    ::testing::AssertionResult sameKey(Look& look);
    ::testing::AssertionResult same(Look& look) const;

    Random mRandom;
    Memory mMemory;
    int mRefusedCalls = 0;
    std::array<Shared, 3> mShared;
    std::array<Look, 3> mLooks;
};

}  // namespace vorel_test
