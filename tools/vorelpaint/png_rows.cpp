#include "png_rows.h"

#include <algorithm>
#include <cstdlib>

namespace vorelpaint {
namespace {

constexpr size_t kChannels = 4;
constexpr int kFilters = 5;

/// A row and the one above it, each behind a clear pixel.
struct RowPair {
    const uint8_t* row;
    const uint8_t* above;
};

uint8_t paeth(int left, int above, int aboveLeft) {
    const int toLeft = std::abs(above - aboveLeft);
    const int toAbove = std::abs(left - aboveLeft);
    const int toAboveLeft = std::abs(left + above - 2 * aboveLeft);
    const int upper = toAbove <= toAboveLeft ? above : aboveLeft;
    return static_cast<uint8_t>(toLeft <= toAbove && toLeft <= toAboveLeft ? left : upper);
}

/// Guesses each byte by `guess` of those on its left, above, and above that on the left; the sum of what
/// remains, which wraps in rows of more than 2^23 pixels and is only worse to choose by there.
template <typename Guess>
uint32_t filterBy(const RowPair& pair, size_t count, uint8_t* remains, Guess guess) {
    uint32_t sum = 0;
    for (size_t i = 0; i < count; ++i) {
        const uint8_t guessed = guess(pair.row[i], pair.above[i + kChannels], pair.above[i]);
        remains[i] = static_cast<uint8_t>(pair.row[i + kChannels] - guessed);
        sum += static_cast<uint32_t>(std::abs(static_cast<int8_t>(remains[i])));
    }
    return sum;
}

uint32_t filterRow(int filter, const RowPair& pair, size_t count, uint8_t* remains) {
    switch (filter) {
        case 1:
            return filterBy(pair, count, remains, [](uint8_t left, uint8_t, uint8_t) { return left; });
        case 2:
            return filterBy(pair, count, remains, [](uint8_t, uint8_t above, uint8_t) { return above; });
        case 3:
            return filterBy(pair, count, remains, [](uint8_t left, uint8_t above, uint8_t) {
                return static_cast<uint8_t>((left + above) / 2);
            });
        case 4:
            return filterBy(pair, count, remains, paeth);
        default:
            return filterBy(pair, count, remains, [](uint8_t, uint8_t, uint8_t) { return uint8_t{0}; });
    }
}

/// The bytes of pixels that are in the file.
template <size_t count>
void append(std::vector<uint8_t>& stream, const PngChannels& channels, const uint8_t* pixels,
            const uint8_t* end) {
    const size_t begin = stream.size();
    stream.resize(begin + static_cast<size_t>(end - pixels) / kChannels * count);
    for (uint8_t* to = &stream[begin]; pixels != end; pixels += kChannels, to += count) {
        for (size_t i = 0; i < count; ++i)
            to[i] = pixels[channels.places[i]];
    }
}

}  // namespace

void appendRow(std::vector<uint8_t>& stream, const PngRows& rows, int filter, const uint8_t* pixels) {
    stream.push_back(static_cast<uint8_t>(filter));
    const uint8_t* end = pixels + rows.width * kChannels;
    switch (rows.channels.count) {
        case 1:
            return append<1>(stream, rows.channels, pixels, end);
        case 2:
            return append<2>(stream, rows.channels, pixels, end);
        case 3:
            return append<3>(stream, rows.channels, pixels, end);
        default:
            stream.insert(stream.end(), pixels, end);
    }
}

std::vector<uint8_t> unfiltered(const PngRows& rows) {
    std::vector<uint8_t> stream;
    stream.reserve(rows.rowBytes() * rows.height);
    for (size_t y = 0; y < rows.height; ++y)
        appendRow(stream, rows, 0, rows.row(y));
    return stream;
}

std::vector<uint8_t> filtered(const PngRows& rows) {
    std::vector<uint8_t> stream;
    stream.reserve(rows.rowBytes() * rows.height);
    const size_t count = rows.width * kChannels;
    std::vector<uint8_t> above(kChannels + count);
    std::vector<uint8_t> row(kChannels + count);
    std::vector<uint8_t> remains(count);
    std::vector<uint8_t> best(count);
    for (size_t y = 0; y < rows.height; ++y) {
        std::copy_n(rows.row(y), count, row.begin() + kChannels);
        int filter = 0;
        uint32_t least = filterRow(filter, {row.data(), above.data()}, count, best.data());
        for (int other = 1; other < kFilters; ++other) {
            const uint32_t sum = filterRow(other, {row.data(), above.data()}, count, remains.data());
            if (sum >= least) continue;
            least = sum;
            filter = other;
            best.swap(remains);
        }
        appendRow(stream, rows, filter, best.data());
        above.swap(row);
    }
    return stream;
}

bool isOfNewPixels(const PngRows& rows) {
    constexpr int kSlotBits = 12;
    constexpr size_t kRowsApart = 4;
    std::vector<uint32_t> lastOf(size_t{1} << kSlotBits);  // pixels, each where its bits are spread to
    size_t edges = 0;
    size_t fresh = 0;
    for (size_t y = 1; y < rows.height; y += kRowsApart) {
        const uint8_t* above = rows.row(y - 1);
        const uint8_t* row = rows.row(y);
        for (size_t i = kChannels; i < kChannels * rows.width; i += kChannels) {
            const uint32_t pixel = wordAt(row + i);
            if (pixel == wordAt(row + i - kChannels) || pixel == wordAt(above + i)) continue;
            ++edges;
            uint32_t& last = lastOf[spread(pixel, kSlotBits)];
            fresh += last == pixel ? 0 : 1;
            last = pixel;
        }
    }
    return 4 * fresh > 3 * edges;
}

}  // namespace vorelpaint
