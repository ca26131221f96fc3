#include "look.h"

#include <voreleffect/VFBitmap.h>

#include <algorithm>
#include <memory>
#include <new>
#include <utility>
#include <variant>

#include "png_io.h"
#include "style_file.h"

namespace vorelpaint {
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

Image readPattern(const Style& style, const Pattern& pattern) {
    try {
        return readPng(style.baseDir / pattern.image);
    } catch (const ToolError& error) {
        throw StyleError(faultPrefix(style.file) + "pattern.image: " + error.what());
    }
}

/// Makes the add-call of one effect and returns its result.
class AddCall {
  public:
    AddCall(VFEffect& effects, const Style& style, uint32_t fill, float textOpacity)
        : mEffects(effects), mStyle(style), mFill(fill), mTextOpacity(textOpacity) {}

    unsigned int operator()(const OuterShadow& e) const {
        return mEffects.addOuterShadowText(e.angle, e.distance, e.size, e.color, e.opacity);
    }
    unsigned int operator()(const InnerShadow& e) const {
        return mEffects.addInnerShadowText(e.angle, e.distance, e.size, e.color, e.opacity);
    }
    unsigned int operator()(const OuterGlow& e) const {
        return mEffects.addOuterGlowText(e.size, e.color, e.opacity, countOf(e.gradient),
                                         dataOf(e.gradient));
    }
    unsigned int operator()(const InnerGlow& e) const {
        return mEffects.addInnerGlowText(e.size, e.color, e.opacity, countOf(e.gradient),
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
        return mEffects.addStrokeText(e.size, e.color, e.opacity, e.strokeStyle, e.position);
    }
    unsigned int operator()(const Pattern& e) const {
        Image image = patternImage(mStyle, e);
        VFBitmap bitmap(static_cast<unsigned int>(image.width), static_cast<unsigned int>(image.height),
                        image.pixels.data(), 4);
        return mEffects.addPatternText(&bitmap, e.scale, e.opacity);
    }
    unsigned int operator()(const TextFill& e) const {
        return mEffects.addText(mFill, e.opacity * mTextOpacity);
    }

  private:
    template <typename Call>
    unsigned int addRelief(Call call, const Relief& e) const {
        return (mEffects.*call)(e.style, e.size, e.depth, e.technique, e.direction, e.soften, e.opacity,
                                e.angle, e.altitude, e.highlightColor, e.highlightOpacity, e.shadowColor,
                                e.shadowOpacity);
    }

    VFEffect& mEffects;
    const Style& mStyle;
    uint32_t mFill;
    float mTextOpacity;
};

}  // namespace

Image patternImage(const Style& style, const Pattern& pattern) {
    Image image = readPattern(style, pattern);
    for (size_t at = 0; at < image.pixels.size(); at += 4) {
        std::rotate(&image.pixels[at], &image.pixels[at + 3], &image.pixels[at] + 4);
    }
    return image;
}

Look::Look(const Style& style, uint32_t fill, float textOpacity) {
    mEffects.setTextOpacity(textOpacity);
    const AddCall add(mEffects, style, fill, textOpacity);
    for (const Effect& effect : style.effects) {
        if (std::visit(add, effect) == kNoCore) {
            mUnpainted.emplace_back(effectName(effect));
        } else {
            mAdded.push_back(effectType(effect));
        }
    }
    const bool filled = hasTextFill(style);
    if (!filled) mAdded.push_back(kTextType);
    const std::unique_ptr<char[]> key(filled ? mEffects.getMapKey() : mEffects.getMapKey(fill));
    if (!key) throw std::bad_alloc();
    mKey = key.get();
}

Margins Look::margins() {
    return {mEffects.getLeftOffset(), mEffects.getTopOffset(), mEffects.getRightOffset(),
            mEffects.getBottomOffset()};
}

Image Look::paint(const TextLayout& text, int padding) {
    Run run(mEffects, {text.inkBox(), margins(), padding});
    run.begin();
    for (size_t i = 0; i < text.glyphCount(); ++i)
        run.draw(text.rasterise(i));
    mEffects.doEffectPostProcessing();
    run.merge();
    return run.picture();
}

}  // namespace vorelpaint
