#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace vorelpaint {

/// Frames a second, as a fraction: 30/1, 24000/1001.
struct FrameRate {
    int64_t frames;
    int64_t seconds;

    static constexpr int64_t kMost = 240;             ///< frames a second; it is one at least
    static constexpr int64_t kLargestPart = 1000000;  ///< of the fraction

    /// The number of frames that begin before a moment, counted from 0, which is at least 0: a frame is
    /// what is seen at the moment at which it begins. Exact up to kLongestFilmMs.
    int64_t framesBefore(int64_t ms) const;

    /// The moment at which a frame begins, in milliseconds.
    double startMs(int64_t frame) const;

    std::string text() const;  ///< "24000/1001", "30/1"
};

/// Reads "30" or "24000/1001"; nothing for anything else or beyond the limits.
std::optional<FrameRate> parseFrameRate(std::string_view text);

}  // namespace vorelpaint
