#pragma once

#include <cstdint>
#include <vector>

#include "text/voreltext.h"

namespace vorelpaint {

/// How much time is spent on making a PNG small. The pixels are the same in all.
enum class PngEffort { fast, normal, small };

/// A picture of straight R, G, B, A as a PNG: with one channel of colour where all are greys, without
/// alpha where it is opaque, with a palette where it has at most 256 colours and is not both. Its sides
/// are above 0, and it has fewer than 2^32 pixels.
std::vector<uint8_t> encodedPng(const voreltext::Image& image, PngEffort effort);

}  // namespace vorelpaint
