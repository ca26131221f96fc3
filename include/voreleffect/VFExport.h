#pragma once

/// Marks what the shared library exports; everything else in it is hidden. A program that links the
/// static library, which defines VOREL_STATIC for its callers, does not export it again.
#ifdef VOREL_STATIC
#define VF_API
#else
#define VF_API __attribute__((visibility("default")))
#endif
