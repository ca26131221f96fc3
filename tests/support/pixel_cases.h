#pragma once

#include <climits>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <ostream>
#include <vector>

#include "bitmap_bytes.h"
#include "guarded.h"
#include "random.h"

/// Random pixels and placements for sweeps of the blending operations, biased to the values and
/// positions where an operation takes another path.
namespace vorel_test {

template <class T>
T oneOf(Random& random, std::initializer_list<T> choices) {
    return choices.begin()[random.between(0, static_cast<int>(choices.size()) - 1)];
}

inline uint8_t boundaryByte(Random& random) {
    return oneOf<uint8_t>(random, {0, 0, 1, 2, 127, 128, 254, 255, 255});
}

inline uint32_t randomColor(Random& random) {
    uint32_t color = 0;
    for (int channel = 0; channel < 4; ++channel)
        color = color << 8 | (random.chance(50) ? boundaryByte(random) : random.byte());
    return color;
}

/// A run of pixels of one kind: short ones mostly, but also some longer than any vector.
inline int randomRun(Random& random) {
    return random.chance(10) ? random.between(30, 150) : random.between(1, 24);
}

/// Coverage in runs that are empty, full, at the boundary values or arbitrary.
inline void fillMask(Random& random, uint8_t* mask, size_t size) {
    for (size_t i = 0; i < size;) {
        const int style = random.between(0, 3);
        for (int run = randomRun(random); run > 0 && i < size; --run, ++i) {
            if (style == 0) mask[i] = 0;
            if (style == 1) mask[i] = 255;
            if (style == 2) mask[i] = boundaryByte(random);
            if (style == 3) mask[i] = random.byte();
        }
    }
}

/// Colour pixels in runs that share a kind of alpha; the byte at `alphaAt` of a pixel is its alpha.
inline void fillColour(Random& random, uint8_t* bytes, size_t pixels, size_t alphaAt) {
    std::vector<uint8_t> alpha(pixels);
    fillMask(random, alpha.data(), pixels);
    for (size_t i = 0; i < pixels; ++i) {
        const bool premultiplied = random.chance(50);
        for (size_t c = 0; c < 4; ++c) {
            const int any = random.chance(30) ? boundaryByte(random) : random.byte();
            const int channel = premultiplied ? any * alpha[i] / 255 : any;
            bytes[i * 4 + c] = c == alphaAt ? alpha[i] : static_cast<uint8_t>(channel);
        }
    }
}

/// Colour pixels R, G, B, A.
inline void fillColour(Random& random, GuardedBuffer& bytes) {
    fillColour(random, bytes.data(), bytes.size() / 4, 3);
}

inline std::vector<uint8_t> bytesOf(const GuardedBuffer& buffer) {
    return std::vector<uint8_t>(buffer.begin(), buffer.end());
}

/// A destination and where a source of width x height pixels lies on it.
struct Placement {
    int dstWidth, dstHeight;
    int x, y;
    int width, height;
};

inline std::ostream& operator<<(std::ostream& out, const Placement& p) {
    return out << p.width << " x " << p.height << " at (" << p.x << ", " << p.y << ") of " << p.dstWidth
               << " x " << p.dstHeight;
}

/// Where `length` pixels start on a side of `room` pixels: at 0, across either end or wholly outside.
inline int randomStart(Random& random, int room, int length) {
    if (random.chance(30)) return 0;
    if (random.chance(40)) return random.between(-length, 0);
    return random.between(-length - 2, room + 2);
}

/// Mostly up to 67 pixels, now and then enough for several of the longest stretches.
inline int randomWidth(Random& random) {
    return random.chance(15) ? random.between(68, 300) : random.between(1, 67);
}

/// Heights 1 to 5.
inline Placement randomPlacement(Random& random) {
    Placement p{};
    p.dstWidth = randomWidth(random);
    p.dstHeight = random.between(1, 5);
    p.width = randomWidth(random);
    p.height = random.between(1, 5);
    p.x = randomStart(random, p.dstWidth, p.width);
    p.y = randomStart(random, p.dstHeight, p.height);
    return p;
}

inline Edge randomEdge(Random& random) {
    return random.chance(75) ? Edge::kEnd : Edge::kStart;
}

/// Bytes of `height` rows that start `strideBytes` apart, the last one cut right after its pixels.
inline size_t sourceBytes(int height, int strideBytes, int rowBytes) {
    return static_cast<size_t>(strideBytes) * static_cast<size_t>(height - 1) +
           static_cast<size_t>(rowBytes);
}

/// Placements at the ends of the range of an int, around a destination of 8 x 3 pixels. A source of
/// 9 x 4 pixels holds all that they can reach.
inline std::vector<Placement> extremePlacements(std::initializer_list<int> lengths) {
    std::vector<Placement> placements;
    const auto starts = {INT_MIN, INT_MIN + 1, -1, 0, 1, INT_MAX - 1, INT_MAX};
    for (const int x : starts)
        for (const int y : starts)
            for (const int width : lengths)
                for (const int height : lengths)
                    placements.push_back(Placement{8, 3, x, y, width, height});
    return placements;
}

/// Bitmap numbers whose byte count does not fit in 32 bits.
struct Numbers {
    unsigned width, height, bytesPerPixel;
};

inline std::vector<Numbers> wrappingNumbers(unsigned bytesPerPixel) {
    std::vector<Numbers> all = {
        {65536, 65536, bytesPerPixel},   {65537, 65537, bytesPerPixel},
        {0x80000000U, 2, bytesPerPixel}, {0xFFFFFFFFU, 2, bytesPerPixel},
        {2, 0xFFFFFFFFU, bytesPerPixel}, {0xFFFFFFFFU, 0xFFFFFFFFU, bytesPerPixel}};
    if (bytesPerPixel == 4) {
        all.push_back({0x40000000U, 1, 4});
        all.push_back({0x40000001U, 1, 4});
        all.push_back({1, 0x40000004U, 4});
        all.push_back({32768, 32768, 4});
    }
    return all;
}

/// Claims these numbers for the bitmap, whatever its pixels hold.
inline void claim(VFontEffect::VFBitmap* bitmap, const Numbers& numbers) {
    bitmap->mWidth = numbers.width;
    bitmap->mHeight = numbers.height;
    bitmap->mBytesPerPixel = numbers.bytesPerPixel;
}

}  // namespace vorel_test
