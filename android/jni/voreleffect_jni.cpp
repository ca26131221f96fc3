#include <jni.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <new>

#include "org_voreleffect_VorelEffect.h"
#include "support.h"
#include "voreleffect/VFEffect.h"

// The native side of org.voreleffect.VorelEffect, which checks every argument before it comes here. The
// generated header declares each function below, so that the compiler refuses one that does not fit.

using namespace VFontEffect;
using namespace voreljni;

namespace {

constexpr int kMaxStops = 256;
constexpr unsigned int kColourBytes = 4;
constexpr unsigned int kColourFormat = 1;
constexpr int kMostKinds = 12;
constexpr const char* kListOfEffects = "list of effects";

VFEffect& lookOf(jlong painter) {
    return at<VFEffect>(painter);
}

unsigned int wordOf(jint bits) {
    return static_cast<unsigned int>(bits);
}

/// An effect id; 0xFFFFFFFF becomes -1.
jint idOf(unsigned int id) {
    return static_cast<jint>(id);
}

/// The id that the add-call gives.
template <class AddCall>
jint added(JNIEnv* env, AddCall addCall) {
    return idOf(orOutOfMemory(env, kListOfEffects, addCall));
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
void dropRun(VFEffect& look) {
    look.releaseBitmap();
    look.doEffectPostProcessing();
}

/// Whether the copy has every effect: one that memory runs out for is missing, or has no record.
bool isWhole(VFEffect& copy, VFEffect& original) {
    for (int kind = 1; kind <= kMostKinds; ++kind) {
        VFECore* const effect = copy.getEffect(kind);
        if (effect == nullptr && original.getEffect(kind) != nullptr) return false;
        if (effect != nullptr && effect->getProperty() == nullptr) return false;
    }
    return true;
}

}  // namespace

#define VOREL_NATIVE(result, name) \
    extern "C" JNIEXPORT result JNICALL Java_org_voreleffect_VorelEffect_##name

VOREL_NATIVE(jlong, nativeCreate)(JNIEnv* env, jclass) {
    auto* const look = new (std::nothrow) VFEffect;
    if (look == nullptr) throwOutOfMemory(env, "look");
    return addressOf(look);
}

VOREL_NATIVE(void, nativeDestroy)(JNIEnv*, jclass, jlong painter) {
    delete &lookOf(painter);
}

// Below, the object stands beside its painter: as an argument it stays reachable until the call has
// returned, so that the painter is not freed under it.

VOREL_NATIVE(jlong, nativeCopy)(JNIEnv* env, jobject, jlong painter) {
    return orOutOfMemory(env, kListOfEffects, [&]() -> jlong {
        auto copy = std::make_unique<VFEffect>(lookOf(painter));
        if (isWhole(*copy, lookOf(painter))) return addressOf(copy.release());
        throwOutOfMemory(env, "look");
        return 0;
    });
}

VOREL_NATIVE(jint, nativeAddOuterShadow)
(JNIEnv* env, jobject, jlong painter, jfloat angle, jfloat distance, jfloat size, jint color,
 jfloat opacity) {
    return added(env, [&] {
        return lookOf(painter).addOuterShadowText(angle, distance, size, wordOf(color), opacity);
    });
}

VOREL_NATIVE(jint, nativeAddInnerShadow)
(JNIEnv* env, jobject, jlong painter, jfloat angle, jfloat distance, jfloat size, jint color,
 jfloat opacity) {
    return added(env, [&] {
        return lookOf(painter).addInnerShadowText(angle, distance, size, wordOf(color), opacity);
    });
}

VOREL_NATIVE(jint, nativeAddOuterGlow)
(JNIEnv* env, jobject, jlong painter, jfloat size, jint color, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return added(env, [&] {
        return lookOf(painter).addOuterGlowText(size, wordOf(color), opacity, ramp.count, ramp.stops);
    });
}

VOREL_NATIVE(jint, nativeAddInnerGlow)
(JNIEnv* env, jobject, jlong painter, jfloat size, jint color, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return added(env, [&] {
        return lookOf(painter).addInnerGlowText(size, wordOf(color), opacity, ramp.count, ramp.stops);
    });
}

VOREL_NATIVE(jint, nativeAddBevel)
(JNIEnv* env, jobject, jlong painter, jint style, jfloat size, jfloat depth, jint technique,
 jint direction, jint soften, jfloat opacity, jfloat angle, jfloat altitude, jint highlightColor,
 jfloat highlightOpacity, jint shadowColor, jfloat shadowOpacity) {
    return added(env, [&] {
        return lookOf(painter).addBevelText(style, size, depth, technique, direction, soften, opacity,
                                            angle, altitude, wordOf(highlightColor), highlightOpacity,
                                            wordOf(shadowColor), shadowOpacity);
    });
}

VOREL_NATIVE(jint, nativeAddEmboss)
(JNIEnv* env, jobject, jlong painter, jint style, jfloat size, jfloat depth, jint technique,
 jint direction, jint soften, jfloat opacity, jfloat angle, jfloat altitude, jint highlightColor,
 jfloat highlightOpacity, jint shadowColor, jfloat shadowOpacity) {
    return added(env, [&] {
        return lookOf(painter).addEmbossText(style, size, depth, technique, direction, soften, opacity,
                                             angle, altitude, wordOf(highlightColor), highlightOpacity,
                                             wordOf(shadowColor), shadowOpacity);
    });
}

VOREL_NATIVE(jint, nativeAddLinearGradient)
(JNIEnv* env, jobject, jlong painter, jfloat angle, jfloat scale, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return added(env, [&] {
        return lookOf(painter).addLinearGradientText(angle, scale, opacity, ramp.count, ramp.stops);
    });
}

VOREL_NATIVE(jint, nativeAddRadialGradient)
(JNIEnv* env, jobject, jlong painter, jfloat scale, jfloat opacity, jintArray colors,
 jfloatArray opacities, jfloatArray locations) {
    Stops ramp(env, colors, opacities, locations);
    return added(env, [&] {
        return lookOf(painter).addRadialGradientText(scale, opacity, ramp.count, ramp.stops);
    });
}

VOREL_NATIVE(jint, nativeAddStroke)
(JNIEnv* env, jobject, jlong painter, jfloat size, jint color, jfloat opacity, jint strokeStyle,
 jint position) {
    return added(env, [&] {
        return lookOf(painter).addStrokeText(size, wordOf(color), opacity, strokeStyle, position);
    });
}

VOREL_NATIVE(jint, nativeAddPattern)
(JNIEnv* env, jobject, jlong painter, jintArray pixels, jint width, jint height, jfloat scale,
 jfloat opacity) {
    VFBitmap pattern(wordOf(width), wordOf(height), kColourBytes);
    if (pattern.mData == nullptr) {
        throwOutOfMemory(env, "pattern");
        return -1;
    }
    env->GetIntArrayRegion(pixels, 0, width * height, reinterpret_cast<jint*>(pattern.mData));
    spellOut(pattern.mData, static_cast<size_t>(width) * static_cast<size_t>(height));
    return added(env, [&] { return lookOf(painter).addPatternText(&pattern, scale, opacity); });
}

VOREL_NATIVE(jint, nativeAddText)(JNIEnv* env, jobject, jlong painter, jint color, jfloat opacity) {
    return added(env, [&] { return lookOf(painter).addText(wordOf(color), opacity); });
}

VOREL_NATIVE(jboolean, nativeRemoveEffect)(JNIEnv*, jobject, jlong painter, jint id) {
    return lookOf(painter).removeEffect(id) ? JNI_TRUE : JNI_FALSE;
}

VOREL_NATIVE(void, nativeCleanAllEffect)(JNIEnv*, jobject, jlong painter) {
    lookOf(painter).cleanAllEffect();
}

VOREL_NATIVE(void, nativeSetTextOpacity)(JNIEnv*, jobject, jlong painter, jfloat opacity) {
    lookOf(painter).setTextOpacity(opacity);
}

VOREL_NATIVE(jfloat, nativeGetTextOpacity)(JNIEnv*, jobject, jlong painter) {
    return lookOf(painter).getTextOpacity();
}

VOREL_NATIVE(jint, nativeGetLeftOffset)(JNIEnv*, jobject, jlong painter) {
    return lookOf(painter).getLeftOffset();
}

VOREL_NATIVE(jint, nativeGetRightOffset)(JNIEnv*, jobject, jlong painter) {
    return lookOf(painter).getRightOffset();
}

VOREL_NATIVE(jint, nativeGetTopOffset)(JNIEnv*, jobject, jlong painter) {
    return lookOf(painter).getTopOffset();
}

VOREL_NATIVE(jint, nativeGetBottomOffset)(JNIEnv*, jobject, jlong painter) {
    return lookOf(painter).getBottomOffset();
}

VOREL_NATIVE(jbyteArray, nativeGetMapKey)(JNIEnv* env, jobject, jlong painter) {
    return keyArray(env, lookOf(painter).getMapKey());
}

VOREL_NATIVE(jbyteArray, nativeGetMapKeyOfColor)(JNIEnv* env, jobject, jlong painter, jint color) {
    char* const key =
        orOutOfMemory(env, kListOfEffects, [&] { return lookOf(painter).getMapKey(wordOf(color)); });
    return env->ExceptionCheck() ? nullptr : keyArray(env, key);
}

VOREL_NATIVE(void, nativeBegin)(JNIEnv* env, jobject, jlong painter, jint width, jint height) {
    VFEffect& look = lookOf(painter);
    dropRun(look);
    look.initEffect(width, height);
    const VFBitmap* const mask = look.getSrcBitmap();
    if (mask == nullptr || mask->mData == nullptr) {
        dropRun(look);
        throwOutOfMemory(env, "layers");
    }
}

VOREL_NATIVE(void, nativeGlyph)
(JNIEnv* env, jobject, jlong painter, jint x, jint y, jobject coverage, jint offset, jint width,
 jint height) {
    const int64_t count = int64_t{width} * height;
    unsigned char* const bytes = bytesOf(env, coverage, offset, count);
    if (bytes == nullptr && count != 0) return;
    VFGlyph glyph = {bytes, static_cast<unsigned short>(width), static_cast<unsigned short>(height)};
    lookOf(painter).renderEffectLayer(x, y, &glyph);
}

VOREL_NATIVE(void, nativeFinish)
(JNIEnv* env, jobject, jlong painter, jobject destination, jint offset) {
    VFEffect& look = lookOf(painter);
    VFBitmap picture;
    picture.mWidth = look.getSrcBitmap()->mWidth;
    picture.mHeight = look.getSrcBitmap()->mHeight;
    picture.mFormat = kColourFormat;
    picture.mBytesPerPixel = kColourBytes;
    const int64_t count = int64_t{picture.mWidth} * picture.mHeight * kColourBytes;
    picture.mData = bytesOf(env, destination, offset, count);
    if (picture.mData == nullptr) return;
    look.setDstBitmap(&picture);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    picture.mData = nullptr;  // the caller's
}
