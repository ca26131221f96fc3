#include <android/bitmap.h>
#include <jni.h>

// Stands in for Android's libjnigraphics: what is told of a bitmap are the fields of Bitmap.java beside
// it.

namespace {

class Fields {
  public:
    Fields(JNIEnv* env, jobject bitmap)
        : mEnv(env), mBitmap(bitmap), mClass(env->GetObjectClass(bitmap)) {}

    jint number(const char* name) { return mEnv->GetIntField(mBitmap, field(name, "I")); }
    bool flag(const char* name) { return mEnv->GetBooleanField(mBitmap, field(name, "Z")) == JNI_TRUE; }
    void count(const char* name) { mEnv->SetIntField(mBitmap, field(name, "I"), number(name) + 1); }
    void* pixels() {
        const jfieldID memory = field("memory", "Ljava/nio/ByteBuffer;");
        return mEnv->GetDirectBufferAddress(mEnv->GetObjectField(mBitmap, memory));
    }

  private:
    jfieldID field(const char* name, const char* type) { return mEnv->GetFieldID(mClass, name, type); }

    JNIEnv* mEnv;
    jobject mBitmap;
    jclass mClass;
};

}  // namespace

extern "C" {

int AndroidBitmap_getInfo(JNIEnv* env, jobject bitmap, AndroidBitmapInfo* info) {
    Fields fields(env, bitmap);
    const jint result = fields.number("infoResult");
    if (result != ANDROID_BITMAP_RESULT_SUCCESS) return result;
    info->width = static_cast<uint32_t>(fields.number("width"));
    info->height = static_cast<uint32_t>(fields.number("height"));
    info->stride = static_cast<uint32_t>(fields.number("stride"));
    info->format = fields.number("format");
    info->flags = static_cast<uint32_t>(fields.number("flags"));
    return result;
}

int AndroidBitmap_lockPixels(JNIEnv* env, jobject bitmap, void** pixels) {
    Fields fields(env, bitmap);
    const jint result = fields.number("lockResult");
    if (fields.flag("throwsInLock"))
        env->ThrowNew(env->FindClass("java/lang/IllegalStateException"), "thrown by the lock");
    if (result != ANDROID_BITMAP_RESULT_SUCCESS) return result;
    *pixels = fields.flag("hasPixels") ? fields.pixels() : nullptr;
    fields.count("locks");
    return result;
}

int AndroidBitmap_unlockPixels(JNIEnv* env, jobject bitmap) {
    Fields(env, bitmap).count("unlocks");
    return ANDROID_BITMAP_RESULT_SUCCESS;
}

}  // extern "C"
