#include "painting.h"

#include <cstring>

#include "support.h"

using namespace VFontEffect;

namespace voreljni {

namespace {

/// How the memory of a glyph or a view is reached: the numbers of Memory.java.
enum MemoryKind { kDirect = 0, kBytes = 1 };

/// One glyph as Java tells it, and the bytes of its coverage that are used.
struct GlyphNumbers {
    Glyph glyph;
    jint kind;
    jint offset;
    int64_t bytes;
};

GlyphNumbers nextGlyph(Numbers& numbers) {
    GlyphNumbers told{};
    told.glyph.x = numbers.next();
    told.glyph.y = numbers.next();
    told.glyph.width = numbers.next();
    told.glyph.height = numbers.next();
    told.glyph.stride = numbers.next();
    told.kind = numbers.next();
    told.offset = numbers.next();
    const bool isEmpty = told.glyph.width == 0 || told.glyph.height == 0;
    told.bytes = isEmpty ? 0 : int64_t{told.glyph.stride} * (told.glyph.height - 1) + told.glyph.width;
    return told;
}

/// How many bytes of arrays the glyphs have: more than there is memory for when many show one array.
int64_t arrayBytes(Numbers numbers, jsize count) {
    int64_t bytes = 0;
    for (jsize i = 0; i < count; ++i) {
        const GlyphNumbers told = nextGlyph(numbers);
        if (told.kind == kBytes) bytes += told.bytes;
    }
    return bytes;
}

/// Where the coverage of a glyph is: that of an array is copied to `room`. False with an exception
/// pending.
bool reach(JNIEnv* env, jobject memory, GlyphNumbers& told, unsigned char* room) {
    if (told.bytes == 0) return true;
    if (told.kind == kBytes) {
        env->GetByteArrayRegion(static_cast<jbyteArray>(memory), told.offset,
                                static_cast<jsize>(told.bytes), reinterpret_cast<jbyte*>(room));
        told.glyph.coverage = room;
        return !env->ExceptionCheck();
    }
    told.glyph.coverage = bytesOf(env, memory, told.offset, told.bytes);
    return told.glyph.coverage != nullptr;
}

}  // namespace

Numbers::Numbers(JNIEnv* env, jintArray array)
    : mNumbers(static_cast<std::size_t>(env->GetArrayLength(array))) {
    env->GetIntArrayRegion(array, 0, static_cast<jsize>(mNumbers.size()), mNumbers.data());
}

float Numbers::nextFloat() {
    const jint bits = next();
    float value = 0;
    std::memcpy(&value, &bits, sizeof value);
    return value;
}

bool JavaPainter::take(JNIEnv* env, jintArray numbers, jobjectArray memory) {
    Numbers told(env, numbers);
    const jsize count = env->GetArrayLength(memory);
    glyphs.clear();
    glyphs.reserve(static_cast<std::size_t>(count));
    const auto needed = static_cast<uint64_t>(arrayBytes(told, count));
    if (needed > coverage.max_size()) {
        throwOutOfMemory(env, "coverage");
        return false;
    }
    coverage.resize(static_cast<std::size_t>(needed));
    unsigned char* room = coverage.data();
    for (jsize i = 0; i < count; ++i) {
        GlyphNumbers next = nextGlyph(told);
        const jobject bytes = env->GetObjectArrayElement(memory, i);
        if (env->ExceptionCheck() || !reach(env, bytes, next, room)) return false;
        env->DeleteLocalRef(bytes);  // the array holds it
        if (next.kind == kBytes) room += next.bytes;
        glyphs.push_back(next.glyph);
    }
    return true;
}

Place::Place(JNIEnv* env, jintArray numbers) {
    Numbers told(env, numbers);
    width = told.next();
    height = told.next();
    left = told.next();
    top = told.next();
}

look_internal::Placed placed(JNIEnv* env, jobject pixels, const Place& place, jint x, jint y) {
    const look_internal::WideBox box{0, 0, place.width, place.height};
    const unsigned char* const bytes = bytesOf(env, pixels, 0, int64_t{4} * place.width * place.height);
    return {bytes, box.moved(int64_t{x} + place.left, int64_t{y} + place.top)};
}

void tell(JNIEnv* env, jintArray touched, const Box& box) {
    const jint sides[] = {box.left, box.top, box.right, box.bottom};
    env->SetIntArrayRegion(touched, 0, 4, sides);
}

void throwFailure(JNIEnv* env, Failure why) {
    if (why == Failure::noMemory) return throwOutOfMemory(env, "layers");
    throwIllegalArgument(env, why == Failure::tooLarge ? "too large: a layer of 2^31 bytes or more"
                                                       : "a view or a glyph without pixels");
}

}  // namespace voreljni
