#include "core/level_table.h"
#include "cores/fill_kernels.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(fillKernels, FillKernels, kFillKernels)

}  // namespace VFontEffect::internal
