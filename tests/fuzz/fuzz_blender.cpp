/// Every pixel operation, at any placement, stride, mode and order, from sources that hold exactly the
/// bytes that their numbers ask for.
#include <voreleffect/VFBlender.h>

#include <climits>
#include <cstdint>
#include <cstdlib>
#include <memory>
#include <vector>

#include "decoder.h"
#include "level_of_input.h"
#include "pixels.h"

namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFBlender;
using vorel_fuzz::Decoder;
using vorel_fuzz::Size;

/// Several stretches of the widest vectors, and rows around them.
constexpr int kLongestSide = 160;
constexpr Size kLargestTarget = {kLongestSide, 12};
constexpr int kMostCalls = 12;
constexpr double kMostSourceBytes = 1 << 16;

/// A source: where it lies on the destination, its size, and the bytes from row to row.
struct Source {
    int x, y, width, height;
    int64_t strideBytes;

    bool reaches(const VFBitmap& target) const {
        return width > 0 && height > 0 && x < int64_t{target.mWidth} && int64_t{x} + width > 0 &&
               y < int64_t{target.mHeight} && int64_t{y} + height > 0;
    }

    /// Up to the last pixel of the last row; wild numbers give more than 64 bits.
    double bytes(int bytesPerPixel) const {
        return (height - 1.0) * static_cast<double>(strideBytes) + 1.0 * width * bytesPerPixel;
    }
};

class Caller {
  public:
    Caller(const uint8_t* data, size_t size) : mIn(data, size) {
        const Size area = decodeSize(mIn, {0, 0}, kLargestTarget);
        mTarget = decodeBitmap(mIn, area, mIn.oneOf({4, 4, 1}));
    }

    void run() {
        for (int calls = 0; calls < kMostCalls && !mIn.atEnd(); ++calls)
            call();
    }

  private:
    Source decodePlace() {
        Source source{};
        source.width = mIn.wildInt(0, kLongestSide);
        source.height = mIn.wildInt(0, kLargestTarget.height);
        source.x = mIn.wildInt(-kLongestSide, kLongestSide);
        source.y = mIn.wildInt(-kLargestTarget.height, kLargestTarget.height);
        return source;
    }

    /// Rows of `unit` bytes per stride step: mostly as wide as the source or a little wider, now and
    /// then overlapping, or negative.
    int decodeStride(const Source& source, int unitsPerPixel) {
        if (mIn.oneIn(4)) return mIn.wildInt(0, 4 * kLongestSide);
        const int64_t units = int64_t{source.width} * unitsPerPixel + mIn.between(0, 9);
        return units > 0 && units < INT_MAX ? static_cast<int>(units) : 0;
    }

    /// The bytes of the source and none more, or null for one call in sixteen. A source that no pixel
    /// is read from has a byte or a word all the same. False when it would be too large to make.
    template <class Unit>
    bool makePixels(const Source& source, int bytesPerPixel, std::unique_ptr<Unit[]>& pixels) {
        if (mIn.oneIn(16)) return true;
        size_t bytes = sizeof(Unit);
        if (mTarget != nullptr && source.strideBytes >= 0 && source.reaches(*mTarget)) {
            if (source.bytes(bytesPerPixel) > kMostSourceBytes) return false;
            bytes = static_cast<size_t>(source.bytes(bytesPerPixel));
        }
        pixels.reset(new Unit[bytes / sizeof(Unit)]());
        auto* const raw = reinterpret_cast<uint8_t*>(pixels.get());
        if (bytesPerPixel == 4) {
            vorel_fuzz::fillColours(mIn, raw, bytes / 4, 3);
        } else {
            vorel_fuzz::fillCoverage(mIn, raw, bytes);
        }
        return true;
    }

    void call();
    void copyMask();
    void blendMask();
    void blendWords();
    void blendBytes();
    void coverItself();

    Decoder mIn;
    VFBlender mBlender;
    std::unique_ptr<VFBitmap> mTarget;
};

void Caller::call() {
    switch (mIn.between(0, 9)) {
        case 0:
        case 1:
            return copyMask();
        case 2:
        case 3:
        case 4:
            return blendMask();
        case 5:
        case 6:
            return blendWords();
        case 7:
        case 8:
            return blendBytes();
        default:
            return coverItself();
    }
}

void Caller::copyMask() {
    const uint32_t color = mIn.word();
    if (mIn.oneIn(4)) {
        const auto mask = decodeBitmap(mIn, decodeSize(mIn, {0, 0}, kLargestTarget), 1);
        const int x = mIn.wildInt(-kLongestSide, kLongestSide);
        mBlender.drawBitmap(x, mIn.wildInt(-kLargestTarget.height, kLargestTarget.height), mTarget.get(),
                            mask.get(), color);
        return;
    }
    Source s = decodePlace();
    s.strideBytes = s.width;
    std::unique_ptr<unsigned char[]> mask;
    if (!makePixels(s, 1, mask)) return;
    switch (mIn.between(0, 2)) {
        case 0:
            return mBlender.drawBitmap8To8(s.x, s.y, mTarget.get(), mask.get(), s.width, s.height);
        case 1:
            return mBlender.drawBitmap8To32(s.x, s.y, mTarget.get(), mask.get(), s.width, s.height,
                                            color);
        default:
            return mBlender.drawBitmap(s.x, s.y, mTarget.get(), mask.get(), s.width, s.height, color);
    }
}

void Caller::blendMask() {
    const uint32_t color = mIn.word();
    Source s = decodePlace();
    const int stride = decodeStride(s, 1);
    s.strideBytes = stride;
    std::unique_ptr<unsigned char[]> mask;
    if (!makePixels(s, 1, mask)) return;
    using Operation =
        void (VFBlender::*)(int, int, const VFBitmap*, unsigned char*, int, int, int, unsigned int);
    constexpr Operation kOperations[] = {&VFBlender::blendSrcOver8To32, &VFBlender::blendDstOver8To32,
                                         &VFBlender::blendDstOver8To32NSA,
                                         &VFBlender::blendDstOverSA8To32};
    const int operation = mIn.between(0, 4);
    if (operation < 4) {
        (mBlender.*kOperations[operation])(s.x, s.y, mTarget.get(), mask.get(), s.width, s.height,
                                           stride, color);
    } else {
        mBlender.drawBitmapBlend8(s.x, s.y, mTarget.get(), mask.get(), s.width, s.height, stride, color,
                                  mIn.wildInt(0, 8));
    }
}

void Caller::blendWords() {
    Source s = decodePlace();
    const int stride = decodeStride(s, 1);
    s.strideBytes = int64_t{stride} * 4;
    std::unique_ptr<unsigned int[]> words;
    if (!makePixels(s, 4, words)) return;
    switch (mIn.between(0, 2)) {
        case 0:
            return mBlender.blendSrcOver32To32(s.x, s.y, mTarget.get(), words.get(), s.width, s.height,
                                               stride);
        case 1:
            return mBlender.blendDstOver32To32(s.x, s.y, mTarget.get(), words.get(), s.width, s.height,
                                               stride);
        default:
            return mBlender.drawBitmapBlend32(s.x, s.y, mTarget.get(), words.get(), s.width, s.height,
                                              stride, mIn.wildInt(0, 3));
    }
}

void Caller::blendBytes() {
    Source s = decodePlace();
    const int stride = decodeStride(s, 4);
    s.strideBytes = stride;
    std::unique_ptr<unsigned char[]> bytes;
    if (!makePixels(s, 4, bytes)) return;
    const int order = mIn.wildInt(0, 2);
    if (mIn.flag()) {
        mBlender.blendDstOver32To32(s.x, s.y, mTarget.get(), bytes.get(), s.width, s.height, stride,
                                    order);
    } else {
        mBlender.drawBitmapBlend32(s.x, s.y, mTarget.get(), bytes.get(), s.width, s.height, stride,
                                   order);
    }
}

/// The one allowed overlap: a mask over itself, which changes nothing.
void Caller::coverItself() {
    if (mTarget == nullptr || mTarget->mBytesPerPixel != 1 || mTarget->mData == nullptr) return;
    if (mTarget->mWidth > kLongestSide || mTarget->mHeight > kLongestSide) return;
    const std::vector<uint8_t> before = vorel_test::bytesOf(*mTarget);
    mBlender.drawBitmap(0, 0, mTarget.get(), mTarget.get(), 0);
    if (before != vorel_test::bytesOf(*mTarget)) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    vorel_fuzz::useLevelOfInput(size);
    Caller(data, size).run();
    return 0;
}
