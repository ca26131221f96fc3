#pragma once

#include <voreleffect/VFECore.h>

#include "tests/support/literal_engine.h"

/// What painting costs, so that a fuzzing input stays within milliseconds.
namespace vorel_fuzz {

namespace literal = vorel_test::literal;

/// The types that have a core.
constexpr int kCoreTypes[] = {literal::kOuterShadow, literal::kInnerShadow,    literal::kOuterGlow,
                              literal::kInnerGlow,   literal::kLinearGradient, literal::kRadialGradient,
                              literal::kStroke,      literal::kPattern,        literal::kText};

/// The size of the core's record as far as it costs work: sizes that a core refuses, and NaN, are 0.
inline double workingSize(VFontEffect::VFECore& core) {
    using namespace VFontEffect;
    constexpr float kLargestPainted = 256.0F;
    VFProperty* const record = core.getProperty();
    if (record == nullptr) return 0.0;
    float size = 0.0F;
    switch (core.getStyle()) {
        case literal::kOuterShadow:
            size = static_cast<VFOuterShadowProperty*>(record)->mSize;
            break;
        case literal::kInnerShadow:
            size = static_cast<VFInnerShadowProperty*>(record)->mSize;
            break;
        case literal::kOuterGlow:
            size = static_cast<VFOuterGlowProperty*>(record)->mSize;
            break;
        case literal::kInnerGlow:
            size = static_cast<VFInnerGlowProperty*>(record)->mSize;
            break;
        case literal::kStroke:
            size = static_cast<VFStrokeProperty*>(record)->mSize;
            break;
        default:
            break;
    }
    return size > 0.0F && size <= kLargestPainted ? static_cast<double>(size) : 0.0;
}

/// Steps, each a few instructions, of one effect of `size` pixels over a box of width x height, when
/// every loop runs over all that it may touch. The forms are those of the effects' plain definitions;
/// a faster algorithm only costs less.
inline double paintCost(int type, double size, double width, double height) {
    const double side = 2 * size + 3;
    switch (type) {
        case literal::kStroke:
            return 2 * (width + 2) * (height + 2) * side * side;
        case literal::kOuterShadow:
            return (width + 4 * size) * (height + 4 * size) * 2 * side;
        case literal::kInnerShadow:
            return (width + 4 * size) * (height + 2 * size) + 2 * width * (height + 2 * size) * side;
        case literal::kOuterGlow:
        case literal::kInnerGlow:
            return (width + 4 * size + 4) * (height + 4 * size + 4) * (5 * (size + 1) + 2 * side);
        case literal::kPattern:
            return 10 * width * height;
        default:
            return width * height;
    }
}

inline double paintCost(VFontEffect::VFECore& core, double width, double height) {
    return paintCost(core.getStyle(), workingSize(core), width, height);
}

/// The longest side of a large input: boxes are taller than what a blur keeps of them, and wider than
/// several of the widest vectors.
constexpr int kLargeSide = 400;

/// The steps that one input may spend.
class WorkBudget {
  public:
    explicit WorkBudget(double steps) : mLeft(steps) {}

    /// Takes the steps, or refuses them when fewer are left.
    bool spend(double steps) {
        if (steps > mLeft) return false;
        mLeft -= steps;
        return true;
    }

  private:
    double mLeft;
};

}  // namespace vorel_fuzz
