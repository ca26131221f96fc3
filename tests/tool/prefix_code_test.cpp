#include "prefix_code.h"

#include <gtest/gtest.h>

#include <random>
#include <string>
#include <vector>

namespace vorelpaint {
namespace {

using Counts = std::vector<uint32_t>;

std::vector<int> lengthsOf(const PrefixCode& code) {
    return {code.lengths().begin(), code.lengths().end()};
}

/// The room that the words take, in words of 15 bits; a code without gaps has 2^15.
uint32_t roomOf(const PrefixCode& code) {
    uint32_t room = 0;
    for (size_t i = 0; i < code.size(); ++i) {
        if (code.length(i) != 0) room += 1U << (15 - code.length(i));
    }
    return room;
}

/// A word with its first bit first.
std::string spelled(const PrefixCode& code, size_t symbol) {
    std::string bits;
    for (unsigned int i = 0; i < code.length(symbol); ++i)
        bits += (code.word(symbol) >> i & 1U) != 0 ? '1' : '0';
    return bits;
}

/// The counts of Fibonacci: Huffman's code of them has a word as long as there are symbols, less one.
Counts fibonacci(size_t size) {
    Counts counts{1, 1};
    while (counts.size() < size)
        counts.push_back(counts[counts.size() - 1] + counts[counts.size() - 2]);
    return counts;
}

TEST(PrefixCode, Lengths_AreHuffmans) {
    EXPECT_EQ(lengthsOf(PrefixCode({1, 1, 2, 4}, 15)), (std::vector<int>{3, 3, 2, 1}));
    EXPECT_EQ(lengthsOf(PrefixCode({5, 5, 5, 5}, 15)), (std::vector<int>{2, 2, 2, 2}));
    EXPECT_EQ(lengthsOf(PrefixCode({45, 13, 12, 16, 9, 5}, 15)), (std::vector<int>{1, 3, 3, 3, 4, 4}));
    EXPECT_EQ(lengthsOf(PrefixCode(fibonacci(6), 15)), (std::vector<int>{5, 5, 4, 3, 2, 1}));
}

TEST(PrefixCode, SymbolsThatNeverOccur_HaveNoWord) {
    EXPECT_EQ(lengthsOf(PrefixCode({0, 3, 0, 1, 0}, 15)), (std::vector<int>{0, 1, 0, 1, 0}));
}

TEST(PrefixCode, OneSymbolOrNone_HasAWordOfOneBit) {
    EXPECT_EQ(lengthsOf(PrefixCode({0, 0, 7}, 15)), (std::vector<int>{0, 0, 1}));
    EXPECT_EQ(lengthsOf(PrefixCode({0, 0, 0}, 15)), (std::vector<int>{1, 0, 0}));
}

/// The example of the format, RFC 1951, 3.2.2: lengths 3, 3, 3, 3, 3, 2, 4, 4.
TEST(PrefixCode, Words_AreThoseOfTheFormat) {
    const PrefixCode code({4, 4, 4, 4, 4, 9, 2, 2}, 15);
    ASSERT_EQ(lengthsOf(code), (std::vector<int>{3, 3, 3, 3, 3, 2, 4, 4}));
    const std::vector<std::string> words{"010", "011", "100", "101", "110", "00", "1110", "1111"};
    for (size_t i = 0; i < words.size(); ++i)
        EXPECT_EQ(spelled(code, i), words[i]);
}

TEST(PrefixCode, LongestWord_IsWithinTheLimit) {
    for (const int most : {5, 7, 15}) {
        const PrefixCode code(fibonacci(30), most);
        EXPECT_LE(code.length(0), static_cast<unsigned int>(most));
        for (size_t i = 1; i < code.size(); ++i)
            EXPECT_GE(code.length(i - 1), code.length(i)) << "what is rarer is longer";
        EXPECT_EQ(roomOf(code), 1U << 15) << most;
    }
}

TEST(PrefixCode, AnyCounts_FillTheRoomExactly) {
    std::mt19937 random(5);
    for (int round = 0; round < 500; ++round) {
        Counts counts(2 + random() % 285);
        for (uint32_t& count : counts)
            count = static_cast<uint32_t>(random() % (1U << (random() % 24)));
        counts[0] = 1;
        counts[1] = 1;
        const PrefixCode code(counts, round % 2 == 0 ? 15 : 9);
        EXPECT_EQ(roomOf(code), 1U << 15);
    }
}

}  // namespace
}  // namespace vorelpaint
