#include <android/bitmap.h>
#include <jni.h>

#include <cstddef>
#include <cstdint>
#include <optional>

#include "org_voreleffect_VorelBitmaps.h"
#include "painting.h"
#include "support.h"

// The native side of org.voreleffect.VorelBitmaps, for Android alone.

using namespace VFontEffect;
using namespace voreljni;

namespace {

/// A flag of API 30 and newer: the pixels are on the graphics card.
constexpr uint32_t kHardware = 0x80000000U;

/// Why a bitmap cannot be painted on; null when it can. That it is mutable and premultiplied the Java
/// side has seen, which older versions of Android do not tell here.
const char* faultOf(const AndroidBitmapInfo& info) {
    constexpr uint32_t kMost = 0x7FFFFFFF;
    if (info.format != ANDROID_BITMAP_FORMAT_RGBA_8888)
        return "bitmap: not of the configuration ARGB_8888";
    if ((info.flags & kHardware) != 0) return "bitmap: of the configuration HARDWARE";
    if (info.width > kMost / 4 || info.height > kMost || info.stride < uint64_t{info.width} * 4)
        return "bitmap: of a size or a stride that there is not";
    return nullptr;
}

/// The pixels of a bitmap, locked as long as this lives. Without pixels an exception is pending.
class LockedPixels {
  public:
    LockedPixels(JNIEnv* env, jobject bitmap) : mEnv(env), mBitmap(bitmap) { lock(); }
    LockedPixels(const LockedPixels&) = delete;
    LockedPixels& operator=(const LockedPixels&) = delete;

    /// With whatever exception is pending: no call but a few may be made then, so it stands aside.
    ~LockedPixels() {
        if (!mIsLocked) return;
        const jthrowable pending = mEnv->ExceptionOccurred();
        if (pending != nullptr) mEnv->ExceptionClear();
        AndroidBitmap_unlockPixels(mEnv, mBitmap);
        if (pending != nullptr) mEnv->Throw(pending);
    }

    std::optional<PictureView> view() const {
        if (!mIsLocked || mPixels == nullptr) return std::nullopt;
        return PictureView{static_cast<unsigned char*>(mPixels), static_cast<int>(mInfo.width),
                           static_cast<int>(mInfo.height), static_cast<std::ptrdiff_t>(mInfo.stride)};
    }

  private:
    void lock() {
        if (AndroidBitmap_getInfo(mEnv, mBitmap, &mInfo) != ANDROID_BITMAP_RESULT_SUCCESS)
            return refuse("bitmap: recycled, or none");
        const char* const fault = faultOf(mInfo);
        if (fault != nullptr) return refuse(fault);
        const int result = AndroidBitmap_lockPixels(mEnv, mBitmap, &mPixels);
        mIsLocked = result == ANDROID_BITMAP_RESULT_SUCCESS;
        if (mIsLocked && mPixels != nullptr) return;
        if (result == ANDROID_BITMAP_RESULT_ALLOCATION_FAILED && !mEnv->ExceptionCheck())
            return throwOutOfMemory(mEnv, "pixels of the bitmap");
        refuse("bitmap: its pixels cannot be locked; is it recycled?");
    }
    /// What Android has thrown itself says more.
    void refuse(const char* what) {
        if (!mEnv->ExceptionCheck()) throwIllegalArgument(mEnv, what);
    }

    JNIEnv* mEnv;
    jobject mBitmap;
    AndroidBitmapInfo mInfo{};
    void* mPixels = nullptr;
    bool mIsLocked = false;
};

}  // namespace

#define VOREL_BITMAPS(name) extern "C" JNIEXPORT void JNICALL Java_org_voreleffect_VorelBitmaps_##name

// The object of the painter is an argument, so that it stays reachable until the call has returned.
VOREL_BITMAPS(nativePaint)
(JNIEnv* env, jclass, jobject, jlong painter, jintArray glyphs, jobjectArray coverage, jobject bitmap,
 jint x, jint y, jintArray touched) {
    orOutOfMemory(env, "glyphs", [&] {
        JavaPainter& ours = at<JavaPainter>(painter);
        if (!ours.take(env, glyphs, coverage)) return;
        const LockedPixels pixels(env, bitmap);
        const std::optional<PictureView> view = pixels.view();
        if (!view) return;
        const std::optional<Box> box = ours.painter.paint(Glyphs(ours.glyphs), *view, x, y);
        if (!box) return throwFailure(env, ours.painter.failure());
        tell(env, touched, *box);
    });
}

VOREL_BITMAPS(nativeLayOver)
(JNIEnv* env, jclass, jobject picture, jintArray place, jobject bitmap, jint x, jint y,
 jintArray touched) {
    orOutOfMemory(env, "picture", [&] {
        const look_internal::Placed ours = placed(env, picture, Place(env, place), x, y);
        if (env->ExceptionCheck()) return;
        const LockedPixels pixels(env, bitmap);
        const std::optional<PictureView> view = pixels.view();
        if (view) tell(env, touched, ours.layOver(*view).narrow());
    });
}
