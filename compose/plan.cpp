#include "compose/plan.h"

#include <voreleffect/VFEffect.h>

#include <algorithm>
#include <array>
#include <cstddef>
#include <iterator>

namespace vorelcompose {
namespace {

using VFontEffect::VFECore;
using VFontEffect::VFEffect;
using VFontEffect::VFStrokeProperty;
using vorelstyle::kStrokeType;
using vorelstyle::kTextType;
using vorelstyle::Look;
using vorelstyle::Place;
using vorelstyle::Span;
using vorelstyle::Stack;
using vorelstyle::StackedLook;

constexpr int kCentred = 0;  ///< as VFEffect::addStrokeText has the positions

bool hasCentredStroke(VFEffect& effects) {
    VFECore* const stroke = effects.getEffect(kStrokeType);
    return stroke != nullptr &&
           static_cast<VFStrokeProperty*>(stroke->getProperty())->mPosition == kCentred;
}

/// The types for which `wanted` holds, those added last first.
template <typename Test>
std::vector<int> latestFirst(const std::vector<int>& added, Test wanted) {
    std::vector<int> types;
    std::copy_if(added.rbegin(), added.rend(), std::back_inserter(types), wanted);
    return types;
}

/// The kinds of effects in a sentence, by the numbers of VFEffect.h.
std::string wordsOf(int type) {
    constexpr std::array<const char*, 13> kWords{
        "",         "outer shadow",    "inner shadow",    "outer glow", "inner glow", "bevel", "emboss",
        "gradient", "radial gradient", "reserved stroke", "stroke",     "pattern",    "fill"};
    return kWords.at(static_cast<size_t>(type));
}

/// How what is outside the glyphs comes about.
std::string originOf(int type) {
    constexpr int kOuterShadowType = 1;
    if (type == kOuterShadowType) return "A shadow falls on what is behind the letters";
    if (type == kStrokeType) return "An outline outside is made of the whole letters, widened";
    return "A glow shines from behind the letters";
}

/// Why an effect lies where it does, as the beginning of a sentence.
std::string reasonOf(int type, EffectPlace place, bool layered) {
    switch (place) {
        case EffectPlace::text:
            return layered
                       ? "The fill lies beneath all that is on the text, wherever it is added; what is "
                         "outside the letters is in a layer of its own"
                       : "The fill lies beneath all that is on the text, which it cuts to the shape of "
                         "the letters, and over all that is beneath it, wherever it is added";
        case EffectPlace::across:
            return "A centred stroke covers both sides of the edge: one half of it lies on the text, "
                   "the "
                   "other outside, each over what was added before it";
        case EffectPlace::outside:
            return originOf(type) +
                   "; all that is outside the text has a layer of its own here, which is cut out where "
                   "the "
                   "letters are, so it neither covers nor shines through what is on the text";
        case EffectPlace::beneath:
            return originOf(type) +
                   ", so it lies beneath the text: it is seen around the letters, and through a fill "
                   "that is "
                   "translucent itself";
        default:
            return "What is on the text lies over the fill, cut to the shape of the letters: nothing "
                   "that "
                   "is beneath or outside the text covers it";
    }
}

bool meet(EffectPlace one, EffectPlace other) {
    if (one == EffectPlace::text || other == EffectPlace::text) return false;
    return one == other || one == EffectPlace::across || other == EffectPlace::across;
}

/// Over which effect of its group one lies, or else beneath which; nothing when it is alone.
std::string orderOf(const std::vector<PlannedEffect>& effects, size_t at) {
    const auto isMet = [&](const PlannedEffect& other) { return meet(other.place, effects[at].place); };
    const auto own = effects.begin() + static_cast<std::ptrdiff_t>(at);
    const auto below = std::find_if(own + 1, effects.end(), isMet);
    if (below != effects.end())
        return "; it was added after the " + wordsOf(below->type) + " and so lies over it";
    const auto above = std::find_if(std::make_reverse_iterator(own), effects.rend(), isMet);
    if (above == effects.rend()) return "";
    return "; the " + wordsOf(above->type) + " was added after it and so lies over it";
}

EffectPlace placeOf(int type, bool layered, VFEffect& planned) {
    if (type == kTextType) return EffectPlace::text;
    if (type == kStrokeType && hasCentredStroke(planned)) return EffectPlace::across;
    if (!planned.isUnderEffect(planned.getEffect(type))) return EffectPlace::on;
    return layered ? EffectPlace::outside : EffectPlace::beneath;
}

std::string reasonOfLayers(VFEffect& effects, bool layered) {
    if (!layered) return "the text is opaque, and no stroke is centred";
    return effects.getTextOpacity() < 1.0F ? "the text is translucent"
                                           : "a stroke is centred on the edge";
}

/// What is one run, and what that makes of the look.
std::string reasonOfSpan(Span span) {
    const std::string name(vorelstyle::kSpanNames[static_cast<size_t>(span)]);
    if (span == Span::block) return "The text is painted as one block";
    return "Each " + name +
           " is painted alone, with a box of its own for gradients and patterns, later ones over "
           "earlier ones";
}

std::string reasonOfPlace(const Stack& stack, size_t at) {
    const Place& place = stack.looks()[at].place;
    std::string reason = reasonOfSpan(place.span);
    if (place.offsetX != 0 || place.offsetY != 0) {
        reason += "; the look is moved by " + std::to_string(place.offsetX) + ", " +
                  std::to_string(place.offsetY) + " pixels as a whole";
    }
    if (at > 0)
        reason += "; all of it lies over the looks before it, none of its effects between theirs";
    return reason + ".";
}

StackedPlan stackedPlanOf(const Stack& stack, size_t at) {
    const StackedLook& stacked = stack.looks()[at];
    const auto place = vorelstyle::keyFragments(placeFragment(stacked.place));
    return {planOf(stacked.look), place.front().meaning, reasonOfPlace(stack, at)};
}

}  // namespace

std::string_view placeName(EffectPlace place) {
    switch (place) {
        case EffectPlace::text:
            return "the text";
        case EffectPlace::across:
            return "across the edge";
        case EffectPlace::outside:
            return "outside the text";
        case EffectPlace::beneath:
            return "beneath the text";
        default:
            return "on the text";
    }
}

LookPlan planOf(const Look& look) {
    VFEffect planned(look.effects());
    planned.initEffect(0, 0);
    LookPlan plan;
    plan.layered = planned.getTextOpacity() < 1.0F || hasCentredStroke(planned);
    plan.reason = reasonOfLayers(planned, plan.layered);
    const auto add = [&](int type) {
        const EffectPlace place = placeOf(type, plan.layered, planned);
        plan.effects.push_back({type, place, reasonOf(type, place, plan.layered)});
    };
    const auto isBeneath = [&](int type) {
        return placeOf(type, plan.layered, planned) == EffectPlace::beneath;
    };
    // The text fill clips what is painted before it to the glyphs; what lies beneath comes after it.
    // With a layer for the effects outside the glyphs there is no such limit.
    for (const int type :
         latestFirst(look.added(), [&](int t) { return t != kTextType && !isBeneath(t); }))
        add(type);
    add(kTextType);
    for (const int type : latestFirst(look.added(), isBeneath))
        add(type);
    for (size_t i = 0; i < plan.effects.size(); ++i)
        plan.effects[i].reason += orderOf(plan.effects, i) + ".";
    return plan;
}

std::vector<StackedPlan> plansOf(const Stack& stack) {
    std::vector<StackedPlan> plans;
    for (size_t at = 0; at < stack.looks().size(); ++at)
        plans.push_back(stackedPlanOf(stack, at));
    return plans;
}

}  // namespace vorelcompose
