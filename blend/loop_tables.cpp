#include "blend/blend_loops.h"
#include "simd/level_table.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, blendLoops, BlendLoops, kBlendLoops)

}  // namespace VFontEffect::internal
