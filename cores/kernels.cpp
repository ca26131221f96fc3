#include "core/level_table.h"
#include "cores/blur_kernels.h"
#include "cores/fill_kernels.h"
#include "cores/growth_kernels.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(blurKernels, BlurKernels, kBlurKernels)
VOREL_LEVEL_TABLE(fillKernels, FillKernels, kFillKernels)
VOREL_LEVEL_TABLE(glowKernels, GlowKernels, kGlowKernels)

}  // namespace VFontEffect::internal
