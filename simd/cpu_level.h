#pragma once

#include <cstdint>

/// Levels of the instruction set. The sources of the inner loops are compiled once for each level of
/// the machine's kind, each time in a namespace of the level's name (VOREL_LEVEL), and picked when the
/// process runs. All levels give the same bytes.
///
/// VOREL_EACH_VECTOR_LEVEL applies a macro to the name of each level but the scalar one, from the
/// plainest to the best, and to two arguments of the caller's. The plainest runs on every CPU of its
/// kind, so only the tests have the scalar level beside it, and VOREL_WITHOUT_SCALAR says that it is not
/// there. A WebAssembly module with vectors is refused as a whole where there are none, so one is built
/// for each of both cases, and VOREL_WITHOUT_VECTORS says that the scalar level is alone.
/// VOREL_EACH_DOTLESS_LEVEL names for each of them the level that its loops without dot products are
/// taken from.
#if defined(__x86_64__)
#define VOREL_EACH_VECTOR_LEVEL(apply, a, b) apply(sse2, a, b) apply(avx2, a, b) apply(avx512, a, b)
#define VOREL_EACH_DOTLESS_LEVEL(apply, a, b) VOREL_EACH_VECTOR_LEVEL(apply, a, b)
#elif defined(__aarch64__)
#define VOREL_EACH_VECTOR_LEVEL(apply, a, b) apply(neon, a, b) apply(dotprod, a, b)
#define VOREL_EACH_DOTLESS_LEVEL(apply, a, b) apply(neon, a, b) apply(neon, a, b)
#elif defined(__wasm__)
#define VOREL_EACH_VECTOR_LEVEL(apply, a, b) apply(simd128, a, b)
#define VOREL_EACH_DOTLESS_LEVEL(apply, a, b) VOREL_EACH_VECTOR_LEVEL(apply, a, b)
#else
#define VOREL_EACH_VECTOR_LEVEL(apply, a, b)
#define VOREL_EACH_DOTLESS_LEVEL(apply, a, b)
#endif

namespace VFontEffect::internal {

#define VOREL_LEVEL_NAME(level, a, b) level,
enum class CpuLevel { scalar, VOREL_EACH_VECTOR_LEVEL(VOREL_LEVEL_NAME, , ) count };
#undef VOREL_LEVEL_NAME

constexpr int kCpuLevels = static_cast<int>(CpuLevel::count);
#if defined(VOREL_WITHOUT_SCALAR)
constexpr int kPlainestLevel = 1;
#else
constexpr int kPlainestLevel = 0;
#endif
#if defined(VOREL_WITHOUT_VECTORS)
constexpr int kBestLevel = 0;
#else
constexpr int kBestLevel = kCpuLevels - 1;
#endif

/// Bytes of the longest vector of any level.
constexpr int64_t kWidestVector = 64;

/// What the levels beyond the plainest ask of a CPU and of the system's kernel.
#if defined(__x86_64__)
struct CpuFeatures {
    bool avx2;
    bool avx512f;
    bool avx512bw;
    bool avx512dq;
    bool avx512vl;
    bool avx512vnni;
};
#elif defined(__aarch64__)
struct CpuFeatures {
    bool dotProducts;
};
#else
struct CpuFeatures {};
#endif

/// Whether a CPU of these features has what the level's code needs: all that cmake/levels.cmake lets the
/// compiler use for it.
bool suffices(const CpuFeatures& features, CpuLevel level);

/// Whether this one has.
bool runsHere(CpuLevel level);

/// The level that the inner loops run at.
CpuLevel chosenLevel();

}  // namespace VFontEffect::internal
