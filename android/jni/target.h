#pragma once

#include <jni.h>

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "voreleffect/look.h"

namespace voreljni {

/// What a PictureView of Java views. Memory of a direct buffer is painted on as it is; of an array the
/// part that is needed is copied, and back when it is painted: the collector goes on meanwhile, and a
/// call that fails has changed nothing.
class Target {
  public:
    /// As PictureView.memory and PictureView.numbers tell.
    Target(JNIEnv* env, jobject memory, jintArray numbers);

    /// A view of all that lies within the clip and the box, which is told in pixels of the picture.
    /// Nothing with an exception pending.
    std::optional<VFontEffect::PictureView> open(const VFontEffect::look_internal::WideBox& needed);

    /// Where the view that was opened starts.
    int left() const { return mOpen.left; }
    int top() const { return mOpen.top; }
    /// A box of the opened view in pixels of the picture.
    VFontEffect::Box inPicture(const VFontEffect::Box& box) const;

    /// Writes what was painted. False with an exception pending.
    bool close();

  private:
    enum Kind { kDirect = 0, kBytes = 1, kWords = 2 };

    /// Units, bytes or words, from the start of the memory to a pixel.
    int64_t unitsTo(int x, int y) const;
    VFontEffect::PictureView viewOf(unsigned char* pixels, std::ptrdiff_t stride) const;
    std::optional<VFontEffect::PictureView> openDirect();
    void fetchRow(int row, unsigned char* to);
    void storeRow(int row, unsigned char* from);

    JNIEnv* mEnv;
    jobject mMemory;
    int mKind;
    int mOffset;
    int mStride;
    VFontEffect::PixelOrder mOrder;
    VFontEffect::Box mClip;
    VFontEffect::Box mOpen;
    std::vector<unsigned char> mCopy;  ///< packed rows of what was opened
};

}  // namespace voreljni
