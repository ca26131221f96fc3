#pragma once

/// VOREL_ASSERT(condition): what a layer relies on, said where it relies on it. Builds with
/// VOREL_ASSERTIONS (all that are tested but Release) end the process with a line that names a broken
/// contract; in the others nothing of it is left.
#if defined(VOREL_ASSERTIONS)
namespace VFontEffect::internal {
[[noreturn]] void contractBroken(const char* condition, const char* file, int line);
}
#define VOREL_ASSERT(condition)   \
    (static_cast<bool>(condition) \
         ? static_cast<void>(0)   \
         : ::VFontEffect::internal::contractBroken(#condition, __FILE__, __LINE__))
#else
#define VOREL_ASSERT(condition) static_cast<void>(sizeof(static_cast<bool>(condition)))
#endif
