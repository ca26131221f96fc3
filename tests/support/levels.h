#pragma once

#include <string>
#include <vector>

#include "simd/cpu_level.h"
#include "voreleffect/VFExport.h"

/// The tests run on a library whose level of the instruction set is set from here, so that one process
/// tries every level that its CPU has.
namespace vorel_test {

using VFontEffect::internal::CpuLevel;

/// The level of all calls from now on, from any thread. Starts as the best one.
VF_API void useLevel(CpuLevel level);

/// The levels that this CPU has, the plainest first.
VF_API std::vector<CpuLevel> levelsHere();

VF_API std::string nameOf(CpuLevel level);

}  // namespace vorel_test
