#include <voreleffect/look.h>

#include "tests/unit/look/mixed_exceptions.h"

Ending endingWithoutExceptions() {
    return &VFontEffect::look_internal::throwBadAlloc;
}
