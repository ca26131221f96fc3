#include "pixel_deflater.h"

#include <libdeflate.h>

#include <algorithm>

#include "bit_writer.h"
#include "deflate_block.h"
#include "pixel_matcher.h"

namespace vorelpaint {
namespace {

/// Pixels and matches of a block: fewer, and the codes would not pay for being told; more, and they
/// would suit no part of it.
constexpr size_t kBlockSize = 16384;

/// The check sum of what the stream unpacks to.
uint32_t checkSum(const PngRows& rows) {
    uint32_t sum = libdeflate_adler32(0, nullptr, 0);
    std::vector<uint8_t> row;
    row.reserve(rows.rowBytes());
    for (size_t y = 0; y < rows.height; ++y) {
        row.clear();
        appendRow(row, rows, 0, rows.row(y));
        sum = libdeflate_adler32(sum, row.data(), row.size());
    }
    return sum;
}

void addRow(DeflateBlock& block, PixelMatcher& matcher, const PngRows& rows, size_t y) {
    constexpr size_t kLong = 16;
    block.startRow();
    for (size_t x = 0; x < rows.width;) {
        const PixelMatch match = matcher.at(x, y);
        if (match.length == 0) {
            block.addPixel(rows.row(y) + 4 * x);
        } else {
            block.addMatch(match);
        }
        const size_t end = x + std::max(match.length, size_t{1});
        // Within long repetitions hardly any other begins.
        for (const size_t shownEnd = match.length > kLong ? x + 1 : end; x < shownEnd; ++x)
            matcher.show(x, y);
        x = end;
    }
}

/// About how many bytes the rows would take with filters, from a part of their pixels.
size_t filteredBytes(const PngRows& rows) {
    constexpr size_t kEvery = 64;
    size_t bits = 0;
    for (size_t y = 1; y < rows.height; ++y) {
        for (size_t x = 1 + y % kEvery; x < rows.width; x += kEvery)
            bits += kEvery * filteredBits(rows, x, y);
    }
    return bits / 8;
}

}  // namespace

DeflatedPixels deflatedPixels(const PngRows& rows) {
    BitWriter bits;
    BitWriter::Cursor head = bits.begin(16);
    head.put(0x0178, 16);  // deflate with a window of 32 KiB, of the fastest kind
    bits.end(head);
    PixelMatcher matcher(rows);
    DeflateBlock block(rows);
    for (size_t y = 0; y < rows.height; ++y) {
        addRow(block, matcher, rows, y);
        const bool isLast = y + 1 == rows.height;
        if (isLast || block.size() >= kBlockSize) block.write(bits, isLast);
    }
    std::vector<uint8_t> stream = bits.finish();
    const uint32_t sum = checkSum(rows);
    for (const int shift : {24, 16, 8, 0})
        stream.push_back(static_cast<uint8_t>(sum >> shift));
    const bool isBetterFiltered = filteredBytes(rows) < stream.size();
    return {std::move(stream), isBetterFiltered};
}

}  // namespace vorelpaint
