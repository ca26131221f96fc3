#include "prefix_code.h"

#include <algorithm>
#include <array>
#include <utility>

namespace vorelpaint {
namespace {

constexpr size_t kMostBits = 15;
using LengthCounts = std::array<uint32_t, kMostBits + 1>;

/// The symbols that occur, the rarest first.
std::vector<size_t> byCount(const std::vector<uint32_t>& counts) {
    std::vector<size_t> symbols;
    for (size_t i = 0; i < counts.size(); ++i) {
        if (counts[i] != 0) symbols.push_back(i);
    }
    std::stable_sort(symbols.begin(), symbols.end(),
                     [&](size_t one, size_t other) { return counts[one] < counts[other]; });
    return symbols;
}

/// The lengths of Huffman's code for symbols in the order of their counts, of which there are at least
/// two. The two rarest nodes are joined until one is left; joined ones come into being in the order of
/// their counts, so the rarest is always the next symbol or the next joined one.
std::vector<size_t> depths(const std::vector<uint32_t>& counts, const std::vector<size_t>& symbols) {
    std::vector<uint64_t> nodes;
    nodes.reserve(2 * symbols.size());
    for (const size_t symbol : symbols)
        nodes.push_back(counts[symbol]);
    std::vector<size_t> parents(2 * symbols.size() - 1);
    size_t leaf = 0;
    size_t joined = symbols.size();
    const auto take = [&]() {
        const bool isLeaf =
            leaf < symbols.size() && (joined == nodes.size() || nodes[leaf] <= nodes[joined]);
        const size_t rarest = isLeaf ? leaf++ : joined++;
        parents[rarest] = nodes.size();
        return nodes[rarest];
    };
    while (nodes.size() < parents.size()) {
        const uint64_t one = take();
        const uint64_t other = take();
        nodes.push_back(one + other);
    }
    std::vector<size_t> depth(parents.size());
    for (size_t i = parents.size() - 1; i-- > 0;)
        depth[i] = depth[parents[i]] + 1;
    depth.resize(symbols.size());
    return depth;
}

/// How many words there are of each length when none is longer than `most`. Cut to that length they take
/// more room than there is. As long as they do, a shorter word gives its room to two that are one bit
/// longer, one of them for a symbol that had a word of the greatest length.
LengthCounts limited(const std::vector<size_t>& depth, size_t most) {
    LengthCounts count{};
    uint64_t room = 0;  // taken, in words of the greatest length
    for (const size_t each : depth) {
        const size_t length = std::min(each, most);
        ++count[length];
        room += uint64_t{1} << (most - length);
    }
    for (; room > uint64_t{1} << most; --room) {
        size_t shorter = most - 1;
        while (count[shorter] == 0)
            --shorter;
        --count[shorter];
        count[shorter + 1] += 2;
        --count[most];
    }
    return count;
}

uint16_t reversed(uint32_t word, size_t length) {
    uint32_t result = 0;
    for (size_t bit = 0; bit < length; ++bit)
        result |= (word >> bit & 1U) << (length - 1 - bit);
    return static_cast<uint16_t>(result);
}

}  // namespace

PrefixCode::PrefixCode(const std::vector<uint32_t>& counts, int mostBits)
    : mLengths(counts.size()), mWords(counts.size()) {
    const std::vector<size_t> symbols = byCount(counts);
    if (symbols.size() < 2) {
        mLengths[symbols.empty() ? 0 : symbols.front()] = 1;
        return;
    }
    const LengthCounts count = limited(depths(counts, symbols), static_cast<size_t>(mostBits));
    size_t next = symbols.size();
    for (size_t length = 1; length < count.size(); ++length) {
        for (uint32_t i = 0; i < count[length]; ++i)
            mLengths[symbols[--next]] = static_cast<uint8_t>(length);
    }
    giveWords();
}

/// The format's way: by length, and in the order of the symbols within one.
void PrefixCode::giveWords() {
    LengthCounts count{};
    for (const uint8_t length : mLengths)
        ++count[length];
    count[0] = 0;
    LengthCounts next{};
    for (size_t length = 1; length <= kMostBits; ++length)
        next[length] = (next[length - 1] + count[length - 1]) << 1;
    for (size_t i = 0; i < mLengths.size(); ++i)
        mWords[i] = reversed(next[mLengths[i]]++, mLengths[i]);
}

}  // namespace vorelpaint
