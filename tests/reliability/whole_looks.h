#pragma once

#include <vector>

#include "tests/support/both_sets.h"
#include "tests/support/mask_gallery.h"

/// A few looks that use all of the library, painted by it and by the literal form.
namespace vorel_test {

enum WholeLook { kEveryEffect, kTranslucent, kCentred, kLargeSizes };
constexpr WholeLook kWholeLooks[] = {kEveryEffect, kTranslucent, kCentred, kLargeSizes};

template <class Set>
void describe(WholeLook look, Set& set, Kit<Set>& kit) {
    const float size = look == kLargeSizes ? 40.0F : 4.0F;
    set.addOuterShadowText(120, 5, size, 0x201008, 0.7F);
    set.addInnerShadowText(300, 2, 3, 0x400000, 0.5F);
    set.addOuterGlowText(size, 0xFFAA00, 0.8F, 3, kit.stops);
    set.addInnerGlowText(3, 0xFFFFFF, 0.4F, 0, nullptr);
    set.addLinearGradientText(30, 1, 0.5F, 3, kit.stops);
    set.addRadialGradientText(1, 0.3F, 2, kit.stops);
    set.addStrokeText(size, 0x00A040, 0.6F, 0, look == kCentred ? 0 : 1);
    set.addPatternText(&kit.tile, 1.5F, 0.5F);
    if (look == kTranslucent) set.setTextOpacity(0.4F);
}

constexpr Stage kWholeStage = {132, 124, 49, 49};

inline literal::Mask wholeMask() {
    return discMask(34, 26, 16.5F, 13.0F, 11.5F, true);
}

/// A whole run of a new set.
template <class Set>
literal::Picture paintedWhole(WholeLook look) {
    Kit<Set> kit;
    Set set;
    describe(look, set, kit);
    return paintedRun(set, wholeMask(), kWholeStage);
}

/// What every run of the look must paint.
inline const literal::Picture& expectedPicture(WholeLook look) {
    static const std::vector<literal::Picture> pictures = [] {
        std::vector<literal::Picture> all;
        for (const WholeLook each : kWholeLooks)
            all.push_back(paintedWhole<literal::Engine>(each));
        return all;
    }();
    return pictures[look];
}

inline bool paintsAsExpected(WholeLook look) {
    return paintedWhole<VFontEffect::VFEffect>(look).bytes == expectedPicture(look).bytes;
}

}  // namespace vorel_test
