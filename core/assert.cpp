#include "core/assert.h"

#if defined(VOREL_ASSERTIONS)

#include <cstdio>
#include <cstdlib>

namespace VFontEffect::internal {

void contractBroken(const char* condition, const char* file, int line) {
    std::fprintf(stderr, "%s:%d: contract broken: %s\n", file, line, condition);
    std::abort();
}

}  // namespace VFontEffect::internal

#endif
