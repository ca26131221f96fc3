#pragma once

#include <jni.h>

#include <cstdint>

// What the native sides of all Java classes share. The Java sides check every argument that a caller may
// get wrong before they come here.

namespace voreljni {

/// The object at an address that Java keeps.
template <class Kind>
Kind& at(jlong address) {
    return *reinterpret_cast<Kind*>(static_cast<intptr_t>(address));
}

/// The address for Java to keep.
inline jlong addressOf(void* object) {
    return static_cast<jlong>(reinterpret_cast<intptr_t>(object));
}

inline void throwNew(JNIEnv* env, const char* className, const char* what) {
    const jclass kind = env->FindClass(className);
    if (kind != nullptr) env->ThrowNew(kind, what);
}

inline void throwOutOfMemory(JNIEnv* env, const char* what) {
    throwNew(env, "java/lang/OutOfMemoryError", what);
}

inline void throwIllegalArgument(JNIEnv* env, const char* what) {
    throwNew(env, "java/lang/IllegalArgumentException", what);
}

/// What `call` gives; an OutOfMemoryError where it throws. It throws for want of memory alone: the
/// exception of a library with a C++ runtime of its own, perhaps, so its type is not asked.
template <class Call>
auto orOutOfMemory(JNIEnv* env, const char* what, const Call& call) -> decltype(call()) {
    try {
        return call();
    } catch (...) {
        throwOutOfMemory(env, what);
        return decltype(call())();
    }
}

/// The bytes of a direct buffer from `offset` on, of which `count` are used. Where the buffer has not so
/// many it throws and gives null. Position and limit are not asked, which any thread may move at any
/// time; the capacity stands.
inline unsigned char* bytesOf(JNIEnv* env, jobject buffer, jint offset, int64_t count) {
    if (count == 0) return nullptr;
    auto* const bytes = static_cast<unsigned char*>(env->GetDirectBufferAddress(buffer));
    if (bytes != nullptr && offset >= 0 && env->GetDirectBufferCapacity(buffer) - offset >= count)
        return bytes + offset;
    throwIllegalArgument(env, "too few bytes in the buffer");
    return nullptr;
}

}  // namespace voreljni
