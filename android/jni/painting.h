#pragma once

#include <jni.h>

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "voreleffect/look.h"

// The native side of org.voreleffect.Look, Painter and Picture: what paints on pixels of any kind.

namespace voreljni {

/// The ints of an array that Java has written. What lies beyond its end is 0.
class Numbers {
  public:
    Numbers(JNIEnv* env, jintArray array);

    jint next() { return mNext < mNumbers.size() ? mNumbers[mNext++] : 0; }
    /// A float that was written as its bits.
    float nextFloat();

  private:
    std::vector<jint> mNumbers;
    std::size_t mNext = 0;
};

/// A painter, and the memory that it keeps from call to call.
struct JavaPainter {
    VFontEffect::Painter painter;
    std::vector<VFontEffect::Glyph> glyphs;
    std::vector<unsigned char> coverage;          ///< of the glyphs that are in arrays
    std::optional<VFontEffect::Picture> picture;  ///< painted and not yet taken

    explicit JavaPainter(const std::vector<VFontEffect::Look>& looks) : painter(looks) {}

    /// Takes the glyphs of a call as Glyph.Run writes them. False with an exception pending.
    bool take(JNIEnv* env, jintArray numbers, jobjectArray memory);
};

/// Where Picture.place tells that its pixels are.
struct Place {
    jint width;
    jint height;
    jint left;
    jint top;

    Place(JNIEnv* env, jintArray numbers);
};

/// The pixels of a Picture and their place; null pixels with an exception pending.
VFontEffect::look_internal::Placed placed(JNIEnv* env, jobject pixels, const Place& place, jint x,
                                          jint y);

/// Tells a box that was touched.
void tell(JNIEnv* env, jintArray touched, const VFontEffect::Box& box);

/// Throws what a failure is in Java.
void throwFailure(JNIEnv* env, VFontEffect::Failure why);

}  // namespace voreljni
