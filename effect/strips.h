#pragma once

#include <cstdint>
#include <vector>

#include "voreleffect/VFECore.h"

/// Large pictures, which effects paint by turns: a strip of rows each, while it is in the cache.
namespace VFontEffect::internal {

/// What the effects of a run paint into and from.
struct RunBitmaps {
    VFBitmap* destination;
    VFBitmap* outerLayer;  ///< null in a run that is not layered
    VFBitmap* mask;
    VFRect* textRect;

    /// What one of them is given. Of two targets the destination is the second.
    VFECore::ParamPostProcessing paramsFor(VFECore& core) const;
};

/// The rows of a strip for a run. 0 when one effect after the other is to paint all of its rows: in
/// pictures of few strips, and where bitmaps share bytes, so that effects may paint over what others
/// paint from.
int64_t stripRowsFor(const RunBitmaps& run);

/// Paints what doPostProcessing of one core after the other does. Each effect has its working memory
/// before any of them paints, and without it paints nothing. Returns false, with nothing painted, when
/// there is no memory to begin with.
[[nodiscard]] bool paintInStrips(const std::vector<VFECore*>& cores, const RunBitmaps& run,
                                 int64_t stripRows);

}  // namespace VFontEffect::internal
