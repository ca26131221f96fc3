#pragma once

#include <cstddef>

#include "tests/support/float_states.h"
#include "tests/support/levels.h"

/// The library's calls of an input are made in one floating-point state, which its size names beside the
/// level; what they are compared with is computed as a process starts.
namespace vorel_fuzz {

inline vorel_test::FloatState callersState = vorel_test::floatStates().front();

inline void useStateOfInput(size_t size) {
    const auto states = vorel_test::floatStates();
    callersState = states[size / vorel_test::levelsHere().size() % states.size()];
}

/// What the call gives, made in the state of the input.
template <class Call>
auto asCaller(Call call) {
    const vorel_test::InFloatState callers(callersState);
    return call();
}

}  // namespace vorel_fuzz
