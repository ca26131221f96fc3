#include "simd/cpu_level.h"

#if defined(__aarch64__)
#include <sys/auxv.h>
#endif

namespace VFontEffect::internal {

#if defined(__x86_64__)

bool runsHere(CpuLevel level) {
    switch (level) {
        case CpuLevel::avx2:
            return __builtin_cpu_supports("avx2") != 0;
        case CpuLevel::avx512:
            return __builtin_cpu_supports("avx512f") != 0 && __builtin_cpu_supports("avx512bw") != 0 &&
                   __builtin_cpu_supports("avx512dq") != 0 && __builtin_cpu_supports("avx512vl") != 0 &&
                   __builtin_cpu_supports("avx512vnni") != 0;
        default:
            return true;
    }
}

#elif defined(__aarch64__)

bool runsHere(CpuLevel level) {
    // The dot product's bit in the Linux kernel's first word of CPU features.
    constexpr unsigned long kDotProduct = 1UL << 20;
    return level != CpuLevel::dotprod || (getauxval(AT_HWCAP) & kDotProduct) != 0;
}

#else

bool runsHere(CpuLevel /*level*/) { return true; }

#endif

}  // namespace VFontEffect::internal
