#include "blend/blend_loops.h"

#include <cstdint>
#include <cstring>

#include "blend/rows.h"
#include "blend/rules.h"
#include "simd/pieces.h"

namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

/// One colour through the mask.
template <class Rule>
struct MaskPainter : MaskReader<Rule::kEmpty, Rule::kIsSparse> {
    Pixels colour;
    Pixels fullOverNothing;  ///< what full coverage paints over transparent pixels

    VOREL_INLINE bool paintWhole(const Place& place) const {
        // Full coverage alone is worth it where vectors are looked at one by one anyway, or hold as many
        // pixels.
        if ((Rule::kIsSparse || kPixels == kBytes) && !hasFullMask(place)) return false;
        if (!isClear<kBytes>(place.destination())) return false;
        const bool isFull = hasFullMask(place);
        for (int64_t x = 0; x < kBytes; x += kPixels) {
            storePixels(
                place.destination() + 4 * x,
                isFull ? fullOverNothing : Rule::apply(Pixels{}, loadAmounts(place.mask() + x), colour));
        }
        return true;
    }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), loadAmounts(place.mask()), colour);
    }
};

struct SolidPainter : MaskReader<> {
    Pixels colour;

    template <int64_t>
    VOREL_INLINE bool isEmpty(const Place&) const {
        return false;
    }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return SolidColour::apply(loadAmounts(place.mask()), colour);
    }
};

/// The image, whose pixels `Load` reads.
template <class Rule, Pixels (*Load)(const uint8_t*)>
struct ImagePainter {
    static constexpr bool kReadsImage = true;
    static constexpr bool kReadsMask = false;
    static constexpr bool kIsSparse = false;
    static constexpr Empty kEmpty = Empty::keeps;

    template <int64_t kCount>
    VOREL_INLINE bool isEmpty(const Place& place) const {
        return isClear<kCount>(place.image());
    }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), Load(place.image()));
    }
};

/// The image of bytes R, G, B, A and the mask.
template <class Rule>
struct MaskedImagePainter : MaskReader<Rule::kEmpty, false, true> {
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), loadPixels(place.image()),
                           loadAmounts(place.mask()));
    }
};

template <class Rule>
void blendMask(const BlendJob& job) {
    const Pixels colour = splatColour(job.color);
    uint8_t full[kPixels];
    std::memset(full, 255, sizeof full);
    const Pixels fullOverNothing = Rule::apply(Pixels{}, loadAmounts(full), colour);
    paintRows(MaskPainter<Rule>{{}, colour, fullOverNothing}, job);
}

void solidColour(const BlendJob& job) {
    paintRows(SolidPainter{{}, splatColour(job.color)}, job);
}

template <class Rule, Pixels (*Load)(const uint8_t*)>
void blendImage(const BlendJob& job) {
    paintRows(ImagePainter<Rule, Load>{}, job);
}

template <class Rule>
void blendMaskedImage(const BlendJob& job) {
    paintRows(MaskedImagePainter<Rule>{}, job);
}

void maxCoverage(const BlendJob& job) {
    // A column of vectors after the other, as glyphs are a few vectors wide; in bands that stay in the
    // cache, as whole layers are not.
    constexpr int64_t kBandRows = 64;
    for (int64_t top = 0; top < job.height; top += kBandRows) {
        const int64_t end = min(top + kBandRows, job.height);
        forPieces(job.width, [&](auto v, int64_t x) VOREL_INLINE_LAMBDA {
            using V = decltype(v);
            for (int64_t y = top; y < end; ++y) {
                uint8_t* const destination = job.destination + y * job.destinationStride + x;
                const auto mask = load<V>(job.mask + y * job.maskStride + x);
                store(destination, max(load<V>(destination), mask));
            }
        });
    }
}

}  // namespace

extern const BlendLoops kBlendLoops = {
    blendMask<SrcOverMask>,
    blendMask<DstOverMask>,
    blendMask<DstOverGate>,
    blendMask<DstOverClip>,
    solidColour,
    blendImage<SrcOver, loadWords>,
    blendImage<DstOver, loadWords>,
    blendImage<DstOver, loadArgb>,
    blendImage<DstOver, loadPixels>,
    blendMaskedImage<DstOverWhereCovered>,
    blendMaskedImage<MixByCoverage>,
    maxCoverage,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
