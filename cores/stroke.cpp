#include <algorithm>
#include <cstdint>

#include "core/blend_modes.h"
#include "core/effect_types.h"
#include "core/numeric.h"
#include "core/pixel_buffer.h"
#include "cores/padded_mask.h"
#include "cores/paint_input.h"
#include "cores/property_copy.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFECore.h"

namespace VFontEffect {

using namespace internal;

namespace {

constexpr int64_t kBorder = 1;

using Dilation = int (*)(void*);

Dilation dilationFor(int position) {
    if (position == kStrokeCentre) return VFStroke::partalDTStrokeCenter;
    return position == kStrokeOutside ? VFStroke::partalDTStrokeOutside : VFStroke::partalDTStrokeInside;
}

/// A centred stroke is what lies within the radius of the edge on both sides of it.
void keepSmaller(Plane& planes, int64_t count) {
    uint8_t* const first = planes.bytes.data();
    const uint8_t* const second = first + count;
    for (int64_t i = 0; i < count; ++i)
        first[i] = std::min(first[i], second[i]);
}

}  // namespace

VFStroke::VFStroke() : mProperty(nullptr) {
    mEffectType = kStroke;
}

VFStroke::~VFStroke() {
    releaseCopy(mProperty);
}

void VFStroke::setProperty(VFProperty* property) {
    replaceCopy(mProperty, property);
}

VFProperty* VFStroke::getProperty() {
    return mProperty;
}

int VFStroke::getOffset() {
    if (mProperty == nullptr) return 0;
    if (mProperty->mPosition == kStrokeOutside) return toInt(mProperty->mSize + 0.5F);
    return mProperty->mPosition == kStrokeCentre ? toInt(mProperty->mSize * 0.5F + 0.5F) : 0;
}

void VFStroke::doPostProcessing(ParamPostProcessing* params) {
    const CoverageBox box = coverageOf(params);
    if (!box || mProperty == nullptr || isAbsurd(mProperty->mSize)) return;
    const bool centred = mProperty->mPosition == kStrokeCentre;

    unsigned char* disc = nullptr;
    const int side = makeCircleKernel(&disc, centred ? mProperty->mSize * 0.5F : mProperty->mSize);
    const PixelBuffer<unsigned char> kernel(disc);
    if (!kernel) return;
    const int radius = side / 2;

    const Plane source = paddedMask(box, kBorder, kBorder);
    const int64_t planeWidth = source.width + 2 * int64_t{radius};
    const int64_t planeHeight = source.height + 2 * int64_t{radius};
    Plane planes = Plane::filled(planeWidth, planeHeight * (centred ? 2 : 1), 0);
    if (!source || !planes) return;

    const int width = saturateToInt(planeWidth);
    const int height = saturateToInt(planeHeight);
    const int sourceHeight = saturateToInt(source.height);
    DilationWork work = {planes.bytes.data(),
                         source.bytes.data(),
                         kernel.data(),
                         saturateToInt(source.width),
                         sourceHeight,
                         width,
                         height,
                         side,
                         0,
                         sourceHeight,
                         radius};
    dilationFor(mProperty->mPosition)(&work);
    if (centred) keepSmaller(planes, planeWidth * planeHeight);

    const int mode = centred && params->useOuterLayer != 1 ? kModeSrcOver : kModeDstOver;
    for (const VFBitmap* target : {params->dstBitmap, params->subDstBitmap}) {
        VFBlender().drawBitmapBlend8(saturateToInt(box.left - kBorder - radius),
                                     saturateToInt(box.top - kBorder - radius), target,
                                     planes.bytes.data(), width, height, width, mProperty->mColor, mode);
    }
}

}  // namespace VFontEffect
