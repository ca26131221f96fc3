#include <jni.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "org_voreleffect_Look.h"
#include "org_voreleffect_Painter.h"
#include "org_voreleffect_Picture.h"
#include "painting.h"
#include "support.h"
#include "target.h"

// The native side of org.voreleffect.Look, Painter and Picture: look.h as it is. The generated headers
// declare each function below, so that the compiler refuses one that does not fit.

using namespace VFontEffect;
using namespace voreljni;

namespace {

/// An effect as Effect.write tells it.
struct EffectNumbers {
    int kind;
    Color color;
    float opacity;
    float angle;
    float distance;
    float size;
    float scale;
    Position position;
    std::vector<Stop> stops;
};

EffectNumbers nextEffect(Numbers& numbers) {
    EffectNumbers told{};
    told.kind = numbers.next();
    told.color = rgb(static_cast<unsigned int>(numbers.next()));
    told.opacity = numbers.nextFloat();
    told.angle = numbers.nextFloat();
    told.distance = numbers.nextFloat();
    told.size = numbers.nextFloat();
    told.scale = numbers.nextFloat();
    told.position = static_cast<Position>(numbers.next());
    const jint count = numbers.next();
    for (jint i = 0; i < count; ++i) {
        const Color color = rgb(static_cast<unsigned int>(numbers.next()));
        const float opacity = numbers.nextFloat();
        told.stops.push_back({color, opacity, numbers.nextFloat()});
    }
    return told;
}

/// The pixels of a pattern: words 0xAARRGGBB behind their width and height, spelt out as R, G, B, A.
class Tile {
  public:
    Tile(JNIEnv* env, jintArray words) {
        if (words == nullptr) return;
        jint size[2] = {0, 0};
        env->GetIntArrayRegion(words, 0, 2, size);
        mWidth = size[0];
        mHeight = size[1];
        std::vector<jint> row(static_cast<std::size_t>(mWidth));
        mBytes.reserve(static_cast<std::size_t>(mWidth) * static_cast<std::size_t>(mHeight) * 4);
        for (jint y = 0; y < mHeight; ++y) {
            env->GetIntArrayRegion(words, 2 + y * mWidth, mWidth, row.data());
            for (const jint word : row)
                take(static_cast<uint32_t>(word));
        }
    }
    PixelView view() const { return {mBytes.data(), mWidth, mHeight}; }

  private:
    void take(uint32_t argb) {
        for (const unsigned int shift : {16U, 8U, 0U, 24U})
            mBytes.push_back(static_cast<unsigned char>(argb >> shift));
    }

    std::vector<unsigned char> mBytes;
    jint mWidth = 0;
    jint mHeight = 0;
};

template <class Shadow>
Shadow shadowOf(const EffectNumbers& e) {
    return Shadow(e.color).angle(e.angle).distance(e.distance).size(e.size).opacity(e.opacity);
}

template <class Glow>
Glow glowOf(const EffectNumbers& e) {
    return Glow(e.size, e.color).opacity(e.opacity).stops(e.stops);
}

void addTo(Look& look, const EffectNumbers& e, const PixelView& tile) {
    switch (e.kind) {
        case look_internal::kOuterShadow:
            look.add(shadowOf<OuterShadow>(e));
            break;
        case look_internal::kInnerShadow:
            look.add(shadowOf<InnerShadow>(e));
            break;
        case look_internal::kOuterGlow:
            look.add(glowOf<OuterGlow>(e));
            break;
        case look_internal::kInnerGlow:
            look.add(glowOf<InnerGlow>(e));
            break;
        case look_internal::kLinearGradient:
            look.add(LinearGradient(e.stops).angle(e.angle).scale(e.scale).opacity(e.opacity));
            break;
        case look_internal::kRadialGradient:
            look.add(RadialGradient(e.stops).scale(e.scale).opacity(e.opacity));
            break;
        case look_internal::kStroke:
            look.add(Stroke(e.size, e.color).opacity(e.opacity).position(e.position));
            break;
        default:
            look.add(Pattern(tile).scale(e.scale).opacity(e.opacity));
    }
}

/// A look as Look.numbers and Look.tile tell it.
Look lookOf(JNIEnv* env, jintArray numbers, jintArray tile) {
    Numbers told(env, numbers);
    Look look;
    const Color color = rgb(static_cast<unsigned int>(told.next()));
    look.fill(color, told.nextFloat()).textOpacity(told.nextFloat());
    if (told.next() == 0) look.noFill();
    const Tile pixels(env, tile);
    const jint count = told.next();
    for (jint i = 0; i < count; ++i)
        addTo(look, nextEffect(told), pixels.view());
    return look;
}

/// The looks of a stack; with an exception pending, some of them.
std::vector<Look> looksOf(JNIEnv* env, jobjectArray numbers, jobjectArray tiles) {
    std::vector<Look> looks;
    const jsize count = env->GetArrayLength(numbers);
    looks.reserve(static_cast<std::size_t>(count));
    for (jsize i = 0; i < count; ++i) {
        const auto own = static_cast<jintArray>(env->GetObjectArrayElement(numbers, i));
        if (env->ExceptionCheck()) break;
        const auto tile = static_cast<jintArray>(env->GetObjectArrayElement(tiles, i));
        if (env->ExceptionCheck()) break;
        looks.push_back(lookOf(env, own, tile));
        env->DeleteLocalRef(own);
        env->DeleteLocalRef(tile);
    }
    return looks;
}

/// A new array; null with an exception pending.
jintArray arrayOf(JNIEnv* env, const Margins& margins) {
    const jint sides[] = {margins.left, margins.top, margins.right, margins.bottom};
    const jintArray array = env->NewIntArray(4);
    if (array != nullptr) env->SetIntArrayRegion(array, 0, 4, sides);
    return array;
}

/// What the painted glyphs may touch when the origin of the text stands at (x, y).
look_internal::WideBox reachOf(const JavaPainter& painter, jint x, jint y) {
    look_internal::WideBox ink;
    for (const Glyph& glyph : painter.glyphs) {
        if (glyph.width > 0 && glyph.height > 0)
            ink.grow(look_internal::WideBox{0, 0, glyph.width, glyph.height}.moved(glyph.x, glyph.y));
    }
    if (ink.isEmpty()) return {};
    return ink.grownBy(painter.painter.margins()).moved(x, y);
}

void paint(JNIEnv* env, JavaPainter& painter, Target& target, jint x, jint y, jintArray touched) {
    const std::optional<PictureView> view = target.open(reachOf(painter, x, y));
    if (!view) return;
    const std::optional<Box> box =
        painter.painter.paint(Glyphs(painter.glyphs), *view, x - target.left(), y - target.top());
    if (!box) return throwFailure(env, painter.painter.failure());
    if (target.close()) tell(env, touched, target.inPicture(*box));
}

}  // namespace

#define VOREL_LOOK(result, name) extern "C" JNIEXPORT result JNICALL Java_org_voreleffect_Look_##name
#define VOREL_PAINTER(result, name) \
    extern "C" JNIEXPORT result JNICALL Java_org_voreleffect_Painter_##name

VOREL_LOOK(jintArray, nativeMargins)(JNIEnv* env, jclass, jintArray numbers, jintArray tile) {
    return orOutOfMemory(env, "look",
                         [&] { return arrayOf(env, lookOf(env, numbers, tile).margins()); });
}

VOREL_LOOK(jbyteArray, nativeKey)(JNIEnv* env, jclass, jintArray numbers, jintArray tile) {
    return orOutOfMemory(env, "key", [&] {
        const std::string key = lookOf(env, numbers, tile).key();
        const auto length = static_cast<jsize>(key.size());
        const jbyteArray bytes = env->NewByteArray(length);
        if (bytes != nullptr)
            env->SetByteArrayRegion(bytes, 0, length, reinterpret_cast<const jbyte*>(key.data()));
        return bytes;
    });
}

VOREL_PAINTER(jlong, nativeNew)(JNIEnv* env, jclass, jobjectArray numbers, jobjectArray tiles) {
    return orOutOfMemory(env, "painter", [&]() -> jlong {
        const std::vector<Look> looks = looksOf(env, numbers, tiles);
        if (env->ExceptionCheck()) return 0;
        return addressOf(new JavaPainter(looks));
    });
}

VOREL_PAINTER(void, nativeFree)(JNIEnv*, jclass, jlong painter) {
    delete &at<JavaPainter>(painter);
}

// Below, the object stands beside its painter: as an argument it stays reachable until the call has
// returned, so that the painter is not freed under it.

VOREL_PAINTER(jintArray, nativeMargins)(JNIEnv* env, jobject, jlong painter) {
    return arrayOf(env, at<JavaPainter>(painter).painter.margins());
}

VOREL_PAINTER(void, nativePaint)
(JNIEnv* env, jobject, jlong painter, jintArray glyphs, jobjectArray coverage, jobject memory,
 jintArray view, jint x, jint y, jintArray touched) {
    orOutOfMemory(env, "glyphs", [&] {
        JavaPainter& ours = at<JavaPainter>(painter);
        Target target(env, memory, view);
        if (ours.take(env, glyphs, coverage)) paint(env, ours, target, x, y, touched);
    });
}

VOREL_PAINTER(void, nativePicture)
(JNIEnv* env, jobject, jlong painter, jintArray glyphs, jobjectArray coverage, jintArray place) {
    orOutOfMemory(env, "glyphs", [&] {
        JavaPainter& ours = at<JavaPainter>(painter);
        if (!ours.take(env, glyphs, coverage)) return;
        ours.picture = ours.painter.paint(Glyphs(ours.glyphs));
        if (!ours.picture) return throwFailure(env, ours.painter.failure());
        const Picture& picture = *ours.picture;
        const jint numbers[] = {picture.width(), picture.height(), picture.left(), picture.top()};
        env->SetIntArrayRegion(place, 0, 4, numbers);
    });
}

VOREL_PAINTER(void, nativeTakePicture)(JNIEnv* env, jobject, jlong painter, jobject pixels) {
    const std::optional<Picture> picture = std::exchange(at<JavaPainter>(painter).picture, std::nullopt);
    if (pixels == nullptr || !picture || picture->isEmpty()) return;
    const int64_t bytes = int64_t{picture->stride()} * picture->height();
    unsigned char* const to = bytesOf(env, pixels, 0, bytes);
    if (to != nullptr) std::memcpy(to, picture->data(), static_cast<std::size_t>(bytes));
}

extern "C" JNIEXPORT void JNICALL Java_org_voreleffect_Picture_nativeLayOver(
    JNIEnv* env, jclass, jobject pixels, jintArray place, jobject memory, jintArray view, jint x, jint y,
    jintArray touched) {
    orOutOfMemory(env, "picture", [&] {
        const look_internal::Placed picture = placed(env, pixels, Place(env, place), x, y);
        if (env->ExceptionCheck()) return;
        Target target(env, memory, view);
        const std::optional<PictureView> opened = target.open(picture.box);
        if (!opened) return;
        const look_internal::Placed moved{picture.pixels,
                                          picture.box.moved(-target.left(), -target.top())};
        const Box box = moved.layOver(*opened).narrow();
        if (target.close()) tell(env, touched, target.inPicture(box));
    });
}
