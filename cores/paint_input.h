#pragma once

#include <cstdint>

#include "core/coverage_rows.h"
#include "core/views.h"
#include "voreleffect/VFECore.h"

/// What a core paints from: checked once, then trusted.
namespace VFontEffect::internal {

/// A box of the mask that lies inside it and is not empty.
struct CoverageBox {
    MaskView mask;
    int64_t left = 0;
    int64_t top = 0;
    int64_t width = 0;
    int64_t height = 0;

    explicit operator bool() const { return static_cast<bool>(mask); }

    /// The box as operators read it.
    CoverageRows rows(uint8_t invertMask = kAsIs) const {
        return {mask.at(left, top), mask.width, width, height, invertMask};
    }

    static CoverageBox of(const MaskView& mask, int64_t left, int64_t top, int64_t width,
                          int64_t height) {
        const bool inside = left >= 0 && top >= 0 && width > 0 && height > 0 &&
                            left + width <= mask.width && top + height <= mask.height;
        if (!mask || !inside) return {};
        return {mask, left, top, width, height};
    }
};

/// The coverage under the text box; empty when anything that a core needs is missing, when the box is
/// empty or inverted, or when it leaves the mask.
inline CoverageBox coverageOf(const VFECore::ParamPostProcessing* params) {
    if (params == nullptr || params->dstBitmap == nullptr || params->textRect == nullptr) return {};
    const VFRect& box = *params->textRect;
    return CoverageBox::of(MaskView::of(params->srcBitmap), box.mLeft, box.mTop,
                           int64_t{box.mRight} - box.mLeft, int64_t{box.mBottom} - box.mTop);
}

}  // namespace VFontEffect::internal
