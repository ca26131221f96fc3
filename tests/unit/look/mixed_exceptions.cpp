// The modern face in a program of which one source is compiled with exceptions and one without: neither
// takes the functions of the other.
#include "tests/unit/look/mixed_exceptions.h"

#include <voreleffect/look.h>

int main() {
    return endingWithoutExceptions() != &VFontEffect::look_internal::throwBadAlloc ? 0 : 1;
}
