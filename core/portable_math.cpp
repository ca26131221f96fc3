#include "core/portable_math.h"

#include <cmath>

namespace VFontEffect::internal {
namespace {

/// c[0] + c[1] * x + c[2] * x^2 + ..., by Horner's rule.
template <int Terms>
double polynomial(double x, const double (&c)[Terms]) {
    double sum = c[Terms - 1];
    for (int i = Terms - 2; i >= 0; --i)
        sum = c[i] + x * sum;
    return sum;
}

/// Taylor series around 0; on the reduced arguments their remainders lie below 1e-17.
constexpr double kExpSeries[] = {1.0,
                                 1.0,
                                 1.0 / 2,
                                 1.0 / 6,
                                 1.0 / 24,
                                 1.0 / 120,
                                 1.0 / 720,
                                 1.0 / 5040,
                                 1.0 / 40320,
                                 1.0 / 362880,
                                 1.0 / 3628800,
                                 1.0 / 39916800,
                                 1.0 / 479001600,
                                 1.0 / 6227020800.0};
constexpr double kSineSeries[] = {1.0,
                                  -1.0 / 6,
                                  1.0 / 120,
                                  -1.0 / 5040,
                                  1.0 / 362880,
                                  -1.0 / 39916800,
                                  1.0 / 6227020800.0,
                                  -1.0 / 1307674368000.0,
                                  1.0 / 355687428096000.0};
constexpr double kCosineSeries[] = {1.0,
                                    -1.0 / 2,
                                    1.0 / 24,
                                    -1.0 / 720,
                                    1.0 / 40320,
                                    -1.0 / 3628800,
                                    1.0 / 479001600,
                                    -1.0 / 87178291200.0,
                                    1.0 / 20922789888000.0,
                                    -1.0 / 6402373705728000.0};

/// ln 2 and pi / 2, split for argument reduction: the high part has so few significant bits that its
/// product with a whole number of up to 20 bits is exact.
constexpr double kLn2High = 6.93147180369123816490e-01;
constexpr double kLn2Low = 1.90821492927058770002e-10;
constexpr double kHalfPiHigh = 1.57079632673412561417e+00;
constexpr double kHalfPiLow = 6.07710050650619224932e-11;

constexpr double kLog2E = 1.44269504088896340736;
constexpr double kTwoOverPi = 0.63661977236758134308;

constexpr float kSmallestExponent = -80.0F;
constexpr float kLargestAngle = 100000.0F;

double nearestWhole(double x) {
    return std::floor(x + 0.5);
}

struct SineCosine {
    double sine;
    double cosine;
};

/// Both of an angle up to kLargestAngle: less whole quarter turns, in -pi/4..pi/4, then turned back.
SineCosine sineCosine(double radians) {
    const double quarters = nearestWhole(radians * kTwoOverPi);
    const double r = (radians - quarters * kHalfPiHigh) - quarters * kHalfPiLow;
    const double sine = r * polynomial(r * r, kSineSeries);
    const double cosine = polynomial(r * r, kCosineSeries);
    switch (static_cast<int>(quarters) & 3) {
        case 0:
            return {sine, cosine};
        case 1:
            return {cosine, -sine};
        case 2:
            return {-sine, -cosine};
        default:
            return {-cosine, sine};
    }
}

bool isReducible(float radians) {
    return std::fabs(radians) <= kLargestAngle;
}

}  // namespace

float portableExp(float x) {
    if (!(x >= kSmallestExponent)) return 0.0F;
    const double halvings = nearestWhole(x * kLog2E);
    const double r = (x - halvings * kLn2High) - halvings * kLn2Low;
    return static_cast<float>(std::ldexp(polynomial(r, kExpSeries), static_cast<int>(halvings)));
}

float portableSin(float radians) {
    return isReducible(radians) ? static_cast<float>(sineCosine(radians).sine) : std::sin(radians);
}

float portableCos(float radians) {
    return isReducible(radians) ? static_cast<float>(sineCosine(radians).cosine) : std::cos(radians);
}

float portableTan(float radians) {
    if (!isReducible(radians)) return std::tan(radians);
    const SineCosine both = sineCosine(radians);
    return static_cast<float>(both.sine / both.cosine);
}

}  // namespace VFontEffect::internal
