#include "pixel_matcher.h"

#include <algorithm>
#include <cstring>

namespace vorelpaint {
namespace {

constexpr size_t kWindow = 32768;
constexpr size_t kLong = 64;
constexpr size_t kRemembered = kWindow / 2;  ///< places, at least those of the window's pixels
constexpr uint32_t kNowhere = 0xFFFFFFFF;
constexpr uint64_t kSpread = 0x9E3779B97F4A7C15U;  ///< 2^64 over the golden ratio, as Knuth hashes

uint32_t pixelAt(const uint8_t* pixels) {
    uint32_t pixel = 0;
    std::memcpy(&pixel, pixels, sizeof pixel);
    return pixel;
}

uint64_t pairAt(const uint8_t* pixels) {
    uint64_t pair = 0;
    std::memcpy(&pair, pixels, sizeof pair);
    return pair;
}

/// How many pixels are the same from two places on.
size_t commonLength(const uint8_t* one, const uint8_t* other, size_t most) {
    size_t length = 0;
    while (length + 2 <= most && pairAt(one + 4 * length) == pairAt(other + 4 * length))
        length += 2;
    const bool isOneMore = length < most && pixelAt(one + 4 * length) == pixelAt(other + 4 * length);
    return isOneMore ? length + 1 : length;
}

/// Takes the pixels `from` on for those at `here` if more of them are the same.
void tryPixels(PixelMatch& best, const uint8_t* here, const uint8_t* from, size_t most,
               size_t distance) {
    const size_t next = 4 * best.length;
    if (best.length >= most || pixelAt(here + next) != pixelAt(from + next)) return;
    const size_t length = commonLength(here, from, most);
    if (length > best.length) best = {length, distance};
}

/// Bits of the tables' indices: small pictures need no large ones.
int bitsFor(size_t pixels) {
    int bits = 8;
    while (bits < 14 && size_t{1} << bits < pixels)
        ++bits;
    return bits;
}

}  // namespace

PixelMatcher::PixelMatcher(const PngRows& rows) : mRows(rows) {
    const int bits = bitsFor(rows.width * rows.height);
    mShift = 64 - bits;
    mOfOne.assign(size_t{1} << bits, kNowhere);
    mOfTwo.assign(size_t{1} << bits, kNowhere);
    mBefore.resize(kRemembered);
}

PixelMatch PixelMatcher::at(size_t x, size_t y) const {
    const uint8_t* here = mRows.row(y) + 4 * x;
    const size_t most = mRows.width - x;
    PixelMatch best;
    if (x > 0) tryPixels(best, here, here - 4, most, mRows.bytesPerPixel);
    if (y > 0 && mRows.rowBytes() <= kWindow) {
        tryPixels(best, here, here - 4 * mRows.width, most, mRows.rowBytes());
        // A run of one colour is told shorter as one from its second pixel on: long matches have many
        // parts, each with its distance.
        const bool isFar = best.distance == mRows.rowBytes() && best.length > kLong;
        if (isFar && commonLength(here, here + 4, most - 1) + 1 >= best.length)
            return {1, best.distance};
    }
    if (best.length < 2 && most > 1) tryPlaces(best, x, y);
    if (best.length == 0) tryPlace(best, mOfOne[slotOfOne(x, y)], x, y);
    return best;
}

void PixelMatcher::show(size_t x, size_t y) {
    const auto place = static_cast<uint32_t>(y * mRows.width + x);
    mOfOne[slotOfOne(x, y)] = place;
    if (x + 1 == mRows.width) return;
    uint32_t& last = mOfTwo[slotOfTwo(x, y)];
    mBefore[place % kRemembered] = last;
    last = place;
}

size_t PixelMatcher::slotOfOne(size_t x, size_t y) const {
    return (pixelAt(mRows.row(y) + 4 * x) * kSpread) >> mShift;
}

size_t PixelMatcher::slotOfTwo(size_t x, size_t y) const {
    return (pairAt(mRows.row(y) + 4 * x) * kSpread) >> mShift;
}

/// The places of this pixel and the next one, the last first.
void PixelMatcher::tryPlaces(PixelMatch& best, size_t x, size_t y) const {
    constexpr int kTries = 4;
    uint32_t place = mOfTwo[slotOfTwo(x, y)];
    for (int i = 0; i < kTries && best.length < kLong && tryPlace(best, place, x, y); ++i)
        place = mBefore[place % kRemembered];
}

/// Whether there is such a place that is not too far.
bool PixelMatcher::tryPlace(PixelMatch& best, uint32_t place, size_t x, size_t y) const {
    if (place == kNowhere) return false;
    const size_t back = y * mRows.width + x - place;  // in pixels
    if (back * mRows.bytesPerPixel > kWindow) return false;
    const size_t rows = back <= x ? 0 : back - x <= mRows.width ? 1 : (back - x - 1) / mRows.width + 1;
    const size_t distance = back * mRows.bytesPerPixel + rows;  // each row has the number of its filter
    if (distance > kWindow) return false;
    const uint8_t* here = mRows.row(y) + 4 * x;
    const size_t placeX = x + rows * mRows.width - back;
    tryPixels(best, here, here - 4 * back, mRows.width - std::max(x, placeX), distance);
    return true;
}

}  // namespace vorelpaint
