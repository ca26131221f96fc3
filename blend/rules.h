#pragma once

#include "simd/pixels.h"

/// Every per-pixel rule of blending, once, over vectors of pixels.
///
/// Branches that the arithmetic takes by itself are not spelled out: product(x, 0) = 0,
/// product(x, 255) = x and product(0, y) = 0, so a factor of 0 or 255 needs no case of its own.
namespace VFontEffect::internal::VOREL_LEVEL {

/// What an empty mask, or an image of nothing but zeros, does to the destination.
enum class Empty { keeps, clears, copiesImage };

/// `source`, of pixels or their halves, under the destination, in the pixels that are `painted`;
/// elsewhere source must be 0. Over a transparent destination it takes the pixel whole, whatever colour
/// channels stood there.
template <class Source>
VOREL_INLINE Pixels under(const Pixels& d, const Source& source, Where painted) {
    if (isClear(d)) return joined(source);
    const Amounts rest = inverseAlphaOf(d);
    const Pixels base = cleared(isFull(rest) & painted, d);
    return added(base, joined(scaled(source, rest)));
}

// --- One colour through a mask --------------------------------------------------------------------

/// Colour times mask over the destination.
struct SrcOverMask {
    static constexpr Empty kEmpty = Empty::keeps;
    static constexpr bool kIsSparse = false;

    static VOREL_INLINE Pixels apply(const Pixels& d, Amounts mask, const Pixels& colour) {
        const Pixels product = scaled(colour, mask);
        // A colour channel above its alpha may outlast it; nothing of it is painted.
        const Pixels source = cleared(isTransparent(product), product);
        return added(scaled(d, inverseAlphaOf(source)), source);
    }
};

/// Colour times mask under the destination.
struct DstOverMask {
    static constexpr Empty kEmpty = Empty::keeps;
    static constexpr bool kIsSparse = false;

    static VOREL_INLINE Pixels apply(const Pixels& d, Amounts mask, const Pixels& colour) {
        return under(d, scaled(halvesOf(colour), mask), ~isZero(mask));
    }
};

/// Colour under the destination wherever the mask is not 0. Deliberate: the mask does not scale it.
struct DstOverGate {
    static constexpr Empty kEmpty = Empty::keeps;
    static constexpr bool kIsSparse = true;

    static VOREL_INLINE Pixels apply(const Pixels& d, Amounts mask, const Pixels& colour) {
        const Where painted = ~isZero(mask);
        return under(d, kept(painted, colour), painted);
    }
};

/// Colour under the destination, then the whole pixel times the mask. Deliberate: erases whatever lies
/// where the mask is 0.
///
/// With p = product, m the mask, d the destination, s = p(colour, m) and i = 255 - d.alpha, the rule is
/// told in five branches. One expression does for all of them,
///
///     min(p(d + p(s, i), m), 255)      with d = 0 and the last m = 255 where d.alpha is 0:
///
/// - m = 0: 0. So are s and p(0, i); d is times 0, or 0 itself where the last m is 255.
/// - d.alpha = 0: s. There i = 255, and p(s, 255) = s, twice.
/// - m = 255: min(d + p(colour, i), 255). There s = colour; p(sum, 255) is the sum up to 255, and 255 or
///   more above.
/// - d.alpha = 255: p(d, m), of which the alpha is m. There i = 0, and p(255, m) = m.
/// - otherwise: as it stands; the sum may reach 510.
struct DstOverClip {
    static constexpr Empty kEmpty = Empty::clears;
    static constexpr bool kIsSparse = true;

    static VOREL_INLINE Pixels apply(const Pixels& d, Amounts mask, const Pixels& colour) {
        const Amounts rest = inverseAlphaOf(d);
        const Where empty = isFull(rest);
        const Halves beneath = scaled(inWholeVectors(scaled(halvesOf(colour), mask)), rest);
        return scaledSum(filled(empty, inverse(d)), beneath, raisedToFull(empty, mask));
    }
};

// --- A colour image -------------------------------------------------------------------------------

/// Source over destination.
struct SrcOver {
    static VOREL_INLINE Pixels apply(const Pixels& d, const Pixels& source) {
        return added(source, scaled(d, inverseAlphaOf(source)));
    }
};

/// Source under destination.
struct DstOver {
    static VOREL_INLINE Pixels apply(const Pixels& d, const Pixels& source) {
        const Where painted = ~isTransparent(source);
        return under(d, kept(painted, source), painted);
    }
};

/// Source under destination wherever the mask is not 0. Deliberate: the mask does not scale it.
struct DstOverWhereCovered {
    static constexpr Empty kEmpty = Empty::keeps;

    static VOREL_INLINE Pixels apply(const Pixels& d, const Pixels& source, Amounts mask) {
        return DstOver::apply(d, cleared(isZero(mask), source));
    }
};

// --- Layers ---------------------------------------------------------------------------------------

/// The destination where the glyph covers, the outer layer where it does not.
struct MixByCoverage {
    static constexpr Empty kEmpty = Empty::copiesImage;

    static VOREL_INLINE Pixels apply(const Pixels& d, const Pixels& outer, Amounts mask) {
        return sumOf(scaled(halvesOf(outer), inverse(mask)), scaled(halvesOf(d), mask));
    }
};

// --- Copies ---------------------------------------------------------------------------------------

/// The colour with its alpha times the mask.
struct SolidColour {
    static VOREL_INLINE Pixels apply(Amounts mask, const Pixels& colour) {
        return withAlphaOf(colour, scaled(colour, mask));
    }
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
