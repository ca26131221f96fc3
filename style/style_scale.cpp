#include "style/style_scale.h"

#include <algorithm>
#include <cmath>

namespace vorelstyle {
namespace {

/// Multiplies the lengths of one effect; effects without lengths stay.
class Scale {
  public:
    explicit Scale(float factor) : mFactor(factor) {}

    void operator()(Shadow& e) const {
        length(e.distance);
        length(e.size);
    }
    void operator()(Glow& e) const { length(e.size); }
    void operator()(Relief& e) const { length(e.size); }
    void operator()(Stroke& e) const { length(e.size); }
    void operator()(Pattern& e) const { e.scale = std::clamp(e.scale * mFactor, 0.1F, 10.0F); }
    void operator()(LinearGradient&) const {}
    void operator()(RadialGradient&) const {}
    void operator()(TextFill&) const {}

  private:
    void length(float& pixels) const {
        if (pixels > 0) pixels = std::clamp(std::round(pixels * mFactor), 1.0F, 100.0F);
    }

    float mFactor;
};

}  // namespace

Style scaledStyle(Style style, float factor) {
    if (factor == 1.0F) return style;
    for (Effect& effect : style.effects)
        std::visit(Scale(factor), effect);
    return style;
}

}  // namespace vorelstyle
