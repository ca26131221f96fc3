#pragma once

#include <cfenv>
#include <cstdint>
#include <type_traits>

#include "core/inline.h"
#include "core/strict_math.h"

namespace VFontEffect::internal {

/// While one lives, its thread computes as the library's bytes are defined: rounding to nearest, keeping
/// subnormal numbers, with all exceptions masked. Hosts come in any other state: audio code flushes
/// subnormals, numeric code rounds upwards or traps. At its end the caller's state is back, sticky flags
/// included: of what happened in between nothing is to be seen.
///
/// It is the state of single and double precision; nothing here computes in the older 80-bit registers.
///
/// Compilers move no access to memory across a change of state, but do not know that arithmetic depends
/// on it. What is computed must come from memory and go there; for all else there is inOwnFloatState().
class OwnFloatState {
  public:
    VOREL_INLINE OwnFloatState();
    VOREL_INLINE ~OwnFloatState();
    OwnFloatState(const OwnFloatState&) = delete;
    OwnFloatState& operator=(const OwnFloatState&) = delete;

  private:
#if defined(__x86_64__)
    uint32_t mControlAndFlags = 0;
#elif defined(__aarch64__)
    uint64_t mControl = 0;
    uint64_t mFlags = 0;
#elif !defined(__wasm__)
    std::fenv_t mEnvironment = {};
#endif
};

#if defined(__x86_64__)

OwnFloatState::OwnFloatState() {
    constexpr uint32_t kOwn = 0x1F80;  // the masks of all six exceptions, nothing else
    asm volatile("stmxcsr %0\n\tldmxcsr %1" : "=&m"(mControlAndFlags) : "m"(kOwn) : "memory");
}
OwnFloatState::~OwnFloatState() {
    asm volatile("ldmxcsr %0" : : "m"(mControlAndFlags) : "memory");
}

#elif defined(__aarch64__)

// The control register is written only if it changes: for that some CPUs wait until all is computed.
OwnFloatState::OwnFloatState() {
    asm volatile("mrs %0, fpcr\n\tmrs %1, fpsr" : "=r"(mControl), "=r"(mFlags) : : "memory");
    if (mControl != 0) asm volatile("msr fpcr, xzr" : : : "memory");
}
OwnFloatState::~OwnFloatState() {
    asm volatile("msr fpsr, %0" : : "r"(mFlags) : "memory");
    if (mControl != 0) asm volatile("msr fpcr, %0" : : "r"(mControl) : "memory");
}

#elif defined(__wasm__)

// Arithmetic has one state there, the library's own.
OwnFloatState::OwnFloatState() = default;
OwnFloatState::~OwnFloatState() = default;

#else

OwnFloatState::OwnFloatState() {
    std::fegetenv(&mEnvironment);
    std::fesetenv(FE_DFL_ENV);
}
OwnFloatState::~OwnFloatState() {
    std::fesetenv(&mEnvironment);
}

#endif

/// The result of `work()`, computed in the library's own state, whatever it captures and returns.
template <class Work>
VOREL_INLINE auto inOwnFloatState(const Work& work) {
    const OwnFloatState state;
    // Hides where the captured values come from, and that only the caller wants the result: neither the
    // first steps of the work move above the change of state nor the last ones below.
    const Work* hidden = &work;
    asm volatile("" : "+r"(hidden) : : "memory");
    if constexpr (std::is_void_v<decltype(work())>) {
        (*hidden)();
    } else {
        auto result = (*hidden)();
        asm volatile("" : "+m"(result) : : "memory");
        return result;
    }
}

}  // namespace VFontEffect::internal
