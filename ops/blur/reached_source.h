#pragma once

#include <cstdint>

#include "core/box.h"
#include "core/coverage_rows.h"

namespace VFontEffect::internal {

/// The part of a source that the results in a window depend on, and its place in the source.
struct ReachedSource {
    CoverageRows part;
    int64_t left;
    int64_t top;

    static ReachedSource of(const CoverageRows& source, int64_t radius, const Box& window);
};

}  // namespace VFontEffect::internal
