#pragma once

/// For what the inner loops call outside of their level's namespace: a copy that the linker could share
/// between levels would run one level's instructions at another.
#define VOREL_INLINE inline __attribute__((always_inline))
