#pragma once

#include <voreleffect/VFBitmap.h>

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <memory>
#include <vector>

#include "decoder.h"
#include "tests/support/pixel_cases.h"
#include "tests/support/random.h"

/// Pixels and bitmaps of fuzzing inputs. All blocks are as large as their pixels and no byte larger,
/// so that AddressSanitizer sees the first byte read or written too far.
namespace vorel_fuzz {

/// Longest side of the images: small enough that a call takes microseconds, large enough for several
/// steps of eight pixels and a tail.
constexpr int kLongestSide = 64;

/// Where decoded pixels come from: all alike, from a short seed, or byte by byte from the input.
enum class Filling { clear, solid, seeded, literal };

inline Filling decodeFilling(Decoder& in) {
    return in.oneOf({Filling::clear, Filling::solid, Filling::seeded, Filling::literal});
}

/// Coverage, or any other bytes.
inline void fillCoverage(Decoder& in, uint8_t* bytes, size_t size) {
    switch (decodeFilling(in)) {
        case Filling::clear:
            break;
        case Filling::solid:
            std::fill_n(bytes, size, in.byte());
            break;
        case Filling::seeded: {
            vorel_test::Random random(in.byte());
            vorel_test::fillMask(random, bytes, size);
            break;
        }
        case Filling::literal:
            in.copy(bytes, size);
            break;
    }
}

/// Colour pixels of four bytes; the byte at `alphaAt` of a pixel is its alpha.
inline void fillColours(Decoder& in, uint8_t* bytes, size_t pixels, size_t alphaAt) {
    switch (decodeFilling(in)) {
        case Filling::clear:
            break;
        case Filling::solid: {
            uint8_t pixel[4];
            in.copy(pixel, sizeof pixel);
            for (size_t i = 0; i < pixels; ++i)
                std::memcpy(bytes + 4 * i, pixel, sizeof pixel);
            break;
        }
        case Filling::seeded: {
            vorel_test::Random random(in.byte());
            vorel_test::fillColour(random, bytes, pixels, alphaAt);
            break;
        }
        case Filling::literal:
            in.copy(bytes, 4 * pixels);
            break;
    }
}

inline std::vector<uint8_t> decodeCoverage(Decoder& in, int width, int height) {
    std::vector<uint8_t> bytes(static_cast<size_t>(width) * static_cast<size_t>(height));
    fillCoverage(in, bytes.data(), bytes.size());
    return bytes;
}

/// Packed pixels with their alpha in the byte at `alphaAt`.
inline std::vector<uint8_t> decodeColours(Decoder& in, int width, int height, size_t alphaAt) {
    const size_t pixels = static_cast<size_t>(width) * static_cast<size_t>(height);
    std::vector<uint8_t> bytes(4 * pixels);
    fillColours(in, bytes.data(), pixels, alphaAt);
    return bytes;
}

/// A bitmap of these numbers with decoded pixels.
inline std::unique_ptr<VFontEffect::VFBitmap> decodePixels(Decoder& in, Size size, int bytesPerPixel) {
    auto bitmap = std::make_unique<VFontEffect::VFBitmap>(static_cast<unsigned>(size.width),
                                                          static_cast<unsigned>(size.height),
                                                          static_cast<unsigned>(bytesPerPixel));
    if (bitmap->mData == nullptr) return bitmap;  // where memory is refused
    const size_t pixels = static_cast<size_t>(size.width) * static_cast<size_t>(size.height);
    if (bytesPerPixel == 4) {
        fillColours(in, bitmap->mData, pixels, 3);
    } else {
        fillCoverage(in, bitmap->mData, pixels * static_cast<size_t>(bytesPerPixel));
    }
    return bitmap;
}

/// A bitmap as a careless caller may make it: mostly one of that size and depth, else of another size or
/// depth, without pixels, or with numbers whose product does not fit in 32 bits; null now and then.
inline std::unique_ptr<VFontEffect::VFBitmap> decodeBitmap(Decoder& in, Size size, int bytesPerPixel) {
    using VFontEffect::VFBitmap;
    const uint8_t kind = in.byte();
    if (kind < 0xB0) return decodePixels(in, size, bytesPerPixel);
    switch (kind % 8) {
        case 0:
            return nullptr;
        case 1:
            return std::make_unique<VFBitmap>();
        case 2:
            return std::make_unique<VFBitmap>(static_cast<unsigned>(size.width),
                                              static_cast<unsigned>(size.height), nullptr,
                                              static_cast<unsigned>(bytesPerPixel));
        case 3: {
            const auto depth = in.oneOf({1U, 4U});
            const auto all = vorel_test::wrappingNumbers(depth);
            const auto& n = all[static_cast<size_t>(in.between(0, static_cast<int>(all.size()) - 1))];
            // The buffer is as large as the wrapped product says, where that is affordable.
            const uint32_t bytes = n.width * n.height * n.bytesPerPixel;
            if (bytes <= (1U << 20)) {
                return std::make_unique<VFBitmap>(n.width, n.height, n.bytesPerPixel);
            }
            return std::make_unique<VFBitmap>(n.width, n.height, nullptr, n.bytesPerPixel);
        }
        case 4:
            return decodePixels(in, size, in.between(0, 6));
        default: {
            const Size other = decodeSize(in, {0, 0}, {kLongestSide, kLongestSide});
            return decodePixels(in, other, in.oneOf({1, 4}));
        }
    }
}

}  // namespace vorel_fuzz
