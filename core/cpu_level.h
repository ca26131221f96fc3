#pragma once

/// Levels of the instruction set. The sources of the inner loops are compiled once for each level of
/// the machine's kind, each time in a namespace of the level's name (VOREL_LEVEL), and picked when the
/// process runs. All levels give the same bytes.
///
/// VOREL_EACH_LEVEL applies a macro to the name of each level, from the plainest to the best, and to two
/// arguments of the caller's.
#if defined(__x86_64__)
#define VOREL_EACH_LEVEL(apply, a, b) \
    apply(scalar, a, b) apply(sse2, a, b) apply(avx2, a, b) apply(avx512, a, b)
#elif defined(__aarch64__)
#define VOREL_EACH_LEVEL(apply, a, b) apply(scalar, a, b) apply(neon, a, b) apply(dotprod, a, b)
#else
#define VOREL_EACH_LEVEL(apply, a, b) apply(scalar, a, b)
#endif

namespace VFontEffect::internal {

#define VOREL_LEVEL_NAME(level, a, b) level,
enum class CpuLevel { VOREL_EACH_LEVEL(VOREL_LEVEL_NAME, , ) count };
#undef VOREL_LEVEL_NAME

constexpr int kCpuLevels = static_cast<int>(CpuLevel::count);

/// Whether this CPU, and the system's kernel, have what the level's code needs.
bool runsHere(CpuLevel level);

/// The level that the inner loops run at.
CpuLevel chosenLevel();

}  // namespace VFontEffect::internal
