#include "ops/blur/difference_loops.h"
#include "ops/blur/dot_loops.h"
#include "ops/blur/narrow_loops.h"
#include "ops/dilate/dilation_loops.h"
#include "ops/grow/growth_loops.h"
#include "ops/ramp/ramp_loops.h"
#include "ops/tile/tile_loops.h"
#include "simd/level_table.h"

namespace VFontEffect::internal {

VOREL_LEVEL_TABLE(VOREL_EACH_VECTOR_LEVEL, dotLoops, DotLoops, kDotLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, dilationLoops, DilationLoops, kDilationLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, rampLoops, RampLoops, kRampLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, tileLoops, TileLoops, kTileLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, growthLoops, GrowthLoops, kGrowthLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, differenceLoops, DifferenceLoops, kDifferenceLoops)
VOREL_LEVEL_TABLE(VOREL_EACH_DOTLESS_LEVEL, narrowLoops, NarrowLoops, kNarrowLoops)

}  // namespace VFontEffect::internal
