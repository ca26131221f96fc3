#include "ops/tile/tile_loops.h"

#include <cstdint>

#include "core/fixed_point.h"
#include "simd/lanes.h"

/// Bilinear samples of a pattern, in two steps: along its columns, then between its rows.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

/// Two bytes of each word times the weight in both of its lanes: 255 * 255 fits in 16 bits.
VOREL_INLINE U16s weighted(U32s bytes, U32s weight) {
    return bitCast<U16s>(bytes) * bitCast<U16s>(weight);
}

// Deliberate: pattern pixels stand in memory as A, R, G, B, unlike the destination's.
void mixColumns(const uint32_t* patternRow, const ColumnTaps& taps, int64_t count, const MixedRow& out) {
    const auto pixelsAt = [patternRow](const int32_t* columns) {
        const U32s argb = gather(patternRow, load<I32s>(columns));
        return argb >> 8 | argb << 24;
    };
    const ColumnTaps from = taps;
    const MixedRow to = out;
    for (int64_t x = 0; x < count; x += kU32Lanes) {
        const U32s near = pixelsAt(from.near + x);
        const U32s far = pixelsAt(from.far + x);
        const auto nearWeight = load<U32s>(from.nearWeights + x);
        const auto farWeight = load<U32s>(from.farWeights + x);
        store(to.redBlue + x,
              weighted(near & kEvenBytes, nearWeight) + weighted(far & kEvenBytes, farWeight));
        store(to.greenAlpha + x,
              weighted(near >> 8 & kEvenBytes, nearWeight) + weighted(far >> 8 & kEvenBytes, farWeight));
    }
}

// Deliberate: weights of 255 and a shift by 16 sample an opaque pattern as 253.
void mixRows(const MixedRow& near, const MixedRow& far, uint32_t nearWeight, uint32_t farWeight,
             float opacity, int64_t count, uint32_t* out) {
    const auto n = splat<U16s>(static_cast<uint16_t>(nearWeight));
    const auto f = splat<U16s>(static_cast<uint16_t>(farWeight));
    const MixedRow first = near;
    const MixedRow second = far;
    for (int64_t x = 0; x < count; x += kU32Lanes) {
        const auto mixed = [=](const uint32_t* nearRow, const uint32_t* farRow) VOREL_INLINE_LAMBDA {
            return multiplyHighSum(load<U16s>(nearRow + x), n, load<U16s>(farRow + x), f);
        };
        const U16s redBlue = mixed(first.redBlue, second.redBlue);
        const auto greenAlpha = bitCast<U32s>(mixed(first.greenAlpha, second.greenAlpha));
        const auto straightAlpha = bitCast<I32s>(greenAlpha >> 16);
        const U32s alpha = toIntUpTo<255>(__builtin_convertvector(straightAlpha, F32s) * opacity);
        const U16s factor = inBothHalves(alpha);
        // Products before their shift, 256 * alpha in the place of the alpha's own.
        const auto green = bitCast<U16s>((greenAlpha & 0xFFFFU) + 0x01000001U);
        store(out + x, upperBytesInTurn((redBlue + 1) * factor, green * factor));
    }
}

}  // namespace

extern const TileLoops kTileLoops = {mixColumns, mixRows};

}  // namespace VFontEffect::internal::VOREL_LEVEL
