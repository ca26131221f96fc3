#include "style/resolved_style.h"

#include <algorithm>
#include <cmath>
#include <utility>

#include "style/error.h"
#include "style/pattern_image.h"

namespace vorelstyle {
namespace {

constexpr float kMaxPixels = 100;

bool isShare(const Length& length) {
    return length.unit == Length::Unit::percent;
}

/// The number in the thousandths with which a file spells it: a float is a little more or less, which
/// would turn halves of a pixel into less than halves.
double thousandths(float value) {
    return std::round(static_cast<double>(value) * 1000);
}

/// The number of pixels without the last bits of what a scale such as 0.7 adds to it, to 1/65536.
double snapped(double pixels) {
    constexpr double kSteps = 65536;
    return std::round(pixels * kSteps) / kSteps;
}

/// Resolves the lengths of one look.
class Resolver {
  public:
    Resolver(int fontSizePx, float scale, std::string path, const Note& note)
        : mFontSize(fontSizePx), mScale(scale), mPath(std::move(path)), mNote(note) {}

    void resolve(LookStyle& look) {
        offset(look.offsetX, "offset.x");
        offset(look.offsetY, "offset.y");
        for (Effect& effect : look.effects) {
            mEffect = effectName(effect);
            std::visit(*this, effect);
        }
    }

    void operator()(Shadow& e) const {
        e.opacity *= line(e.distance, ".distance");
        length(e.size, ".size");
    }
    void operator()(Glow& e) const { e.opacity *= line(e.size, ".size"); }
    void operator()(Relief& e) const { e.opacity *= line(e.size, ".size"); }
    void operator()(Stroke& e) const { e.opacity *= line(e.size, ".size"); }
    void operator()(Pattern& e) const {
        if (e.width) {
            tileWidth(*e.width);
        } else if (mScale != 1.0F) {
            patternScale(e.scale);
        }
    }
    void operator()(LinearGradient&) const {}
    void operator()(RadialGradient&) const {}
    void operator()(TextFill&) const {}

  private:
    double pixelsOfShare(const Length& share) const {
        const double atScaleOne = thousandths(share.value) * mFontSize / (1000.0 * 100.0);
        return snapped(atScaleOne * static_cast<double>(mScale));
    }

    /// Resolves the width of something drawn, and returns the part of its opacity that it keeps.
    float line(Length& size, const char* key) const {
        if (isShare(size) && size.value > 0) {
            const double pixels = pixelsOfShare(size);
            if (pixels < 1) {
                size = {1};
                return static_cast<float>(pixels);
            }
        }
        length(size, key);
        return 1;
    }

    void length(Length& size, const char* key) const {
        if (isShare(size)) {
            size = {limited(std::round(pixelsOfShare(size)), key)};
        } else if (mScale != 1.0F && size.value > 0) {
            size = {std::max(1.0F, limited(std::round(size.value * mScale), key))};
        }
    }

    template <typename Number>
    float limited(Number asked, const char* key) const {
        if (!(asked > static_cast<Number>(kMaxPixels))) return static_cast<float>(asked);
        note(key, spelled(asked) + " pixels are more than the library's 100; painted with 100");
        return kMaxPixels;
    }

    void tileWidth(Length& width) const {
        if (isShare(width)) {
            width = {static_cast<float>(std::max(1.0, std::round(pixelsOfShare(width))))};
        } else if (mScale != 1.0F) {
            width = {std::max(1.0F, std::round(width.value * mScale))};
        }
    }

    void patternScale(float& scale) const {
        const float asked = scale * mScale;
        scale = std::clamp(asked, kSmallestPatternScale, kLargestPatternScale);
        if (asked != scale) note(".scale", spelled(asked) + beyondScale(asked, scale));
    }

    void offset(Length& distance, const char* key) const {
        const double asked =
            isShare(distance) ? pixelsOfShare(distance) : static_cast<double>(distance.value * mScale);
        const double whole = std::round(asked);
        const double cut = std::clamp<double>(whole, -kMaxOffset, kMaxOffset);
        distance = {static_cast<float>(cut)};
        if (cut == whole) return;
        note(key, spelled(whole) + " pixels are farther than " + std::to_string(kMaxOffset) +
                      "; moved by " + spelled(cut));
    }

    void note(const char* key, const std::string& text) const {
        if (mNote) mNote(mPath + std::string(mEffect) + key + ": " + text);
    }

    int mFontSize;
    float mScale;
    std::string mPath;
    std::string_view mEffect;
    const Note& mNote;
};

/// Refuses the shares among the lengths of one effect.
class ShareRefusal {
  public:
    explicit ShareRefusal(std::string_view effect) : mEffect(effect) {}

    void operator()(const Shadow& e) const {
        require(e.distance, ".distance");
        require(e.size, ".size");
    }
    void operator()(const Glow& e) const { require(e.size, ".size"); }
    void operator()(const Relief& e) const { require(e.size, ".size"); }
    void operator()(const Stroke& e) const { require(e.size, ".size"); }
    void operator()(const Pattern& e) const { require(e.width.value_or(Length{}), ".width"); }
    void operator()(const LinearGradient&) const {}
    void operator()(const RadialGradient&) const {}
    void operator()(const TextFill&) const {}

  private:
    void require(const Length& length, const char* key) const {
        if (!isShare(length)) return;
        throw StyleError(std::string(mEffect) + key + ": is a share of the font's size, not in pixels");
    }

    std::string_view mEffect;
};

}  // namespace

Style resolvedStyle(Style style, int fontSizePx, float scale, const Note& note) {
    for (size_t i = 0; i < style.looks.size(); ++i)
        Resolver(fontSizePx, scale, lookPath(style, i), note).resolve(style.looks[i]);
    return style;
}

void requireResolved(const LookStyle& look) {
    for (const Effect& effect : look.effects)
        std::visit(ShareRefusal(effectName(effect)), effect);
}

}  // namespace vorelstyle
