#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "style/vorelstyle.h"

namespace vorelcompose {

/// Where an effect lies relative to the glyphs.
enum class EffectPlace {
    text,     ///< the text's fill itself
    across,   ///< a centred stroke, on both sides of the edge
    outside,  ///< in the outer layer of a layered run, of which the glyphs show nothing
    beneath,  ///< beneath the text in a run without one
    on,       ///< within the glyphs, on their fill
};

/// "the text", "across the edge", "outside the text", "beneath the text", "on the text".
std::string_view placeName(EffectPlace place);

struct PlannedEffect {
    int type;  ///< as VFEffect.h numbers them; effectName names it
    EffectPlace place;
    std::string reason;  ///< one sentence: why it lies there, and over what
};

/// How a look will paint a run.
struct LookPlan {
    bool layered;                        ///< the effects outside the glyphs have a layer of their own
    std::string reason;                  ///< why, or why not: "the text is translucent"
    std::vector<PlannedEffect> effects;  ///< in the order of painting, the topmost first
};

/// The plan of a look. Nothing is painted.
LookPlan planOf(const vorelstyle::Look& look);

/// How a look of a stack will be painted.
struct StackedPlan {
    LookPlan look;
    std::string place;   ///< "moved by 3, -2, by word", in the words of the cache key
    std::string reason;  ///< one sentence: what its offset, its span and its place in the stack do
};

/// Of each look of a stack, the lowest first. Nothing is painted.
std::vector<StackedPlan> plansOf(const vorelstyle::Stack& stack);

}  // namespace vorelcompose
