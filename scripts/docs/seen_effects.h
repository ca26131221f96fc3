#pragma once

/// To be included before a program that people copy, by the option -include: hides one of the effects
/// that the program adds, and paints with every painter twice. See seen_effects.py.
///
/// The environment names the file to which each effect is noted, as its number and its line
/// (ADDED_EFFECTS), and the number of the effect to hide (HIDDEN_EFFECT). One is hidden by the opacity
/// 0, which keeps the margins: else a picture would differ by its size alone.

#include <stdio.h>
#include <stdlib.h>
#include <voreleffect/voreleffect_c.h>

/// The opacity of an effect; 0 when it is the one to hide.
static inline float vorelShownOpacity(int number, const char* file, int line, float opacity) {
    const char* const list = getenv("ADDED_EFFECTS");
    const char* const hidden = getenv("HIDDEN_EFFECT");
    FILE* const added = list == NULL ? NULL : fopen(list, "a");
    if (added != NULL) {
        fprintf(added, "%d %s:%d\n", number, file, line);
        fclose(added);
    }
    return hidden != NULL && atoi(hidden) == number ? 0.0F : opacity;
}

#define VOREL_SHOWN(opacity) vorelShownOpacity(__COUNTER__, __FILE__, __LINE__, opacity)

#define vorel_look_outer_shadow(l, angle, distance, size, color, opacity) \
    vorel_look_outer_shadow(l, angle, distance, size, color, VOREL_SHOWN(opacity))
#define vorel_look_inner_shadow(l, angle, distance, size, color, opacity) \
    vorel_look_inner_shadow(l, angle, distance, size, color, VOREL_SHOWN(opacity))
#define vorel_look_outer_glow(l, size, color, opacity, stops, count) \
    vorel_look_outer_glow(l, size, color, VOREL_SHOWN(opacity), stops, count)
#define vorel_look_inner_glow(l, size, color, opacity, stops, count) \
    vorel_look_inner_glow(l, size, color, VOREL_SHOWN(opacity), stops, count)
#define vorel_look_linear_gradient(l, angle, scale, opacity, stops, count) \
    vorel_look_linear_gradient(l, angle, scale, VOREL_SHOWN(opacity), stops, count)
#define vorel_look_radial_gradient(l, scale, opacity, stops, count) \
    vorel_look_radial_gradient(l, scale, VOREL_SHOWN(opacity), stops, count)
#define vorel_look_stroke(l, size, color, opacity, position) \
    vorel_look_stroke(l, size, color, VOREL_SHOWN(opacity), position)
#define vorel_look_pattern(l, pixels, scale, opacity) \
    vorel_look_pattern(l, pixels, scale, VOREL_SHOWN(opacity))

#ifdef __cplusplus

#include <voreleffect/look.h>
#include <voreleffect/voreleffect.h>

#include <cstddef>
#include <cstdlib>
#include <optional>
#include <vector>

namespace VFontEffect {

/// The effect; clear when it is the one to hide.
template <class AnyEffect>
AnyEffect shownEffect(int number, const char* file, int line, const AnyEffect& effect) {
    return vorelShownOpacity(number, file, line, 1) > 0 ? effect : effect.opacity(0);
}

/// Ends the program when the second picture is not the first.
class PaintsTwice : public Painter {
  public:
    using Painter::Painter;

    std::optional<Picture> paint(Glyphs glyphs) {
        const std::optional<Picture> first = Painter::paint(glyphs);
        std::optional<Picture> second = Painter::paint(glyphs);
        if (bytesOf(first) != bytesOf(second)) std::abort();
        return second;
    }
    std::optional<Box> paint(Glyphs glyphs, const PictureView& view, int x = 0, int y = 0) {
        const auto rowBytes = static_cast<std::ptrdiff_t>(view.width) * 4;
        const std::ptrdiff_t stride = view.stride == 0 ? rowBytes : view.stride;
        unsigned char* const end = view.data + stride * (view.height - 1) + rowBytes;
        const std::vector<unsigned char> before(view.data, end);
        Painter::paint(glyphs, view, x, y);
        const std::vector<unsigned char> first(view.data, end);
        for (std::size_t i = 0; i < before.size(); ++i)
            view.data[i] = before[i];
        const std::optional<Box> touched = Painter::paint(glyphs, view, x, y);
        if (first != std::vector<unsigned char>(view.data, end)) std::abort();
        return touched;
    }

  private:
    static std::vector<unsigned char> bytesOf(const std::optional<Picture>& picture) {
        if (!picture || picture->isEmpty()) return {};
        return {picture->data(), picture->data() + picture->stride() * picture->height()};
    }
};

}  // namespace VFontEffect

#define Painter PaintsTwice
#define add(...) add(shownEffect(__COUNTER__, __FILE__, __LINE__, __VA_ARGS__))
#define addOuterShadowText(angle, distance, size, color, opacity) \
    addOuterShadowText(angle, distance, size, color, VOREL_SHOWN(opacity))
#define addInnerShadowText(angle, distance, size, color, opacity) \
    addInnerShadowText(angle, distance, size, color, VOREL_SHOWN(opacity))
#define addOuterGlowText(size, color, opacity, count, stops) \
    addOuterGlowText(size, color, VOREL_SHOWN(opacity), count, stops)
#define addInnerGlowText(size, color, opacity, count, stops) \
    addInnerGlowText(size, color, VOREL_SHOWN(opacity), count, stops)
#define addLinearGradientText(angle, scale, opacity, count, stops) \
    addLinearGradientText(angle, scale, VOREL_SHOWN(opacity), count, stops)
#define addRadialGradientText(scale, opacity, count, stops) \
    addRadialGradientText(scale, VOREL_SHOWN(opacity), count, stops)
#define addStrokeText(size, color, opacity, style, position) \
    addStrokeText(size, color, VOREL_SHOWN(opacity), style, position)
#define addPatternText(bitmap, scale, opacity) addPatternText(bitmap, scale, VOREL_SHOWN(opacity))

#endif
