#include "recipe.h"

#include <cstdio>
#include <cstdlib>

void check(bool isTrue, const char* words) {
    if (isTrue) return;
    std::fprintf(stderr, "not so: %s\n", words);
    std::exit(1);
}
