#include "film_rate.h"

#include "read_value.h"

namespace vorelpaint {

int64_t FrameRate::framesBefore(int64_t ms) const {
    const int64_t unit = 1000 * seconds;
    return (ms * frames + unit - 1) / unit;
}

double FrameRate::startMs(int64_t frame) const {
    return 1000.0 * static_cast<double>(frame * seconds) / static_cast<double>(frames);
}

std::string FrameRate::text() const {
    return std::to_string(frames) + "/" + std::to_string(seconds);
}

std::optional<FrameRate> parseFrameRate(std::string_view text) {
    const size_t slash = text.find('/');
    const bool isFraction = slash != std::string_view::npos;
    const auto frames = numberIn<int64_t>(text.substr(0, slash));
    const auto seconds =
        isFraction ? numberIn<int64_t>(text.substr(slash + 1)) : std::optional<int64_t>(1);
    constexpr Limits<int64_t> kParts{1, FrameRate::kLargestPart};
    if (!frames || !seconds || !contains(kParts, *frames) || !contains(kParts, *seconds)) {
        return std::nullopt;
    }
    if (*frames < *seconds || *frames > FrameRate::kMost * *seconds) return std::nullopt;
    return FrameRate{*frames, *seconds};
}

}  // namespace vorelpaint
