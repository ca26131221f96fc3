#pragma once

#include <cstdint>

#include "core/windows.h"
#include "cores/glow.h"
#include "cores/shadow_offset.h"
#include "voreleffect/VFECore.h"

/// The cores that take working memory, as functions of it.
namespace VFontEffect::internal {

/// Paint what the core of the record paints, in windows that take `workingBytes` at most, if they can.
/// All of it is taken before the first pixel is painted: without it nothing is.
void paintStroke(const VFECore::ParamPostProcessing* params, const VFStrokeProperty& record,
                 int64_t workingBytes = kWorkingBytes);
void paintOuterShadow(const VFECore::ParamPostProcessing* params, const VFOuterShadowProperty& record,
                      const ShadowOffset& offset, int64_t workingBytes = kWorkingBytes);
void paintInnerShadow(const VFECore::ParamPostProcessing* params, const VFInnerShadowProperty& record,
                      int64_t workingBytes = kWorkingBytes);

}  // namespace VFontEffect::internal
