#pragma once

#include <cstdint>
#include <vector>

/// The plain value types of the literal forms: references written one pixel at a time, which the
/// library's operations and cores are compared with.
namespace vorel_test::literal {

/// Coverage, one byte per pixel, packed rows.
struct Mask {
    int width = 0, height = 0;
    std::vector<uint8_t> bytes;
};

/// Colour, four bytes per pixel in the order R, G, B, A, packed rows.
struct Picture {
    int width = 0, height = 0;
    std::vector<uint8_t> bytes;
};

/// A half-open box of whole pixels.
struct Box {
    int left = 0, top = 0, right = 0, bottom = 0;
};

/// One stop of a gradient: straight 0xAARRGGBB, opacity and location 0 to 1.
struct Stop {
    uint32_t color = 0;
    float opacity = 0.0F;
    float location = 0.0F;
};

}  // namespace vorel_test::literal
