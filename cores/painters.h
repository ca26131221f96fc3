#pragma once

#include <cstdint>

#include "core/windows.h"
#include "cores/shadow_offset.h"
#include "voreleffect/VFECore.h"

/// The strokes and shadows as functions of the working memory that they may take; glows stand in glow.h.
namespace VFontEffect::internal {

/// Paint what the core of the record does, in windows that take `workingBytes` at most, if they can.
/// All of it is taken before the first pixel is painted: without it nothing is.
void paintStroke(const VFECore::ParamPostProcessing* params, const VFStrokeProperty& record,
                 int64_t workingBytes = kWorkingBytes);
void paintOuterShadow(const VFECore::ParamPostProcessing* params, const VFOuterShadowProperty& record,
                      const ShadowOffset& offset, int64_t workingBytes = kWorkingBytes);
void paintInnerShadow(const VFECore::ParamPostProcessing* params, const VFInnerShadowProperty& record,
                      int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
