#include "core/portable_math.h"

#include <cmath>
#include <cstdint>
#include <cstring>

#include "core/numeric.h"

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

/// Of a number within 32 bits.
int32_t nearestWhole(double x) {
    const double above = x + 0.5;
    const int32_t whole = toInt(above);
    return whole > above ? whole - 1 : whole;
}

/// Of an exponent that normal numbers have.
double powerOfTwo(int32_t exponent) {
    constexpr int32_t kBias = 1023;
    constexpr int kFractionBits = 52;
    const uint64_t bits = static_cast<uint64_t>(kBias + exponent) << kFractionBits;
    double power = 0.0;
    std::memcpy(&power, &bits, sizeof power);
    return power;
}

Turn turnOf(double sine, double cosine) {
    return {static_cast<float>(sine), static_cast<float>(cosine), static_cast<float>(sine / cosine)};
}

bool isReducible(float radians) {
    return std::fabs(radians) <= kLargestAngle;
}

}  // namespace

float portableExp(float x) {
    if (!(x >= kSmallestExponent)) return 0.0F;
    const int32_t halvings = nearestWhole(x * kLog2E);
    const double r = (x - halvings * kLn2High) - halvings * kLn2Low;
    return static_cast<float>(polynomial(r, kExpSeries) * powerOfTwo(halvings));
}

// Whole quarter turns are taken away, which leaves -pi/4..pi/4, then turned back.
Turn portableTurn(float radians) {
    if (!isReducible(radians)) {
        // Read anew for each: compilers would ask the C library for sine and cosine at once.
        const volatile float angle = radians;
        return {std::sin(angle), std::cos(angle), std::tan(angle)};
    }
    const int32_t quarters = nearestWhole(radians * kTwoOverPi);
    const double r = (radians - quarters * kHalfPiHigh) - quarters * kHalfPiLow;
    const double sine = r * polynomial(r * r, kSineSeries);
    const double cosine = polynomial(r * r, kCosineSeries);
    switch (quarters & 3) {
        case 0:
            return turnOf(sine, cosine);
        case 1:
            return turnOf(cosine, -sine);
        case 2:
            return turnOf(-sine, -cosine);
        default:
            return turnOf(-cosine, sine);
    }
}

}  // namespace VFontEffect::internal
