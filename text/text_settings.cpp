#include "text/text_settings.h"

#include <cmath>
#include <cstdlib>

#include "text/error.h"
#include "text/text_layout.h"
#include "text/units.h"
#include "unicode/decimal.h"

namespace voreltext {
namespace {

constexpr int64_t kMostSpacing = TextLayout::kMaxSide * kUnit;

[[noreturn]] void refuse(const std::string& what, const std::string& value, const std::string& range) {
    throw TextError("the " + what + " is " + value + "; it may be " + range);
}

}  // namespace

void checkSettings(const TextSettings& settings) {
    const float lineHeight = settings.lineHeight;
    if (!(lineHeight >= 0 && lineHeight <= TextSettings::kMostLineHeight)) {
        refuse("line height", vorelunicode::decimal(double{lineHeight}),
               "0 to " + vorelunicode::decimal(double{TextSettings::kMostLineHeight}));
    }
    if (settings.letterSpacing < -kMostSpacing || settings.letterSpacing > kMostSpacing) {
        refuse(
            "letter spacing", std::to_string(settings.letterSpacing),
            std::to_string(-kMostSpacing) + " to " + std::to_string(kMostSpacing) + " 64ths of a pixel");
    }
    if (settings.wrapWidth < 0) {
        refuse("width of lines", std::to_string(settings.wrapWidth), "0, for any, or more pixels");
    }
}

}  // namespace voreltext
