#pragma once

#include <cstddef>
#include <string>
#include <type_traits>

#include "text/voreltext.h"
#include "unicode/decimal.h"

/// What can be asked for at most of one picture. Who fills in a Request keeps to it.
namespace vorelcompose {

/// From `low` to `high`, both taken.
template <typename Number>
struct Limits {
    Number low;
    Number high;
};

constexpr Limits<int> kFontSize{1, 1000};
constexpr Limits<int> kPadding{0, 1000};
constexpr Limits<int> kCanvasSide{1, voreltext::TextLayout::kMaxSide};
constexpr Limits<int> kMargin{0, 8000};
constexpr Limits<float> kLineHeight{0.5F, 10.0F};
constexpr Limits<float> kLetterSpacing{-200.0F, 200.0F};  ///< pixels, or percent of the font size
constexpr Limits<float> kEffectScale{0.05F, 20.0F};
constexpr Limits<float> kOpacity{0.0F, 1.0F};

constexpr size_t kMostFonts = 16;  ///< that a text asks in turn
constexpr size_t kMaxTextBytes = size_t{1} << 16;
constexpr size_t kMaxStyleBytes = size_t{1} << 17;
constexpr unsigned int kMaxPatternSide = 4096;  ///< of a picture that is read

/// Not what is no number.
template <typename Number>
bool contains(const Limits<Number>& limits, Number number) {
    return number >= limits.low && number <= limits.high;
}

/// "1 to 1000".
template <typename Number>
std::string spelled(const Limits<Number>& limits) {
    const auto written = [](Number number) {
        if constexpr (std::is_integral_v<Number>) {
            return std::to_string(number);
        } else {
            return vorelunicode::decimal(double{number});
        }
    };
    return written(limits.low) + " to " + written(limits.high);
}

}  // namespace vorelcompose
