#pragma once

#include <cstdint>
#include <vector>

/// States of floating-point arithmetic that a caller's thread may be in.
namespace vorel_test {

struct FloatState {
    const char* name;
    uint32_t control;  ///< MXCSR without its flags on x86-64, FPCR on 64-bit ARM
    uint16_t x87;      ///< control word of the 80-bit registers, x86-64 only
    uint32_t flags;    ///< of exceptions, sticky: in MXCSR, FPSR

    bool operator==(const FloatState& other) const {
        return control == other.control && x87 == other.x87 && flags == other.flags;
    }
};

/// The default one first; then the other rounding modes, subnormal numbers flushed on the way in and
/// out, every exception a trap (where the CPU can), and mixtures.
std::vector<FloatState> floatStates();

/// The calling thread's.
FloatState currentFloatState();

/// What the calling thread is in when it is put into a state: a CPU may lack a part of it.
FloatState asThisCpuHasIt(const FloatState& state);

/// While one lives, the calling thread is in a state. What it computes itself had better not round.
class InFloatState {
  public:
    explicit InFloatState(const FloatState& state);
    ~InFloatState();
    InFloatState(const InFloatState&) = delete;
    InFloatState& operator=(const InFloatState&) = delete;

  private:
    FloatState mBefore;
};

}  // namespace vorel_test
