#include "simd/cpu_level.h"

namespace VFontEffect::internal {

// Asked anew each time, a few nanoseconds, so that nothing is remembered between calls. The tests put
// a choice of their own in the place of this source.
CpuLevel chosenLevel() {
    int level = kBestLevel;
    while (level > kPlainestLevel && !runsHere(static_cast<CpuLevel>(level)))
        --level;
    return static_cast<CpuLevel>(level);
}

}  // namespace VFontEffect::internal
