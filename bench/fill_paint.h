#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

/// The ramp and the tile that fills, looks and peers share.
namespace vorel_bench {

constexpr int kTileSide = 32;
constexpr float kTileScale = 1.5F;

/// Three opaque stops of any record with colour, opacity and location in this order.
template <class Stop>
std::vector<Stop> rampStops() {
    return {{0xFFFFD000U, 1.0F, 0.0F}, {0xFFE02010U, 1.0F, 0.5F}, {0xFF2030C0U, 1.0F, 1.0F}};
}

/// A soft diagonal weave of kTileSide x kTileSide pixels in A, R, G, B, opaque.
inline std::vector<uint8_t> tileBytes() {
    std::vector<uint8_t> bytes;
    for (int y = 0; y < kTileSide; ++y) {
        for (int x = 0; x < kTileSide; ++x) {
            const auto slope = static_cast<uint8_t>((x + y) * 255 / (2 * kTileSide - 2));
            const auto weave = static_cast<uint8_t>((x / 8 + y / 8) % 2 * 160 + 40);
            bytes.insert(bytes.end(), {255, slope, weave, static_cast<uint8_t>(255 - slope)});
        }
    }
    return bytes;
}

}  // namespace vorel_bench
