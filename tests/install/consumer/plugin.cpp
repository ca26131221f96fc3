#include "painted.h"

/// A plug-in that uses the library and shows this function alone.
extern "C" __attribute__((visibility("default"))) int paints() {
    return paintsFillAndOutline() ? 1 : 0;
}
