#pragma once

/// Forces the inlining of what inner loops call. In a level's namespace, because a real call that passes
/// vectors depends on the level's calling convention; outside of it, because of several objects' copies
/// of a function the linker keeps one, which may hold instructions of a level that the CPU lacks.
#define VOREL_INLINE inline __attribute__((always_inline))
/// The same for a lambda; it stands after the parameter list.
#define VOREL_INLINE_LAMBDA __attribute__((always_inline))
