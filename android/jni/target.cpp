#include "target.h"

#include <algorithm>
#include <cstdint>
#include <cstring>

#include "painting.h"
#include "support.h"

using namespace VFontEffect;

namespace voreljni {

namespace {

constexpr int kPixel = 4;

/// Turns words 0xAARRGGBB, in place, into bytes R, G, B, A.
void spellOut(unsigned char* pixels, int count) {
    for (; count > 0; --count, pixels += kPixel) {
        uint32_t word = 0;
        std::memcpy(&word, pixels, kPixel);
        for (int channel = 0; channel < kPixel; ++channel)
            pixels[channel] = static_cast<unsigned char>(word >> ((16 - 8 * channel) & 31));
    }
}

/// Turns bytes R, G, B, A, in place, into words 0xAARRGGBB.
void readIn(unsigned char* pixels, int count) {
    for (; count > 0; --count, pixels += kPixel) {
        const uint32_t word = uint32_t{pixels[3]} << 24 | uint32_t{pixels[0]} << 16 |
                              uint32_t{pixels[1]} << 8 | uint32_t{pixels[2]};
        std::memcpy(pixels, &word, kPixel);
    }
}

}  // namespace

Target::Target(JNIEnv* env, jobject memory, jintArray numbers) : mEnv(env), mMemory(memory) {
    Numbers told(env, numbers);
    mKind = told.next();
    mOffset = told.next();
    mStride = told.next();
    mOrder = told.next() == 1 ? PixelOrder::bgra : PixelOrder::rgba;
    mClip.left = told.next();
    mClip.top = told.next();
    mClip.right = told.next();
    mClip.bottom = told.next();
}

int64_t Target::unitsTo(int x, int y) const {
    const int unitsOfAPixel = mKind == kWords ? 1 : kPixel;
    return mOffset + int64_t{mStride} * y + int64_t{unitsOfAPixel} * x;
}

PictureView Target::viewOf(unsigned char* pixels, std::ptrdiff_t stride) const {
    return {pixels, mOpen.right - mOpen.left, mOpen.bottom - mOpen.top, stride, mOrder};
}

std::optional<PictureView> Target::openDirect() {
    const int64_t first = unitsTo(mOpen.left, mOpen.top);
    const int64_t end = unitsTo(mOpen.right, mOpen.bottom - 1);
    unsigned char* const bytes = bytesOf(mEnv, mMemory, 0, end);
    if (bytes == nullptr) return std::nullopt;
    return viewOf(bytes + first, mStride);
}

std::optional<PictureView> Target::open(const look_internal::WideBox& needed) {
    const auto inside = [](int64_t value, int least, int most) {
        return static_cast<int>(std::clamp<int64_t>(value, least, std::max(least, most)));
    };
    mOpen.left = inside(needed.left, mClip.left, mClip.right);
    mOpen.top = inside(needed.top, mClip.top, mClip.bottom);
    mOpen.right = inside(needed.right, mOpen.left, mClip.right);
    mOpen.bottom = inside(needed.bottom, mOpen.top, mClip.bottom);
    if (mOpen.isEmpty()) return PictureView{};
    if (mKind == kDirect) return openDirect();
    const PictureView size = viewOf(nullptr, 0);
    const std::size_t rowBytes = static_cast<std::size_t>(size.width) * kPixel;
    mCopy.resize(rowBytes * static_cast<std::size_t>(size.height));
    for (int row = 0; row < size.height; ++row) {
        fetchRow(row, mCopy.data() + static_cast<std::size_t>(row) * rowBytes);
        if (mEnv->ExceptionCheck()) return std::nullopt;
    }
    return viewOf(mCopy.data(), 0);
}

Box Target::inPicture(const Box& box) const {
    if (box.isEmpty()) return {};
    return {box.left + mOpen.left, box.top + mOpen.top, box.right + mOpen.left, box.bottom + mOpen.top};
}

void Target::fetchRow(int row, unsigned char* to) {
    const auto first = static_cast<jsize>(unitsTo(mOpen.left, mOpen.top + row));
    const int width = mOpen.right - mOpen.left;
    if (mKind == kBytes) {
        mEnv->GetByteArrayRegion(static_cast<jbyteArray>(mMemory), first, width * kPixel,
                                 reinterpret_cast<jbyte*>(to));
        return;
    }
    mEnv->GetIntArrayRegion(static_cast<jintArray>(mMemory), first, width, reinterpret_cast<jint*>(to));
    spellOut(to, width);
}

void Target::storeRow(int row, unsigned char* from) {
    const auto first = static_cast<jsize>(unitsTo(mOpen.left, mOpen.top + row));
    const int width = mOpen.right - mOpen.left;
    if (mKind == kBytes) {
        mEnv->SetByteArrayRegion(static_cast<jbyteArray>(mMemory), first, width * kPixel,
                                 reinterpret_cast<jbyte*>(from));
        return;
    }
    readIn(from, width);
    mEnv->SetIntArrayRegion(static_cast<jintArray>(mMemory), first, width,
                            reinterpret_cast<jint*>(from));
}

bool Target::close() {
    if (mKind == kDirect || mOpen.isEmpty()) return true;
    const auto rowBytes = static_cast<std::size_t>(mOpen.right - mOpen.left) * kPixel;
    for (int row = 0; row < mOpen.bottom - mOpen.top; ++row) {
        storeRow(row, mCopy.data() + static_cast<std::size_t>(row) * rowBytes);
        if (mEnv->ExceptionCheck()) return false;
    }
    return true;
}

}  // namespace voreljni
