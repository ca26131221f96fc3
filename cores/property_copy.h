#pragma once

#include <algorithm>
#include <cstddef>
#include <new>

#include "voreleffect/VFProperty.h"

/// How cores take their own deep copy of a record and let go of it.
namespace VFontEffect::internal {

/// The fields of a record, as the parameters of its constructor name them. What a field owns in a copy
/// is told by its type: a stop array, a bitmap, or nothing.
template <auto... Field>
struct Fields {
    /// The same class of record built anew from another's fields, so that the constructor's clamps and
    /// reductions run again. Arrays and bitmaps are still shared. Null when memory ran out.
    template <class Record>
    [[nodiscard]] static Record* rebuilt(const Record& p) {
        return new (std::nothrow) Record(p.*Field...);
    }

    /// Puts copies in the place of the shared array or bitmap; false when memory ran out. Even then the
    /// record holds nothing shared afterwards.
    template <class Record>
    [[nodiscard]] static bool ownContents(Record& copy) {
        bool owned = true;
        ((owned = own(copy, copy.*Field) && owned), ...);
        return owned;
    }

    template <class Record>
    static void releaseContents(Record& owned) {
        (release(owned.*Field), ...);
    }

  private:
    template <class Record, class Number>
    [[nodiscard]] static bool own(const Record& /*copy*/, Number& /*number*/) {
        return true;
    }
    template <class Record>
    [[nodiscard]] static bool own(const Record& copy, VFGradient*& stops) {
        if (stops == nullptr) return true;
        const VFGradient* const shared = stops;
        const auto count = static_cast<std::size_t>(std::max(copy.mGradientCount, 0));
        stops = new (std::nothrow) VFGradient[count];
        if (stops != nullptr) std::copy_n(shared, count, stops);
        return stops != nullptr;
    }
    template <class Record>
    [[nodiscard]] static bool own(const Record& /*copy*/, VFBitmap*& bitmap) {
        if (bitmap == nullptr) return true;
        const VFBitmap* const shared = bitmap;
        bitmap = new (std::nothrow) VFBitmap(*shared);
        return bitmap != nullptr && (bitmap->mData != nullptr || shared->mData == nullptr);
    }

    template <class Number>
    static void release(const Number& /*number*/) {}
    static void release(VFGradient* stops) { delete[] stops; }
    static void release(VFBitmap* bitmap) { delete bitmap; }
};

template <class R>
using ShadowFields = Fields<&R::mAngle, &R::mDistance, &R::mSize, &R::mColor, &R::mOpacity>;
template <class R>
using GlowFields = Fields<&R::mSize, &R::mColor, &R::mOpacity, &R::mGradientCount, &R::mGradient>;
template <class R>
using GradientFields = Fields<&R::mAngle, &R::mScale, &R::mOpacity, &R::mGradientCount, &R::mGradient>;

/// The fields of each record that a core keeps.
template <class Record>
struct FieldsOf;
template <>
struct FieldsOf<VFTextProperty> : Fields<&VFTextProperty::mColor, &VFTextProperty::mOpacity> {};
template <>
struct FieldsOf<VFOuterShadowProperty> : ShadowFields<VFOuterShadowProperty> {};
template <>
struct FieldsOf<VFInnerShadowProperty> : ShadowFields<VFInnerShadowProperty> {};
template <>
struct FieldsOf<VFStrokeProperty>
    : Fields<&VFStrokeProperty::mSize, &VFStrokeProperty::mColor, &VFStrokeProperty::mOpacity,
             &VFStrokeProperty::mStrokeStyle, &VFStrokeProperty::mPosition> {};
template <>
struct FieldsOf<VFOuterGlowProperty> : GlowFields<VFOuterGlowProperty> {};
template <>
struct FieldsOf<VFInnerGlowProperty> : GlowFields<VFInnerGlowProperty> {};
template <>
struct FieldsOf<VFLinearGradientProperty> : GradientFields<VFLinearGradientProperty> {};
template <>
struct FieldsOf<VFRadialGradientProperty> : GradientFields<VFRadialGradientProperty> {};
template <>
struct FieldsOf<VFPatternProperty>
    : Fields<&VFPatternProperty::mPattern, &VFPatternProperty::mScale, &VFPatternProperty::mOpacity> {};

/// Destroys a core's own record with the array or bitmap that came with it.
template <class Record>
void releaseCopy(Record* owned) {
    if (owned != nullptr) FieldsOf<Record>::releaseContents(*owned);
    delete owned;
}

/// A core's setProperty: puts a deep copy of `given`, which must be of class Record, in the place of
/// `stored`. Returns whether it did: not for null, nor when memory ran out; only a core that derives
/// numbers from its record needs to know. `given` may be the stored record itself.
template <class Record>
bool replaceCopy(Record*& stored, const VFProperty* given) {
    if (given == nullptr) return false;
    Record* copy = FieldsOf<Record>::rebuilt(static_cast<const Record&>(*given));
    if (copy == nullptr) return false;
    if (!FieldsOf<Record>::ownContents(*copy)) {
        releaseCopy(copy);
        return false;
    }
    releaseCopy(stored);
    stored = copy;
    return true;
}

}  // namespace VFontEffect::internal

// clang-format off
/// Defines what all cores do alike that keep their record in `mProperty` and derive nothing from it.
#define VOREL_KEEPS_RECORD(Core, type)                                                             \
    Core::Core() : mProperty(nullptr) { mEffectType = type; }                                      \
    Core::~Core() { internal::releaseCopy(mProperty); }                                            \
    void Core::setProperty(VFProperty* property) { internal::replaceCopy(mProperty, property); }   \
    VFProperty* Core::getProperty() { return mProperty; }
// clang-format on
