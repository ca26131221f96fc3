#pragma once

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

/// Gives a copy its own stop array, where the record has one.
template <class Record>
auto ownContents(Record& copy, int) -> decltype(copy.mGradient, bool()) {
    const VFGradient* const shared = copy.mGradient;
    if (shared == nullptr) return true;
    const int count = copy.mGradientCount > 0 ? copy.mGradientCount : 0;
    copy.mGradient = new (std::nothrow) VFGradient[static_cast<size_t>(count)];
    for (int i = 0; copy.mGradient != nullptr && i < count; ++i)
        copy.mGradient[i] = shared[i];
    return copy.mGradient != nullptr;
}

/// Gives a copy its own pattern bitmap, where the record has one.
template <class Record>
auto ownContents(Record& copy, int) -> decltype(copy.mPattern, bool()) {
    if (copy.mPattern == nullptr) return true;
    copy.mPattern = new (std::nothrow) VFBitmap(*copy.mPattern);
    return copy.mPattern != nullptr;
}

template <class Record>
bool ownContents(Record& /*copy*/, long) {
    return true;
}

template <class Record>
auto releaseContents(Record& owned, int) -> decltype(owned.mGradient, void()) {
    delete[] owned.mGradient;
}

template <class Record>
auto releaseContents(Record& owned, int) -> decltype(owned.mPattern, void()) {
    delete owned.mPattern;
}

template <class Record>
void releaseContents(Record& /*owned*/, long) {}

/// Destroys a core's own record with the array or bitmap that came with it.
template <class Record>
void releaseCopy(Record* owned) {
    if (owned != nullptr) releaseContents(*owned, 0);
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
    if (!ownContents(*copy, 0)) {
        delete copy;
        return false;
    }
    releaseCopy(stored);
    stored = copy;
    return true;
}

}  // namespace VFontEffect::internal
