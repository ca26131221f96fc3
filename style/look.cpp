#include "style/look.h"

#include <voreleffect/VFBitmap.h>

#include <memory>
#include <new>
#include <utility>
#include <variant>

#include "style/resolved_style.h"

namespace vorelstyle {
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGradient;

constexpr unsigned int kNoCore = 0xFFFFFFFFU;

int countOf(const Stops& stops) {
    return static_cast<int>(stops.size());
}

/// The library reads stops without changing them, but takes a pointer to mutable ones.
VFGradient* dataOf(const Stops& stops) {
    return const_cast<VFGradient*>(stops.data());
}

/// Makes the add-call of one effect and returns its result.
class AddCall {
  public:
    AddCall(VFEffect& effects, uint32_t fill, float fillOpacity, const LoadImage& load, Note note)
        : mEffects(effects),
          mFill(fill),
          mFillOpacity(fillOpacity),
          mLoad(load),
          mNote(std::move(note)) {}

    unsigned int operator()(const OuterShadow& e) const {
        return mEffects.addOuterShadowText(e.angle, e.distance.value, e.size.value, e.color, e.opacity);
    }
    unsigned int operator()(const InnerShadow& e) const {
        return mEffects.addInnerShadowText(e.angle, e.distance.value, e.size.value, e.color, e.opacity);
    }
    unsigned int operator()(const OuterGlow& e) const {
        return mEffects.addOuterGlowText(e.size.value, e.color, e.opacity, countOf(e.gradient),
                                         dataOf(e.gradient));
    }
    unsigned int operator()(const InnerGlow& e) const {
        return mEffects.addInnerGlowText(e.size.value, e.color, e.opacity, countOf(e.gradient),
                                         dataOf(e.gradient));
    }
    unsigned int operator()(const Bevel& e) const { return addRelief(&VFEffect::addBevelText, e); }
    unsigned int operator()(const Emboss& e) const { return addRelief(&VFEffect::addEmbossText, e); }
    unsigned int operator()(const LinearGradient& e) const {
        return mEffects.addLinearGradientText(e.angle, e.scale, e.opacity, countOf(e.gradient),
                                              dataOf(e.gradient));
    }
    unsigned int operator()(const RadialGradient& e) const {
        return mEffects.addRadialGradientText(e.scale, e.opacity, countOf(e.gradient),
                                              dataOf(e.gradient));
    }
    unsigned int operator()(const Stroke& e) const {
        return mEffects.addStrokeText(e.size.value, e.color, e.opacity, e.strokeStyle, e.position);
    }
    unsigned int operator()(const Pattern& e) const {
        PatternImage image = patternImage(e, mLoad);
        VFBitmap bitmap(static_cast<unsigned int>(image.width), static_cast<unsigned int>(image.height),
                        image.pixels.data(), 4);
        return mEffects.addPatternText(&bitmap, patternScale(e, image, mNote), e.opacity);
    }
    unsigned int operator()(const TextFill&) const { return mEffects.addText(mFill, mFillOpacity); }

  private:
    template <typename Call>
    unsigned int addRelief(Call call, const Relief& e) const {
        return (mEffects.*call)(e.style, e.size.value, e.depth, e.technique, e.direction, e.soften,
                                e.opacity, e.angle, e.altitude, e.highlightColor, e.highlightOpacity,
                                e.shadowColor, e.shadowOpacity);
    }

    VFEffect& mEffects;
    uint32_t mFill;
    float mFillOpacity;
    const LoadImage& mLoad;
    Note mNote;
};

float fillOpacityOf(const LookStyle& look, float textOpacity) {
    for (const Effect& effect : look.effects) {
        if (const auto* text = std::get_if<TextFill>(&effect)) return text->opacity * textOpacity;
    }
    return textOpacity;
}

}  // namespace

Look::Look(const LookStyle& look, uint32_t fill, float textOpacity, const LoadImage& load)
    : mFillOpacity(fillOpacityOf(look, textOpacity)) {
    requireResolved(look);
    mEffects.setTextOpacity(textOpacity);
    const AddCall add(mEffects, fill, mFillOpacity, load,
                      [this](const std::string& line) { mNotes.push_back(line); });
    for (const Effect& effect : look.effects) {
        if (std::visit(add, effect) == kNoCore) {
            mUnpainted.emplace_back(effectName(effect));
        } else {
            mAdded.push_back(effectType(effect));
        }
    }
    const bool hasFill = hasTextFill(look);
    if (!hasFill) mAdded.push_back(kTextType);
    const std::unique_ptr<char[]> key(hasFill ? mEffects.getMapKey() : mEffects.getMapKey(fill));
    if (!key) throw std::bad_alloc();
    mKey = key.get();
}

}  // namespace vorelstyle
