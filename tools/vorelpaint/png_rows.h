#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <vector>

namespace vorelpaint {

/// Which of a pixel's four bytes are in the file: of grey ones the first stands for the first three, and
/// opaque ones need no fourth.
struct PngChannels {
    size_t count;
    std::array<size_t, 4> places;
};
constexpr PngChannels kGrey{1, {0}};
constexpr PngChannels kGreyAlpha{2, {0, 3}};
constexpr PngChannels kRgb{3, {0, 1, 2}};
constexpr PngChannels kRgba{4, {0, 1, 2, 3}};

/// The rows of a picture as a PNG has them. The bytes are the owner's.
struct PngRows {
    const uint8_t* pixels;  ///< packed rows of four bytes a pixel
    size_t width;           ///< of both sides at least 1
    size_t height;
    PngChannels channels;

    const uint8_t* row(size_t y) const { return pixels + y * width * 4; }
    size_t rowBytes() const { return 1 + width * channels.count; }  ///< with the number of its filter
};

/// Adds a row as it is in the file to `stream`: the number of a filter, then of each of these pixels the
/// bytes that are in the file.
void appendRow(std::vector<uint8_t>& stream, const PngRows& rows, int filter, const uint8_t* pixels);

/// What is compressed of them, each row behind the number of its filter: pixels as they are, filter 0.
std::vector<uint8_t> unfiltered(const PngRows& rows);

/// The same with the filter for each row that suits it, of the five that the format has: what remains of
/// a byte when it is guessed from those to its left and above. The remains are smallest in sum, as
/// signed numbers: what the format itself advises for pictures of many colours.
std::vector<uint8_t> filtered(const PngRows& rows);

/// Whether more than three quarters of the pixels are new, of those in every fourth row that are neither
/// the one on their left nor the one above: as far as a table of 4,096 tells in which later ones push
/// out earlier ones. In photographs nearly all are, in text and its effects about half at most.
bool isOfNewPixels(const PngRows& rows);

/// A pixel as one word, equal where its four channels are.
inline uint32_t wordAt(const uint8_t* pixel) {
    uint32_t word = 0;
    std::memcpy(&word, pixel, sizeof word);
    return word;
}

/// A number below 2^bits for a word; `bits` is from 1 to 31.
inline size_t spread(uint32_t word, int bits) {
    constexpr uint32_t kGolden = 2654435761U;  // 2^32 over the golden ratio, as Knuth hashes
    return (word * kGolden) >> (32 - bits);
}

}  // namespace vorelpaint
