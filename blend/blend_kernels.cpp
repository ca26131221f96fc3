#include <cstdint>
#include <cstring>

#include "blend/kernels.h"
#include "blend/rows.h"
#include "blend/rules.h"

namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

/// Whether kBytes pixels are nothing but zeros; the first of them mostly tell.
VOREL_INLINE bool isClear(const uint8_t* pixels) {
    Bytes all = load<Bytes>(pixels);
    if (!allZero(all)) return false;
    for (int64_t i = 1; i < 4; ++i)
        all |= load<Bytes>(pixels + i * kBytes);
    return allZero(all);
}

/// One colour through the mask.
template <class Rule>
struct MaskPainter {
    static constexpr bool kReadsImage = false;
    static constexpr bool kReadsMask = true;
    static constexpr Empty kEmpty = Rule::kEmpty;
    Pixels colour;
    Pixels fullOverNothing;  ///< what full coverage paints over transparent pixels

    VOREL_INLINE bool isEmpty(const Place& place) const { return hasEmptyMask(place); }
    VOREL_INLINE bool paintWhole(const Place& place) const {
        if (!hasFullMask(place) || !isClear(place.destination())) return false;
        for (int64_t x = 0; x < kBytes; x += kPixels)
            storePixels(place.destination() + 4 * x, fullOverNothing);
        return true;
    }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), loadAmounts(place.mask()), colour);
    }
};

struct SolidPainter {
    static constexpr bool kReadsImage = false;
    static constexpr bool kReadsMask = true;
    static constexpr Empty kEmpty = Empty::keeps;
    Pixels colour;

    VOREL_INLINE bool isEmpty(const Place&) const { return false; }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return SolidColour::apply(loadAmounts(place.mask()), colour);
    }
};

/// The image, whose pixels `Load` reads.
template <class Rule, Pixels (*Load)(const uint8_t*)>
struct ImagePainter {
    static constexpr bool kReadsImage = true;
    static constexpr bool kReadsMask = false;
    static constexpr Empty kEmpty = Empty::keeps;

    VOREL_INLINE bool isEmpty(const Place& place) const { return isClear(place.image()); }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), Load(place.image()));
    }
};

/// The image of bytes R, G, B, A and the mask.
template <class Rule>
struct MaskedImagePainter {
    static constexpr bool kReadsImage = true;
    static constexpr bool kReadsMask = true;
    static constexpr Empty kEmpty = Rule::kEmpty;

    VOREL_INLINE bool isEmpty(const Place& place) const { return hasEmptyMask(place); }
    VOREL_INLINE bool paintWhole(const Place&) const { return false; }
    VOREL_INLINE Pixels paint(const Place& place) const {
        return Rule::apply(loadPixels(place.destination()), loadPixels(place.image()),
                           loadAmounts(place.mask()));
    }
};

template <class Rule>
void blendMask(const BlendJob& job) {
    const Pixels colour = spreadColour(job.color);
    uint8_t full[kPixels];
    std::memset(full, 255, sizeof full);
    const Pixels fullOverNothing = Rule::apply(Pixels{}, loadAmounts(full), colour);
    paintRows(MaskPainter<Rule>{colour, fullOverNothing}, job);
}

void solidColour(const BlendJob& job) {
    paintRows(SolidPainter{spreadColour(job.color)}, job);
}

template <class Rule, Pixels (*Load)(const uint8_t*)>
void blendImage(const BlendJob& job) {
    paintRows(ImagePainter<Rule, Load>{}, job);
}

template <class Rule>
void blendMaskedImage(const BlendJob& job) {
    paintRows(MaskedImagePainter<Rule>{}, job);
}

void largerCoverage(const BlendJob& job) {
    for (int64_t y = 0; y < job.height; ++y) {
        uint8_t* const destination = job.destination + y * job.destinationStride;
        const uint8_t* const mask = job.mask + y * job.maskStride;
        int64_t x = 0;
        for (; x + kBytes <= job.width; x += kBytes)
            store(destination + x, larger(load<Bytes>(destination + x), load<Bytes>(mask + x)));
        for (; x < job.width; ++x)
            destination[x] = larger(destination[x], mask[x]);
    }
}

}  // namespace

extern const BlendKernels kBlendKernels = {
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
    largerCoverage,
};

}  // namespace VFontEffect::internal::VOREL_LEVEL
