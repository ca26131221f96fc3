#include "blend/kernels.h"

#include "core/level_table.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, blendKernels, BlendKernels, kBlendKernels)

}  // namespace VFontEffect::internal
