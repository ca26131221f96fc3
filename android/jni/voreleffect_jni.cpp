#include <jni.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <new>

#include "org_voreleffect_VorelEffect.h"
#include "voreleffect/VFEffect.h"

// The native side of org.voreleffect.VorelEffect, which checks every argument before it comes here. The
// generated header declares each function below, so that the compiler refuses one that does not fit.

using namespace VFontEffect;

namespace {

constexpr int kMaxStops = 256;
constexpr unsigned int kColourBytes = 4;
constexpr unsigned int kColourFormat = 1;

/// A look and the run that is painted with it.
struct Painter {
    VFEffect look;
    VFBitmap picture;  ///< over the destination of the open run; its pixels belong to the caller

    Painter() = default;
    Painter(const Painter&) = delete;
    Painter& operator=(const Painter&) = delete;
    ~Painter() { picture.mData = nullptr; }
};

Painter& painterOf(jlong handle) {
    return *reinterpret_cast<Painter*>(static_cast<intptr_t>(handle));
}

VFEffect& lookOf(jlong handle) {
    return painterOf(handle).look;
}

unsigned int wordOf(jint bits) {
    return static_cast<unsigned int>(bits);
}

/// An effect id; 0xFFFFFFFF becomes -1.
jint idOf(unsigned int id) {
    return static_cast<jint>(id);
}

void throwOutOfMemory(JNIEnv* env, const char* what) {
    const jclass kind = env->FindClass("java/lang/OutOfMemoryError");
    if (kind != nullptr) env->ThrowNew(kind, what);
}

/// The bytes of a direct buffer from `offset` on; null for a buffer without memory.
unsigned char* bytesOf(JNIEnv* env, jobject buffer, jint offset) {
    auto* const bytes = static_cast<unsigned char*>(env->GetDirectBufferAddress(buffer));
    return bytes != nullptr ? bytes + offset : nullptr;
}

/// Colour stops, read from three arrays of one length.
struct Stops {
    VFGradient stops[kMaxStops];
    int count;

    Stops(JNIEnv* env, jintArray colors, jfloatArray opacities, jfloatArray locations)
        : count(std::min(static_cast<int>(env->GetArrayLength(colors)), kMaxStops)) {
        jint words[kMaxStops];
        jfloat alphas[kMaxStops];
        jfloat places[kMaxStops];
        env->GetIntArrayRegion(colors, 0, count, words);
        env->GetFloatArrayRegion(opacities, 0, count, alphas);
        env->GetFloatArrayRegion(locations, 0, count, places);
        for (int i = 0; i < count; ++i)
            stops[i] = {wordOf(words[i]), alphas[i], places[i]};
    }
};

/// Turns words 0xAARRGGBB, in place, into bytes A, R, G, B.
void spellOut(unsigned char* pixels, size_t count) {
    for (size_t i = 0; i < count; ++i, pixels += kColourBytes) {
        uint32_t word = 0;
        std::memcpy(&word, pixels, sizeof word);
        for (unsigned int channel = 0; channel < kColourBytes; ++channel)
            pixels[channel] = static_cast<unsigned char>(word >> (24 - 8 * channel));
    }
}

/// The characters of a key as a new array; releases the key.
jbyteArray keyArray(JNIEnv* env, char* key) {
    if (key == nullptr) {
        throwOutOfMemory(env, "key");
        return nullptr;
    }
    const auto length = static_cast<jsize>(std::strlen(key));
    const jbyteArray bytes = env->NewByteArray(length);
    if (bytes != nullptr) env->SetByteArrayRegion(bytes, 0, length, reinterpret_cast<const jbyte*>(key));
    delete[] key;
    return bytes;
}

/// Ends a run that was not finished, if there is one. Without a mask nothing is painted, but the next
/// glyph starts a new text box.
void dropRun(Painter& painter) {
    painter.look.releaseBitmap();
    painter.look.doEffectPostProcessing();
    painter.picture.mData = nullptr;
}

}  // namespace

#define VOREL_NATIVE(result, name) \
    extern "C" JNIEXPORT result JNICALL Java_org_voreleffect_VorelEffect_##name

VOREL_NATIVE(jlong, nativeCreate)(JNIEnv* env, jclass) {
    auto* const painter = new (std::nothrow) Painter;
    if (painter == nullptr) throwOutOfMemory(env, "look");
    return static_cast<jlong>(reinterpret_cast<intptr_t>(painter));
}

VOREL_NATIVE(void, nativeDestroy)(JNIEnv*, jclass, jlong painter) {
    delete &painterOf(painter);
}

VOREL_NATIVE(jint, nativeAddOuterShadow)
(JNIEnv*, jclass, jlong painter, jfloat angle, jfloat distance, jfloat size, jint color,
 jfloat opacity) {
    return idOf(lookOf(painter).addOuterShadowText(angle, distance, size, wordOf(color), opacity));
}

VOREL_NATIVE(jint, nativeAddInnerShadow)
(JNIEnv*, jclass, jlong painter, jfloat angle, jfloat distance, jfloat size, jint color,
 jfloat opacity) {
    return idOf(lookOf(painter).addInnerShadowText(angle, distance, size, wordOf(color), opacity));
}

VOREL_NATIVE(jint, nativeAddOuterGlow)
(JNIEnv* env, jclass, jlong painter, jfloat size, jint color, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return idOf(lookOf(painter).addOuterGlowText(size, wordOf(color), opacity, ramp.count, ramp.stops));
}

VOREL_NATIVE(jint, nativeAddInnerGlow)
(JNIEnv* env, jclass, jlong painter, jfloat size, jint color, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return idOf(lookOf(painter).addInnerGlowText(size, wordOf(color), opacity, ramp.count, ramp.stops));
}

VOREL_NATIVE(jint, nativeAddBevel)
(JNIEnv*, jclass, jlong painter, jint style, jfloat size, jfloat depth, jint technique, jint direction,
 jint soften, jfloat opacity, jfloat angle, jfloat altitude, jint highlightColor,
 jfloat highlightOpacity, jint shadowColor, jfloat shadowOpacity) {
    return idOf(lookOf(painter).addBevelText(style, size, depth, technique, direction, soften, opacity,
                                             angle, altitude, wordOf(highlightColor), highlightOpacity,
                                             wordOf(shadowColor), shadowOpacity));
}

VOREL_NATIVE(jint, nativeAddEmboss)
(JNIEnv*, jclass, jlong painter, jint style, jfloat size, jfloat depth, jint technique, jint direction,
 jint soften, jfloat opacity, jfloat angle, jfloat altitude, jint highlightColor,
 jfloat highlightOpacity, jint shadowColor, jfloat shadowOpacity) {
    return idOf(lookOf(painter).addEmbossText(style, size, depth, technique, direction, soften, opacity,
                                              angle, altitude, wordOf(highlightColor), highlightOpacity,
                                              wordOf(shadowColor), shadowOpacity));
}

VOREL_NATIVE(jint, nativeAddLinearGradient)
(JNIEnv* env, jclass, jlong painter, jfloat angle, jfloat scale, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return idOf(lookOf(painter).addLinearGradientText(angle, scale, opacity, ramp.count, ramp.stops));
}

VOREL_NATIVE(jint, nativeAddRadialGradient)
(JNIEnv* env, jclass, jlong painter, jfloat scale, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return idOf(lookOf(painter).addRadialGradientText(scale, opacity, ramp.count, ramp.stops));
}

VOREL_NATIVE(jint, nativeAddStroke)
(JNIEnv*, jclass, jlong painter, jfloat size, jint color, jfloat opacity, jint strokeStyle,
 jint position) {
    return idOf(lookOf(painter).addStrokeText(size, wordOf(color), opacity, strokeStyle, position));
}

VOREL_NATIVE(jint, nativeAddPattern)
(JNIEnv* env, jclass, jlong painter, jintArray pixels, jint width, jint height, jfloat scale,
 jfloat opacity) {
    VFBitmap pattern(wordOf(width), wordOf(height), kColourBytes);
    if (pattern.mData == nullptr) {
        throwOutOfMemory(env, "pattern");
        return -1;
    }
    env->GetIntArrayRegion(pixels, 0, width * height, reinterpret_cast<jint*>(pattern.mData));
    spellOut(pattern.mData, static_cast<size_t>(width) * static_cast<size_t>(height));
    return idOf(lookOf(painter).addPatternText(&pattern, scale, opacity));
}

VOREL_NATIVE(jint, nativeAddText)(JNIEnv*, jclass, jlong painter, jint color, jfloat opacity) {
    return idOf(lookOf(painter).addText(wordOf(color), opacity));
}

VOREL_NATIVE(jboolean, nativeRemoveEffect)(JNIEnv*, jclass, jlong painter, jint id) {
    return lookOf(painter).removeEffect(id) ? JNI_TRUE : JNI_FALSE;
}

VOREL_NATIVE(void, nativeCleanAllEffect)(JNIEnv*, jclass, jlong painter) {
    lookOf(painter).cleanAllEffect();
}

VOREL_NATIVE(void, nativeSetTextOpacity)(JNIEnv*, jclass, jlong painter, jfloat opacity) {
    lookOf(painter).setTextOpacity(opacity);
}

VOREL_NATIVE(jfloat, nativeGetTextOpacity)(JNIEnv*, jclass, jlong painter) {
    return lookOf(painter).getTextOpacity();
}

VOREL_NATIVE(jint, nativeGetLeftOffset)(JNIEnv*, jclass, jlong painter) {
    return lookOf(painter).getLeftOffset();
}

VOREL_NATIVE(jint, nativeGetRightOffset)(JNIEnv*, jclass, jlong painter) {
    return lookOf(painter).getRightOffset();
}

VOREL_NATIVE(jint, nativeGetTopOffset)(JNIEnv*, jclass, jlong painter) {
    return lookOf(painter).getTopOffset();
}

VOREL_NATIVE(jint, nativeGetBottomOffset)(JNIEnv*, jclass, jlong painter) {
    return lookOf(painter).getBottomOffset();
}

VOREL_NATIVE(jbyteArray, nativeGetMapKey)(JNIEnv* env, jclass, jlong painter) {
    return keyArray(env, lookOf(painter).getMapKey());
}

VOREL_NATIVE(jbyteArray, nativeGetMapKeyOfColor)(JNIEnv* env, jclass, jlong painter, jint color) {
    return keyArray(env, lookOf(painter).getMapKey(wordOf(color)));
}

VOREL_NATIVE(void, nativeBegin)
(JNIEnv* env, jclass, jlong painter, jobject destination, jint offset, jint width, jint height) {
    auto& [look, picture] = painterOf(painter);
    dropRun(painterOf(painter));
    look.initEffect(width, height);
    if (look.getSrcBitmap() == nullptr || look.getSrcBitmap()->mData == nullptr) {
        dropRun(painterOf(painter));
        throwOutOfMemory(env, "layers");
        return;
    }
    picture.mWidth = wordOf(width);
    picture.mHeight = wordOf(height);
    picture.mFormat = kColourFormat;
    picture.mBytesPerPixel = kColourBytes;
    picture.mData = bytesOf(env, destination, offset);
    look.setDstBitmap(&picture);
}

VOREL_NATIVE(void, nativeGlyph)
(JNIEnv* env, jclass, jlong painter, jint x, jint y, jobject coverage, jint offset, jint width,
 jint height) {
    VFGlyph glyph = {bytesOf(env, coverage, offset), static_cast<unsigned short>(width),
                     static_cast<unsigned short>(height)};
    lookOf(painter).renderEffectLayer(x, y, &glyph);
}

VOREL_NATIVE(void, nativeFinish)(JNIEnv*, jclass, jlong painter) {
    auto& [look, picture] = painterOf(painter);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    picture.mData = nullptr;
}
