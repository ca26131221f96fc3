#pragma once

#include <cstddef>
#include <new>

#include "voreleffect/VFProperty.h"

/// How cores take their own deep copy of a record and let go of it.
namespace VFontEffect::internal {

/// The same class of record built anew from another's fields, so that the constructor's clamps and
/// reductions run again. Arrays and bitmaps are still shared. Null when memory ran out.
inline VFTextProperty* rebuilt(const VFTextProperty& p) {
    return new (std::nothrow) VFTextProperty(p.mColor, p.mOpacity);
}
inline VFOuterShadowProperty* rebuilt(const VFOuterShadowProperty& p) {
    return new (std::nothrow)
        VFOuterShadowProperty(p.mAngle, p.mDistance, p.mSize, p.mColor, p.mOpacity);
}
inline VFInnerShadowProperty* rebuilt(const VFInnerShadowProperty& p) {
    return new (std::nothrow)
        VFInnerShadowProperty(p.mAngle, p.mDistance, p.mSize, p.mColor, p.mOpacity);
}
inline VFStrokeProperty* rebuilt(const VFStrokeProperty& p) {
    return new (std::nothrow)
        VFStrokeProperty(p.mSize, p.mColor, p.mOpacity, p.mStrokeStyle, p.mPosition);
}
inline VFOuterGlowProperty* rebuilt(const VFOuterGlowProperty& p) {
    return new (std::nothrow)
        VFOuterGlowProperty(p.mSize, p.mColor, p.mOpacity, p.mGradientCount, p.mGradient);
}
inline VFInnerGlowProperty* rebuilt(const VFInnerGlowProperty& p) {
    return new (std::nothrow)
        VFInnerGlowProperty(p.mSize, p.mColor, p.mOpacity, p.mGradientCount, p.mGradient);
}
inline VFLinearGradientProperty* rebuilt(const VFLinearGradientProperty& p) {
    return new (std::nothrow)
        VFLinearGradientProperty(p.mAngle, p.mScale, p.mOpacity, p.mGradientCount, p.mGradient);
}
inline VFRadialGradientProperty* rebuilt(const VFRadialGradientProperty& p) {
    return new (std::nothrow)
        VFRadialGradientProperty(p.mAngle, p.mScale, p.mOpacity, p.mGradientCount, p.mGradient);
}
inline VFPatternProperty* rebuilt(const VFPatternProperty& p) {
    return new (std::nothrow) VFPatternProperty(p.mPattern, p.mScale, p.mOpacity);
}

/// Puts a copy in the place of a shared stop array; false when memory ran out.
inline bool ownStops(VFGradient*& stops, int count) {
    if (stops == nullptr) return true;
    const VFGradient* const shared = stops;
    const auto own = static_cast<std::size_t>(count > 0 ? count : 0);
    stops = new (std::nothrow) VFGradient[own];
    for (std::size_t i = 0; stops != nullptr && i < own; ++i)
        stops[i] = shared[i];
    return stops != nullptr;
}

/// Puts a copy in the place of a shared bitmap; false when memory ran out.
inline bool ownBitmap(VFBitmap*& bitmap) {
    if (bitmap == nullptr) return true;
    const VFBitmap* const shared = bitmap;
    bitmap = new (std::nothrow) VFBitmap(*shared);
    return bitmap != nullptr && (bitmap->mData != nullptr || shared->mData == nullptr);
}

/// Gives a copy its own array or bitmap, where its class has one. Even when that fails it holds nothing
/// shared afterwards.
inline bool ownContents(VFProperty& /*copy*/) {
    return true;
}
inline bool ownContents(VFOuterGlowProperty& p) {
    return ownStops(p.mGradient, p.mGradientCount);
}
inline bool ownContents(VFInnerGlowProperty& p) {
    return ownStops(p.mGradient, p.mGradientCount);
}
inline bool ownContents(VFLinearGradientProperty& p) {
    return ownStops(p.mGradient, p.mGradientCount);
}
inline bool ownContents(VFRadialGradientProperty& p) {
    return ownStops(p.mGradient, p.mGradientCount);
}
inline bool ownContents(VFPatternProperty& p) {
    return ownBitmap(p.mPattern);
}

inline void releaseContents(VFProperty& /*owned*/) {}
inline void releaseContents(VFOuterGlowProperty& p) {
    delete[] p.mGradient;
}
inline void releaseContents(VFInnerGlowProperty& p) {
    delete[] p.mGradient;
}
inline void releaseContents(VFLinearGradientProperty& p) {
    delete[] p.mGradient;
}
inline void releaseContents(VFRadialGradientProperty& p) {
    delete[] p.mGradient;
}
inline void releaseContents(VFPatternProperty& p) {
    delete p.mPattern;
}

/// Destroys a core's own record with the array or bitmap that came with it.
template <class Record>
void releaseCopy(Record* owned) {
    if (owned != nullptr) releaseContents(*owned);
    delete owned;
}

/// A core's setProperty: puts a deep copy of `given`, which must be of class Record, in the place of
/// `stored`. Returns whether it did: not for null, nor when memory ran out. `given` may be the stored
/// record itself.
template <class Record>
bool replaceCopy(Record*& stored, const VFProperty* given) {
    if (given == nullptr) return false;
    Record* copy = rebuilt(static_cast<const Record&>(*given));
    if (copy == nullptr) return false;
    if (!ownContents(*copy)) {
        releaseCopy(copy);
        return false;
    }
    releaseCopy(stored);
    stored = copy;
    return true;
}

}  // namespace VFontEffect::internal
