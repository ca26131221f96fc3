#include "deflate_block.h"

#include <algorithm>
#include <numeric>

#include "prefix_code.h"

namespace vorelpaint {
namespace {

// The numbers of the format, RFC 1951.
constexpr uint8_t kNoFilter = 0;
constexpr size_t kSymbols = 286;
constexpr size_t kDistances = 30;
constexpr size_t kEnd = 256;
constexpr size_t kFirstLength = 257;
constexpr uint32_t kFewestLength = 3;
constexpr uint32_t kMostLength = 258;
constexpr unsigned int kOwnCode = 2;
constexpr int kMostBits = 15;
constexpr size_t kExtraBits = 5 + 13;  ///< of a length and a distance, at most

/// A symbol, and the bits behind it that tell its values apart.
struct Symbol {
    size_t number;
    uint32_t bits;
    unsigned int count;
};

/// Of a number above 0.
unsigned int highestBit(uint32_t number) {
    return 31U - static_cast<unsigned int>(__builtin_clz(number));
}

/// Calls `take` with the lengths that make up one of at least 3 bytes; their number.
template <typename Take>
uint32_t forEachPart(uint32_t length, Take take) {
    uint32_t parts = 1;
    for (; length > kMostLength; ++parts) {
        // None is left that is too short to be told.
        const uint32_t part = std::min(kMostLength, length - kFewestLength);
        take(part);
        length -= part;
    }
    take(length);
    return parts;
}

/// Among `2^shift` symbols for each power of two, after as many with one value each; values from 0.
Symbol graded(uint32_t value, unsigned int shift) {
    const uint32_t each = 1U << shift;
    if (value < 2 * each) return {value, 0, 0};
    const unsigned int count = highestBit(value) - shift;
    return {each * count + (value >> count), value & ((1U << count) - 1), count};
}

/// Of a length in bytes, 3 to 258. The greatest one has a symbol of its own.
Symbol lengthSymbol(uint32_t length) {
    if (length == kMostLength) return {kSymbols - 1, 0, 0};
    Symbol symbol = graded(length - kFewestLength, 2);
    symbol.number += kFirstLength;
    return symbol;
}

/// Of a distance in bytes less one, 0 to 32767.
Symbol distanceSymbol(uint32_t distance) {
    return graded(distance, 1);
}

size_t bitsOf(const PrefixCode& code, const std::vector<uint32_t>& counts) {
    size_t bits = 0;
    for (size_t i = 0; i < counts.size(); ++i)
        bits += size_t{counts[i]} * code.length(i);
    return bits;
}

/// The number of symbols up to the last one with a word, at least `fewest`.
size_t usedSize(const PrefixCode& code, size_t fewest) {
    size_t size = code.size();
    while (size > fewest && code.length(size - 1) == 0)
        --size;
    return size;
}

// --- the codes' own code
// --------------------------------------------------------------------------------

constexpr size_t kRepeat = 16;     ///< the last length again, 3 to 6 times
constexpr size_t kFewZeros = 17;   ///< 3 to 10
constexpr size_t kManyZeros = 18;  ///< 11 to 138
constexpr size_t kLengthSymbols = 19;

void addRun(std::vector<Symbol>& symbols, uint8_t length, size_t count) {
    struct Kind {
        size_t number;
        size_t fewest;
        size_t most;
        unsigned int bits;
    };
    constexpr Kind kRepeats{kRepeat, 3, 6, 2};
    constexpr Kind kFew{kFewZeros, 3, 10, 3};
    constexpr Kind kMany{kManyZeros, 11, 138, 7};
    if (length != 0) {
        symbols.push_back({length, 0, 0});
        --count;
    }
    const auto longRuns = [&](const Kind& kind) {
        for (; count >= kind.fewest; count -= std::min(count, kind.most))
            symbols.push_back({kind.number,
                               static_cast<uint32_t>(std::min(count, kind.most) - kind.fewest),
                               kind.bits});
    };
    if (length == 0) longRuns(kMany);
    longRuns(length == 0 ? kFew : kRepeats);
    symbols.insert(symbols.end(), count, {length, 0, 0});
}

/// The lengths of codes, with runs of one length told at once.
std::vector<Symbol> lengthSymbols(const std::vector<uint8_t>& lengths) {
    std::vector<Symbol> symbols;
    for (auto at = lengths.begin(); at != lengths.end();) {
        const auto end = std::find_if(at, lengths.end(), [&](uint8_t length) { return length != *at; });
        addRun(symbols, *at, static_cast<size_t>(end - at));
        at = end;
    }
    return symbols;
}

void writeCodes(BitWriter::Cursor& bits, const PrefixCode& literals, const PrefixCode& distances) {
    constexpr std::array<uint8_t, kLengthSymbols> kOrder{16, 17, 18, 0, 8,  7, 9,  6, 10, 5,
                                                         11, 4,  12, 3, 13, 2, 14, 1, 15};
    const size_t literalCount = usedSize(literals, kFirstLength);
    const size_t distanceCount = usedSize(distances, 1);
    std::vector<uint8_t> lengths(literals.lengths().begin(),
                                 literals.lengths().begin() + static_cast<ptrdiff_t>(literalCount));
    lengths.insert(lengths.end(), distances.lengths().begin(),
                   distances.lengths().begin() + static_cast<ptrdiff_t>(distanceCount));
    const std::vector<Symbol> symbols = lengthSymbols(lengths);
    std::vector<uint32_t> counts(kLengthSymbols);
    for (const Symbol& symbol : symbols)
        ++counts[symbol.number];
    const PrefixCode code(counts, 7);
    size_t ordered = kOrder.size();
    while (ordered > 4 && code.length(kOrder[ordered - 1]) == 0)
        --ordered;
    bits.put(literalCount - kFirstLength, 5);
    bits.put(distanceCount - 1, 5);
    bits.put(ordered - 4, 4);
    for (size_t i = 0; i < ordered; ++i)
        bits.put(code.length(kOrder[i]), 3);
    for (const Symbol& symbol : symbols) {
        bits.put(code.word(symbol.number), code.length(symbol.number));
        bits.put(symbol.bits, symbol.count);
    }
}

/// The most that writeCodes takes, and the begin and the end of a block.
constexpr size_t kHeadBits = 3 + 14 + 3 * kLengthSymbols + (kSymbols + kDistances) * 14 + 15;

void putSymbol(BitWriter::Cursor& bits, const PrefixCode& code, const Symbol& symbol) {
    const unsigned int length = code.length(symbol.number);
    bits.put(code.word(symbol.number) | symbol.bits << length, length + symbol.count);
}

/// The words of bytes, each with its length beside it.
class LiteralWords {
  public:
    explicit LiteralWords(const PrefixCode& code) {
        for (size_t i = 0; i < mWords.size(); ++i)
            mWords[i] = {static_cast<uint16_t>(code.word(i)), static_cast<uint16_t>(code.length(i))};
    }

    void put(BitWriter::Cursor& bits, uint8_t byte) const {
        bits.put(mWords[byte].bits, mWords[byte].length);
    }
    void put(BitWriter::Cursor& bits, uint8_t one, uint8_t other) const {
        const Word first = mWords[one];
        const Word second = mWords[other];
        bits.put(first.bits | uint32_t{second.bits} << first.length,
                 uint32_t{first.length} + second.length);
    }

  private:
    struct Word {
        uint16_t bits;
        uint16_t length;
    };
    std::array<Word, 256> mWords;
};

}  // namespace

struct DeflateBlock::Codes {
    PrefixCode literals;
    PrefixCode distances;
};

DeflateBlock::DeflateBlock(const PngRows& rows)
    : mRows(rows), mSymbolCounts(kSymbols), mDistanceCounts(kDistances), mNextPixel(rows.pixels) {}

void DeflateBlock::startRow() {
    finishSequence();
    mOpen.startsRow = true;
    ++mSymbolCounts[kNoFilter];
}

void DeflateBlock::addPixel(const uint8_t* pixel) {
    for (size_t channel = 0; channel < mRows.bytesPerPixel; ++channel)
        ++mByteCounts[channel][pixel[channel]];
    ++mOpen.pixels;
    ++mSize;
}

void DeflateBlock::addMatch(const PixelMatch& match) {
    mOpen.repeated = static_cast<uint32_t>(match.length * mRows.bytesPerPixel);
    mOpen.distance = static_cast<uint16_t>(match.distance - 1);
    const uint32_t parts = forEachPart(
        mOpen.repeated, [&](uint32_t length) { ++mSymbolCounts[lengthSymbol(length).number]; });
    mDistanceCounts[distanceSymbol(mOpen.distance).number] += parts;
    ++mSize;
    finishSequence();
}

void DeflateBlock::finishSequence() {
    if (mOpen.startsRow || mOpen.pixels > 0 || mOpen.repeated > 0) mSequences.push_back(mOpen);
    mOpen = {};
}

std::vector<uint32_t> DeflateBlock::literalCounts() const {
    std::vector<uint32_t> counts = mSymbolCounts;
    for (const ByteCounts& channel : mByteCounts) {
        for (size_t i = 0; i < channel.size(); ++i)
            counts[i] += channel[i];
    }
    counts[kEnd] = 1;
    return counts;
}

void DeflateBlock::write(BitWriter& bits, bool isLast) {
    finishSequence();
    const std::vector<uint32_t> counts = literalCounts();
    const size_t matches = std::accumulate(mDistanceCounts.begin(), mDistanceCounts.end(), size_t{0});
    const Codes codes{PrefixCode(counts, kMostBits), PrefixCode(mDistanceCounts, kMostBits)};
    BitWriter::Cursor cursor =
        bits.begin(kHeadBits + bitsOf(codes.literals, counts) +
                   bitsOf(codes.distances, mDistanceCounts) + kExtraBits * matches);
    cursor.put(isLast ? 1 : 0, 1);
    cursor.put(kOwnCode, 2);
    writeCodes(cursor, codes.literals, codes.distances);
    writeSequences(cursor, codes);
    cursor.put(codes.literals.word(kEnd), codes.literals.length(kEnd));
    bits.end(cursor);
    mSequences.clear();
    std::fill(mSymbolCounts.begin(), mSymbolCounts.end(), 0);
    std::fill(mDistanceCounts.begin(), mDistanceCounts.end(), 0);
    mByteCounts = {};
    mSize = 0;
}

void DeflateBlock::writeSequences(BitWriter::Cursor& bits, const Codes& codes) {
    const LiteralWords words(codes.literals);
    BitWriter::Cursor to = bits;
    const uint8_t* pixel = mNextPixel;
    const bool hasFourth = mRows.bytesPerPixel == 4;
    for (const Sequence& sequence : mSequences) {
        if (sequence.startsRow) words.put(to, kNoFilter);
        for (size_t i = 0; i < sequence.pixels; ++i, pixel += 4) {
            words.put(to, pixel[0], pixel[1]);
            hasFourth ? words.put(to, pixel[2], pixel[3]) : words.put(to, pixel[2]);
        }
        if (sequence.repeated == 0) continue;
        const Symbol distance = distanceSymbol(sequence.distance);
        forEachPart(sequence.repeated, [&](uint32_t length) {
            putSymbol(to, codes.literals, lengthSymbol(length));
            putSymbol(to, codes.distances, distance);
        });
        pixel += 4 * size_t{sequence.repeated} / mRows.bytesPerPixel;
    }
    mNextPixel = pixel;
    bits = to;
}

}  // namespace vorelpaint
