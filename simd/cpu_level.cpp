#include "simd/cpu_level.h"

#if defined(__aarch64__)
#include <sys/auxv.h>
#endif

namespace VFontEffect::internal {

#if defined(__x86_64__)

namespace {

bool has(int supported) { return supported != 0; }
CpuFeatures featuresHere() {
    return {has(__builtin_cpu_supports("avx2")),     has(__builtin_cpu_supports("avx512f")),
            has(__builtin_cpu_supports("avx512bw")), has(__builtin_cpu_supports("avx512dq")),
            has(__builtin_cpu_supports("avx512vl")), has(__builtin_cpu_supports("avx512vnni"))};
}

}  // namespace

bool suffices(const CpuFeatures& features, CpuLevel level) {
    switch (level) {
        case CpuLevel::avx2:
            return features.avx2;
        case CpuLevel::avx512:
            return features.avx512f && features.avx512bw && features.avx512dq && features.avx512vl &&
                   features.avx512vnni;
        default:
            return true;
    }
}

#elif defined(__aarch64__)

namespace {

CpuFeatures featuresHere() {
    // The dot product's bit in the Linux kernel's first word of CPU features.
    constexpr unsigned long kDotProduct = 1UL << 20;
    return {(getauxval(AT_HWCAP) & kDotProduct) != 0};
}

}  // namespace

bool suffices(const CpuFeatures& features, CpuLevel level) {
    return level != CpuLevel::dotprod || features.dotProducts;
}

#else

namespace {

CpuFeatures featuresHere() { return {}; }

}  // namespace

bool suffices(const CpuFeatures& /*features*/, CpuLevel /*level*/) { return true; }

#endif

bool runsHere(CpuLevel level) { return suffices(featuresHere(), level); }

}  // namespace VFontEffect::internal
