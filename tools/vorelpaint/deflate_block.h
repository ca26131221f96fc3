#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "bit_writer.h"
#include "pixel_matcher.h"
#include "png_rows.h"

namespace vorelpaint {

/// A part of a picture in the making: pixels as they are and repetitions of pixels, and from their
/// counts, when it is written, the code that suits them.
class DeflateBlock {
  public:
    /// The rows must outlive it.
    explicit DeflateBlock(const PngRows& rows);

    /// What follows on what was added before, in the order of the file.
    void startRow();
    void addPixel(const uint8_t* pixel);
    void addMatch(const PixelMatch& match);

    size_t size() const { return mSize; }  ///< pixels and matches since the last one was written

    /// Writes what was added since the last time.
    void write(BitWriter& bits, bool isLast);

  private:
    using ByteCounts = std::array<uint32_t, 256>;

    /// Pixels as they are and what is repeated behind them.
    struct Sequence {
        uint32_t pixels = 0;
        uint32_t repeated = 0;  ///< bytes
        uint16_t distance = 0;  ///< less one
        bool startsRow = false;
    };
    struct Codes;

    void finishSequence();
    std::vector<uint32_t> literalCounts() const;
    void writeSequences(BitWriter::Cursor& bits, const Codes& codes);

    PngRows mRows;
    std::vector<Sequence> mSequences;
    Sequence mOpen;
    size_t mSize = 0;
    std::array<ByteCounts, 4> mByteCounts{};  ///< of each channel
    std::vector<uint32_t> mSymbolCounts;      ///< of filters, the end and lengths
    std::vector<uint32_t> mDistanceCounts;
    const uint8_t* mNextPixel;  ///< to be written
};

}  // namespace vorelpaint
