#pragma once

#include <cstdint>
#include <vector>

#include "effect/placement.h"
#include "voreleffect/VFECore.h"

/// Large pictures, which effects paint by turns: a strip of rows each, while it is in the cache.
namespace VFontEffect::internal {

/// The rows of a strip for a run. 0 when one effect after the other is to paint all of its rows: in
/// pictures that stay in the caches, and where bitmaps share bytes, so that effects may paint over what
/// others paint from.
int64_t stripRowsFor(const RunBitmaps& run);

/// Paints what doPostProcessing of one core after the other does. All effects have their working memory
/// at once: returns false, with nothing painted, when there is not enough for that.
[[nodiscard]] bool paintInStrips(const std::vector<VFECore*>& cores, const RunBitmaps& run,
                                 int64_t stripRows);

}  // namespace VFontEffect::internal
