#include "core/level_table.h"
#include "cores/blur_kernels.h"
#include "cores/dilation.h"
#include "cores/fill_kernels.h"
#include "cores/glow_kernels.h"
#include "cores/running_kernels.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_VECTOR_LEVEL, blurKernels, BlurKernels, kBlurKernels)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, dilationKernels, DilationKernels, kDilationKernels)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, fillKernels, FillKernels, kFillKernels)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, glowKernels, GlowKernels, kGlowKernels)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, runningKernels, RunningKernels, kRunningKernels)

}  // namespace VFontEffect::internal
