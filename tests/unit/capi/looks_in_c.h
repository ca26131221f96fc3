#pragma once

#include <voreleffect/look.h>
#include <voreleffect/voreleffect_c.h>

#include <algorithm>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/random.h"

/// Looks described twice, in C++ and in C.
namespace vorel_test {

struct FreeHandle {
    void operator()(vorel_look* look) const { vorel_look_free(look); }
    void operator()(vorel_painter* painter) const { vorel_painter_free(painter); }
    void operator()(vorel_picture* picture) const { vorel_picture_free(picture); }
};
using LookHandle = std::unique_ptr<vorel_look, FreeHandle>;
using PainterHandle = std::unique_ptr<vorel_painter, FreeHandle>;
using PictureHandle = std::unique_ptr<vorel_picture, FreeHandle>;

inline LookHandle newLook() {
    vorel_look* look = nullptr;
    vorel_look_new(&look);
    return LookHandle(look);
}

inline PainterHandle newPainter(const std::vector<vorel_look*>& looks) {
    vorel_painter* painter = nullptr;
    vorel_painter_new(looks.data(), looks.size(), &painter);
    return PainterHandle(painter);
}

/// Empty where the key is refused.
inline std::string keyOf(const vorel_look* look) {
    size_t length = 0;
    if (vorel_look_key(look, nullptr, 0, &length) != VOREL_OK) return {};
    std::string key(length, '\0');
    return vorel_look_key(look, key.data(), length, &length) == VOREL_OK ? key : std::string();
}

inline std::vector<vorel_glyph> inC(const std::vector<VFontEffect::Glyph>& glyphs) {
    std::vector<vorel_glyph> list;
    for (const VFontEffect::Glyph& g : glyphs)
        list.push_back({g.x, g.y, g.coverage, g.width, g.height, g.stride});
    return list;
}

inline vorel_view inC(const VFontEffect::PictureView& view) {
    const int32_t order = view.order == VFontEffect::PixelOrder::bgra ? VOREL_BGRA : VOREL_RGBA;
    return {view.data, view.width, view.height, view.stride, order};
}

inline std::vector<vorel_stop> inC(const std::vector<VFontEffect::Stop>& stops) {
    std::vector<vorel_stop> list;
    for (const VFontEffect::Stop& stop : stops)
        list.push_back({stop.color.value, stop.opacity, stop.place});
    return list;
}

/// One look in both languages.
struct LookInBoth {
    VFontEffect::Look look;
    LookHandle handle = newLook();
};

/// Hands random numbers to both, among them some out of range, and some that are no numbers.
class RandomInBoth {
  public:
    RandomInBoth(Random& random, LookInBoth& both) : mRandom(random), mBoth(both) {}

    void tellFill() {
        const unsigned value = mRandom.next();
        const float o = opacity();
        mBoth.look.fill(VFontEffect::rgb(value), o);
        mIsGood = mIsGood && vorel_look_fill(c(), value, o) == VOREL_OK;
        if (mRandom.chance(30)) {
            const float ofText = opacity();
            mBoth.look.textOpacity(ofText);
            mIsGood = mIsGood && vorel_look_text_opacity(c(), ofText) == VOREL_OK;
        }
        if (mRandom.chance(80)) return;
        mBoth.look.noFill();
        mIsGood = mIsGood && vorel_look_no_fill(c()) == VOREL_OK;
    }

    void addEffect() {
        switch (mRandom.between(0, 7)) {
            case 0:
                return addShadow<VFontEffect::OuterShadow>(vorel_look_outer_shadow);
            case 1:
                return addShadow<VFontEffect::InnerShadow>(vorel_look_inner_shadow);
            case 2:
                return addGlow<VFontEffect::OuterGlow>(vorel_look_outer_glow);
            case 3:
                return addGlow<VFontEffect::InnerGlow>(vorel_look_inner_glow);
            case 4:
                return addLinear();
            case 5:
                return addRadial();
            case 6:
                return addStroke();
            default:
                return addPattern();
        }
    }

    /// Whether the C face has taken all of it.
    bool isGood() const { return mIsGood; }

  private:
    vorel_look* c() const { return mBoth.handle.get(); }
    float number(float low, float high) {
        if (mRandom.chance(2)) return std::numeric_limits<float>::quiet_NaN();
        if (mRandom.chance(2)) return -std::numeric_limits<float>::infinity();
        return mRandom.real(low, high);
    }
    float opacity() { return mRandom.chance(40) ? 1.0F : number(-0.1F, 1.1F); }
    float size() { return number(-1, 9); }
    std::vector<VFontEffect::Stop> stops() {
        std::vector<VFontEffect::Stop> list;
        for (int i = mRandom.chance(3) ? 300 : mRandom.between(0, 4); i > 0; --i)
            list.push_back({VFontEffect::rgb(mRandom.next()), opacity(), number(0, 1)});
        return list;
    }
    void add(const VFontEffect::Effect& effect, vorel_status status) {
        mBoth.look.add(effect);
        mIsGood = mIsGood && status == VOREL_OK;
    }

    template <class Shadow, class Call>
    void addShadow(Call call) {
        const float a = number(-400, 400);
        const float d = size();
        const float s = size();
        const unsigned value = mRandom.next();
        const float o = opacity();
        add(Shadow(VFontEffect::rgb(value)).angle(a).distance(d).size(s).opacity(o),
            call(c(), a, d, s, value, o));
    }
    template <class Glow, class Call>
    void addGlow(Call call) {
        const float s = size();
        const unsigned value = mRandom.next();
        const float o = opacity();
        const auto list = stops();
        const auto listInC = inC(list);
        add(Glow(s, VFontEffect::rgb(value)).opacity(o).stops(list),
            call(c(), s, value, o, listInC.data(), listInC.size()));
    }
    void addLinear() {
        const float a = number(-400, 400);
        const float s = number(0, 2);
        const float o = opacity();
        const auto list = stops();
        const auto listInC = inC(list);
        add(VFontEffect::LinearGradient(list).angle(a).scale(s).opacity(o),
            vorel_look_linear_gradient(c(), a, s, o, listInC.data(), listInC.size()));
    }
    void addRadial() {
        const float s = number(0, 2);
        const float o = opacity();
        const auto list = stops();
        const auto listInC = inC(list);
        add(VFontEffect::RadialGradient(list).scale(s).opacity(o),
            vorel_look_radial_gradient(c(), s, o, listInC.data(), listInC.size()));
    }
    void addStroke() {
        const float s = size();
        const unsigned value = mRandom.next();
        const float o = opacity();
        const int where = mRandom.between(0, 2);
        constexpr VFontEffect::Position kPositions[] = {VFontEffect::Position::centre,
                                                        VFontEffect::Position::outside,
                                                        VFontEffect::Position::inside};
        constexpr int32_t kInC[] = {VOREL_CENTRE, VOREL_OUTSIDE, VOREL_INSIDE};
        add(VFontEffect::Stroke(s, VFontEffect::rgb(value)).opacity(o).position(kPositions[where]),
            vorel_look_stroke(c(), s, value, o, kInC[where]));
    }
    void addPattern() {
        const int width = mRandom.between(1, 6);
        const int height = mRandom.between(1, 6);
        const int stride = mRandom.chance(50) ? 0 : 4 * width + mRandom.between(0, 9);
        std::vector<unsigned char> pixels(static_cast<size_t>(std::max(stride, 4 * width) * height));
        for (unsigned char& byte : pixels)
            byte = mRandom.byte();
        const vorel_pixels view = {pixels.data(), width, height, stride};
        const float s = number(0, 4);
        const float o = opacity();
        add(VFontEffect::Pattern({pixels.data(), width, height, stride}).scale(s).opacity(o),
            vorel_look_pattern(c(), &view, s, o));
    }

    Random& mRandom;
    LookInBoth& mBoth;
    bool mIsGood = true;
};

/// Up to five effects; none where the C face has refused something.
inline LookInBoth randomLookInBoth(Random& random) {
    LookInBoth both;
    RandomInBoth hand(random, both);
    const bool isToldFirst = random.chance(50);
    if (isToldFirst) hand.tellFill();
    for (int effects = random.between(0, 5); effects > 0; --effects)
        hand.addEffect();
    if (!isToldFirst) hand.tellFill();
    if (!hand.isGood()) both.handle.reset();
    return both;
}

}  // namespace vorel_test
