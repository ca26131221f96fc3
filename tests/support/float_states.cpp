#include "float_states.h"

namespace vorel_test {
namespace {

#if defined(__x86_64__)

constexpr uint32_t kNearest = 0x1F80;  // all six exceptions masked
constexpr uint32_t kDown = kNearest | 0x2000;
constexpr uint32_t kUp = kNearest | 0x4000;
constexpr uint32_t kToZero = kNearest | 0x6000;
constexpr uint32_t kFlush = 0x8000 | 0x0040;
constexpr uint32_t kTraps = 0x0000;
constexpr uint32_t kFlags = 0x003F;
constexpr uint16_t kX87 = 0x037F;     // as a process starts
constexpr uint16_t kOddX87 = 0x0800;  // single precision, upwards, every exception a trap

void apply(const FloatState& state) {
    const uint32_t mxcsr = state.control | state.flags;
    // Exceptions of the 80-bit registers wait until they are unmasked.
    asm volatile("ldmxcsr %0\n\tfnclex\n\tfldcw %1" : : "m"(mxcsr), "m"(state.x87) : "memory");
}

#elif defined(__aarch64__)

constexpr uint32_t kNearest = 0;
constexpr uint32_t kUp = 1U << 22;
constexpr uint32_t kDown = 2U << 22;
constexpr uint32_t kToZero = 3U << 22;
constexpr uint32_t kFlush = 1U << 24 | 1U << 25;  // and every NaN the default one
constexpr uint32_t kTraps = 0x9F00;               // stays 0 on CPUs that have none
constexpr uint32_t kFlags = 0x009F;               // not that of saturated integers
constexpr uint16_t kX87 = 0;
constexpr uint16_t kOddX87 = 0;

void apply(const FloatState& state) {
    asm volatile("msr fpcr, %0\n\tmsr fpsr, %1"
                 :
                 : "r"(uint64_t{state.control}), "r"(uint64_t{state.flags})
                 : "memory");
}

#else

// Of WebAssembly there is one state.
void apply(const FloatState& /*state*/) {}

#endif

}  // namespace

std::vector<FloatState> floatStates() {
#if defined(__wasm__)
    return {{"as it starts", 0, 0, 0}};
#else
    return {{"as it starts", kNearest, kX87, 0},
            {"rounding up", kUp, kX87, 0},
            {"rounding down", kDown, kX87, 0},
            {"rounding toward zero", kToZero, kX87, 0},
            {"flushing subnormals", kNearest | kFlush, kX87, 0},
            {"trapping", kTraps, kX87, 0},
            {"80-bit registers set up", kNearest, kOddX87, 0},
            {"trapping, flushing, rounding up", kTraps | kFlush | (kUp & ~kNearest), kOddX87, 0}};
#endif
}

FloatState currentFloatState() {
    FloatState state = {"the thread's", 0, 0, 0};
#if defined(__x86_64__)
    uint32_t mxcsr = 0;
    asm volatile("stmxcsr %0\n\tfnstcw %1" : "=m"(mxcsr), "=m"(state.x87) : : "memory");
    state.control = mxcsr & ~kFlags;
    state.flags = mxcsr & kFlags;
#elif defined(__aarch64__)
    uint64_t control = 0;
    uint64_t flags = 0;
    asm volatile("mrs %0, fpcr\n\tmrs %1, fpsr" : "=r"(control), "=r"(flags) : : "memory");
    state.control = static_cast<uint32_t>(control);
    state.flags = static_cast<uint32_t>(flags) & kFlags;
#endif
    return state;
}

InFloatState::InFloatState(const FloatState& state) : mBefore(currentFloatState()) {
    apply(state);
}
InFloatState::~InFloatState() {
    apply(mBefore);
}

FloatState asThisCpuHasIt(const FloatState& state) {
    const InFloatState callers(state);
    return currentFloatState();
}

}  // namespace vorel_test
