#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace vorelpaint {

/// A Huffman code as deflate has them: what occurs often has few bits, none more than a given number.
class PrefixCode {
  public:
    /// Of symbols that occur so often; those that never do have no code word. One symbol alone has a
    /// word of one bit, and so has symbol 0 where none occurs. There are at most 2^mostBits symbols;
    /// mostBits is at most 15.
    PrefixCode(const std::vector<uint32_t>& counts, int mostBits);

    size_t size() const { return mLengths.size(); }
    unsigned int length(size_t symbol) const { return mLengths[symbol]; }  ///< in bits; 0 without a word
    uint32_t word(size_t symbol) const { return mWords[symbol]; }  ///< its first bit is the lowest
    const std::vector<uint8_t>& lengths() const { return mLengths; }

  private:
    void giveWords();

    std::vector<uint8_t> mLengths;
    std::vector<uint16_t> mWords;
};

}  // namespace vorelpaint
