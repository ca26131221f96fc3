#pragma once

/// For what the inner loops call. In a level's namespace, because a vector passed to a call would need a
/// calling convention; outside of it, because a copy that the linker could share between levels would
/// run one level's instructions at another.
#define VOREL_INLINE inline __attribute__((always_inline))
/// The same for a lambda, behind its parameters.
#define VOREL_INLINE_LAMBDA __attribute__((always_inline))
