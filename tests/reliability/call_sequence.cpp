#include "call_sequence.h"

#include <algorithm>
#include <string>
#include <vector>

#include "allocation_watch.h"
#include "random_effect.h"
#include "tests/support/compare.h"
#include "tests/support/engine.h"

namespace vorel_test {

using literal::Engine;
using literal::Picture;
using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
using VFontEffect::VFRect;

CallSequence::CallSequence(uint64_t seed, Memory memory) : mRandom(seed), mMemory(memory) {
    constexpr int kSizes[][2] = {{40, 28}, {64, 23}, {7, 33}};
    for (size_t i = 0; i < mShared.size(); ++i) {
        const auto [width, height] = kSizes[i];
        mShared[i].real = VFBitmap(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
        mShared[i].literal = {width, height, bytesOf(mShared[i].real)};
    }
    for (Look& look : mLooks) {
        look.real = std::make_unique<VFEffect>();
        look.literal = std::make_unique<Engine>();
    }
}

/// Makes a call of the library. Returns whether it was refused memory.
template <class Call>
bool CallSequence::refusedIn(Call call) {
    if (mMemory == Memory::kPlenty || mRandom.chance(50)) {
        call();
        return false;
    }
    const long first = mRandom.between(1, 12);
    const Refusal refusal = mRandom.chance(50) ? Refusal::kOnce : Refusal::kFromThenOn;
    bool refused = false;
    {
        const RefusedMemory no(first, refusal);
        call();
        refused = RefusedMemory::refused();
    }
    mRefusedCalls += refused ? 1 : 0;
    return refused;
}

/// Makes a call that may be made again, and after a refusal is.
template <class Call>
void CallSequence::retried(Call call) {
    if (refusedIn(call)) call();
}

CallSequence::Shared& CallSequence::anyShared() {
    return mShared[static_cast<size_t>(mRandom.between(0, static_cast<int>(mShared.size()) - 1))];
}

// --- The look ---------------------------------------------------------------------------------------

void CallSequence::addEffect(Look& look) {
    RandomEffect effect(mRandom);
    retried([&] { effect.addTo(*look.real); });
    effect.addTo(*look.literal);
}

void CallSequence::change(Look& look) {
    const int id = mRandom.between(0, 8);
    const float opacity = randomOpacity(mRandom);
    switch (mRandom.between(0, 5)) {
        case 0:
            look.real->cleanAllEffect();
            look.literal->releaseEffect();
            break;
        case 1:
            look.real->clearTextOpacity();
            look.literal->clearTextOpacity();
            break;
        case 2:
        case 3:
            look.real->setTextOpacity(opacity);
            look.literal->setTextOpacity(opacity);
            break;
        default:
            look.real->removeEffect(id);
            look.literal->removeEffect(id);
            break;
    }
}

/// A new look, or a copy of another one: the look is copied, its run is not.
void CallSequence::replace(Look& look) {
    const Look& from =
        mLooks[static_cast<size_t>(mRandom.between(0, static_cast<int>(mLooks.size()) - 1))];
    Look made;
    if (mRandom.chance(30)) {
        made.real = std::make_unique<VFEffect>();
        made.literal = std::make_unique<Engine>();
    } else {
        retried([&] { made.real = std::make_unique<VFEffect>(*from.real); });
        made.literal = std::make_unique<Engine>(*from.literal);
    }
    look = std::move(made);
}

// --- Runs -------------------------------------------------------------------------------------------

/// Layers of the size of a destination, or of none.
void CallSequence::plan(Look& look) {
    const Shared& like = anyShared();
    const bool odd = mRandom.chance(20);
    look.width = odd ? mRandom.between(0, 50) : like.literal.width;
    look.height = odd ? mRandom.between(0, 50) : like.literal.height;
    retried([&] { look.real->initEffect(look.width, look.height); });
    look.literal->initEffect(look.width, look.height);
    look.destination = nullptr;
}

/// Sets the destination, mostly to one of the size of the layers.
void CallSequence::direct(Look& look) {
    look.destination = &anyShared();
    for (Shared& shared : mShared) {
        const bool fits = shared.literal.width == look.width && shared.literal.height == look.height;
        if (fits && mRandom.chance(80)) look.destination = &shared;
    }
    if (mRandom.chance(5)) look.destination = nullptr;
    const bool none = look.destination == nullptr;
    look.real->setDstBitmap(none ? nullptr : &look.destination->real);
    look.literal->setDstBitmap(none ? nullptr : &look.destination->literal);
}

void CallSequence::renderGlyph(Look& look) {
    const int width = mRandom.between(0, 20);
    const int height = mRandom.between(0, 20);
    const int x = mRandom.between(-8, 60);
    const int y = mRandom.between(-8, 40);
    literal::Mask mask = randomGlyph(mRandom, width, height);
    VFGlyph glyph{mask.bytes.data(), static_cast<unsigned short>(width),
                  static_cast<unsigned short>(height)};
    const bool none = mRandom.chance(3);
    look.real->renderEffectLayer(x, y, none ? nullptr : &glyph);
    look.literal->renderEffectLayer(x, y, none ? nullptr : &mask);
}

void CallSequence::postProcess(Look& look) {
    const bool layered = isLayered(*look.real);
    Shared* const target = look.destination;
    const std::vector<uint8_t> before =
        target != nullptr ? bytesOf(target->real) : std::vector<uint8_t>();
    if (!refusedIn([&] { look.real->doEffectPostProcessing(); })) {
        look.literal->doEffectPostProcessing();
        return;
    }
    // Some effects have painted and some have not. In the destination that is undone; in the outer layer
    // it cannot be.
    std::copy(before.begin(), before.end(), target != nullptr ? target->real.mData : nullptr);
    if (!layered) look.real->doEffectPostProcessing();
    Picture scratch = target != nullptr ? target->literal : Picture{};
    if (layered) look.literal->setDstBitmap(&scratch);
    look.literal->doEffectPostProcessing();
    if (layered) composite(look, nullptr);
}

/// Ends the run, in layered mode by merging into a picture.
void CallSequence::composite(Look& look, Shared* into) {
    look.real->compositeLayers(into != nullptr ? &into->real : nullptr);
    Picture none;
    const bool merges = into != nullptr && look.literal->hasMask() &&
                        into->literal.width == look.width && into->literal.height == look.height;
    look.literal->compositeLayers(merges ? into->literal : none);
    look.destination = nullptr;
}

void CallSequence::wholeRun(Look& look) {
    plan(look);
    direct(look);
    for (int glyphs = mRandom.between(0, 3); glyphs > 0; --glyphs)
        renderGlyph(look);
    postProcess(look);
    composite(look, look.destination);
}

// --- Comparison -------------------------------------------------------------------------------------

::testing::AssertionResult CallSequence::sameKey(Look& look) {
    const uint32_t color = mRandom.next();
    std::string key;
    retried([&] {
        char* const bytes = look.real->getMapKey(color);
        if (bytes != nullptr) key = bytes;
        delete[] bytes;
    });
    if (key == look.literal->getMapKey(color)) return ::testing::AssertionSuccess();
    return ::testing::AssertionFailure() << "the keys differ";
}

::testing::AssertionResult CallSequence::same(Look& look) const {
    for (const Shared& shared : mShared) {
        const Picture& expected = shared.literal;
        auto painted =
            sameBytes(expected.bytes.data(), shared.real.mData, expected.width, expected.height, 4);
        if (!painted) return painted << ", of the destination " << expected.width << " pixels wide";
    }
    const literal::Box box = look.literal->textRect();
    if (sidesOf(*look.real->getTextRect()) != std::vector<int>{box.left, box.top, box.right, box.bottom})
        return ::testing::AssertionFailure() << "the text boxes differ";
    const literal::Margins margins = look.literal->margins();
    if (look.real->getLeftOffset() != margins.left || look.real->getRightOffset() != margins.right ||
        look.real->getTopOffset() != margins.top || look.real->getBottomOffset() != margins.bottom)
        return ::testing::AssertionFailure() << "the margins differ";
    if (look.real->hasEffects() != look.literal->hasEffects())
        return ::testing::AssertionFailure() << "one has effects";
    return ::testing::AssertionSuccess();
}

::testing::AssertionResult CallSequence::step() {
    Look& look = mLooks[static_cast<size_t>(mRandom.between(0, static_cast<int>(mLooks.size()) - 1))];
    const int choice = mRandom.between(0, 99);
    if (choice < 25) {
        addEffect(look);
    } else if (choice < 32) {
        change(look);
    } else if (choice < 35) {
        replace(look);
    } else if (choice < 42) {
        plan(look);
    } else if (choice < 52) {
        direct(look);
    } else if (choice < 66) {
        renderGlyph(look);
    } else if (choice < 74) {
        postProcess(look);
    } else if (choice < 80) {
        composite(look, mRandom.chance(80) ? look.destination : &anyShared());
    } else if (choice < 85) {
        auto keys = sameKey(look);
        if (!keys) return keys;
    } else {
        wholeRun(look);
    }
    return same(look);
}

}  // namespace vorel_test
