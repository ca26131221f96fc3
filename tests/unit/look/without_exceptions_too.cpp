#include "tests/unit/look/without_exceptions.h"

VFontEffect::Look outlined() {
    using namespace VFontEffect;
    const unsigned char pixel[] = {0x33, 0x66, 0xCC, 0xFF};
    return Look()
        .fill(rgb(0x3366CC))
        .add(Pattern({pixel, 1, 1}).opacity(0))
        .add(Stroke(1, rgb(0xFFFFFF)));
}
