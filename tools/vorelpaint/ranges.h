#pragma once

#include <cstddef>
#include <cstdint>

#include "compose/limits.h"
#include "film_rate.h"

/// What can be asked for at most; help and manual name the same.
namespace vorelpaint {

using namespace vorelcompose;  // the limits of one picture

constexpr Limits<size_t> kSheetSizes{1, 16};  ///< how many a sheet has

constexpr Limits<int> kJobs{1, 64};  ///< at a time
constexpr Limits<int> kShards{1, 100000};
constexpr Limits<int> kFade{0, 60000};  ///< milliseconds
constexpr Limits<int64_t> kFrameRates{1, FrameRate::kMost};

constexpr size_t kMaxJobBytes = size_t{1} << 18;  ///< room for the largest text and the largest style

}  // namespace vorelpaint
