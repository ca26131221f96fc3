#pragma once

#include "blend/lanes.h"
#include "core/fixed_point.h"

/// Every per-pixel rule of the blending kernels, once, over a lane type L. Channels are 0..255 in
/// 16-bit lanes; `product` is the fixed-point product of core/fixed_point.h.
namespace VFontEffect::internal {

template <class L>
struct Pixel {
    L red;
    L green;
    L blue;
    L alpha;
};

/// The same operation on two pixels, channel by channel.
template <class L, class Operation>
Pixel<L> perChannel(const Pixel<L>& a, const Pixel<L>& b, Operation operation) {
    return {operation(a.red, b.red), operation(a.green, b.green), operation(a.blue, b.blue),
            operation(a.alpha, b.alpha)};
}

template <class L>
Pixel<L> select(L mask, const Pixel<L>& a, const Pixel<L>& b) {
    return perChannel(a, b, [mask](L x, L y) { return select(mask, x, y); });
}

/// Each channel times `factor`.
template <class L>
Pixel<L> scaled(const Pixel<L>& pixel, L factor) {
    return {product(pixel.red, factor), product(pixel.green, factor), product(pixel.blue, factor),
            product(pixel.alpha, factor)};
}

/// min(x, 255).
template <class L>
L saturated(L x) {
    return smaller(x, L(255));
}

/// Channel-wise a + b, saturated.
template <class L>
Pixel<L> added(const Pixel<L>& a, const Pixel<L>& b) {
    return perChannel(a, b, [](L x, L y) { return saturated(x + y); });
}

/// product(x, y) for x up to 511, whose intermediate would need 17 bits: with x + 1 = 256 h + l the
/// result is h * y + (l * y >> 8), exactly.
template <class L>
L wideProduct(L x, L y) {
    const L grown = x + L(1);
    return (grown >> 8) * y + (((grown & L(255)) * y) >> 8);
}

/// Larger coverage wins.
struct LargerCoverage {
    template <class L>
    static L apply(L destination, L mask) {
        return larger(destination, mask);
    }
};

// --- One colour through a mask --------------------------------------------------------------------

/// Colour times mask over the destination.
struct SrcOverMask {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, L mask, const Pixel<L>& colour) {
        const Pixel<L> source = scaled(colour, mask);
        const L inverse = L(255) - source.alpha;
        const Pixel<L> over = added(scaled(d, inverse), source);
        return select(equal(source.alpha, L(0)), d, select(equal(inverse, L(0)), colour, over));
    }
};

/// Colour times mask under the destination.
struct DstOverMask {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, L mask, const Pixel<L>& colour) {
        const Pixel<L> source = scaled(colour, mask);
        const Pixel<L> under = added(d, scaled(source, L(255) - d.alpha));
        const L kept = equal(d.alpha, L(255)) | equal(mask, L(0));
        return select(kept, d, select(equal(d.alpha, L(0)), source, under));
    }
};

/// Colour under the destination wherever the mask is not 0. Deliberate: the mask does not scale it.
struct DstOverGate {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, L mask, const Pixel<L>& colour) {
        const Pixel<L> under = added(d, scaled(colour, L(255) - d.alpha));
        const L kept = equal(d.alpha, L(255)) | equal(mask, L(0));
        return select(kept, d, select(equal(d.alpha, L(0)), colour, under));
    }
};

/// Colour under the destination, then the whole pixel times the mask. Deliberate: erases whatever lies
/// where the mask is 0.
struct DstOverClip {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, L mask, const Pixel<L>& colour) {
        const Pixel<L> source = scaled(colour, mask);
        const L inverse = L(255) - d.alpha;

        // Full coverage: a plain destination-over.
        Pixel<L> full = added(d, scaled(colour, inverse));
        full.alpha = saturated(d.alpha + product(source.alpha, inverse));

        // Partial coverage. Colour and alpha are multiplied by the mask after the sum, which may
        // reach 508; over an opaque destination the alpha is the mask itself.
        const Pixel<L> sum = perChannel(d, scaled(source, inverse), [](L x, L y) { return x + y; });
        const Pixel<L> clipped = {
            saturated(wideProduct(sum.red, mask)), saturated(wideProduct(sum.green, mask)),
            saturated(wideProduct(sum.blue, mask)), saturated(wideProduct(sum.alpha, mask))};

        const L opaque = equal(d.alpha, L(255));
        Pixel<L> partial =
            select(opaque, perChannel(d, d, [mask](L x, L) { return product(x, mask); }), clipped);
        partial.alpha = select(opaque, mask, clipped.alpha);

        const Pixel<L> covered = select(equal(mask, L(255)), full, partial);
        const Pixel<L> painted = select(equal(d.alpha, L(0)), source, covered);
        const Pixel<L> cleared = {L(0), L(0), L(0), L(0)};
        return select(equal(mask, L(0)), cleared, painted);
    }
};

// --- A colour image -------------------------------------------------------------------------------

/// Source over destination.
struct SrcOver {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, const Pixel<L>& source) {
        const Pixel<L> over = added(source, scaled(d, L(255) - source.alpha));
        return select(equal(source.alpha, L(255)), source, over);
    }
};

/// Source under destination.
struct DstOver {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, const Pixel<L>& source) {
        const Pixel<L> under = added(d, scaled(source, L(255) - d.alpha));
        const L kept = equal(d.alpha, L(255)) | equal(source.alpha, L(0));
        return select(kept, d, select(equal(d.alpha, L(0)), source, under));
    }
};

// --- Layers ---------------------------------------------------------------------------------------

/// The destination where the glyph covers, the outer layer where it does not.
struct MixByCoverage {
    template <class L>
    static Pixel<L> apply(const Pixel<L>& d, const Pixel<L>& outer, L mask) {
        return added(scaled(outer, L(255) - mask), scaled(d, mask));
    }
};

}  // namespace VFontEffect::internal
