#include "text/scripts.h"

#include <gtest/gtest.h>

#include <string>

#include "text/utf8.h"

namespace voreltext {
namespace {

/// The first letter of the script of each character: Latin, Hebrew, Greek, or Z for Common.
std::string initials(const char* text) {
    std::string result;
    for (const uint32_t script : scriptsOf(decodeUtf8(text)))
        result += static_cast<char>(script >> 24);
    return result;
}

TEST(Scripts, Letters_HaveTheirOwn) {
    EXPECT_EQ(initials(""), "");
    EXPECT_EQ(initials("aאγ"), "LHG");
}

TEST(Scripts, WhatIsOfSeveral_TakesThatBefore) {
    EXPECT_EQ(initials("a, א1"), "LLLHH");
    EXPECT_EQ(initials("e\u0301א\u0301"), "LLHH");
}

TEST(Scripts, AtTheBeginning_ItTakesThatBehind) {
    EXPECT_EQ(initials("1. a"), "LLLL");
    EXPECT_EQ(initials("\u0301א"), "HH");
    EXPECT_EQ(initials("123"), "ZZZ");
}

TEST(Scripts, Brackets_ArePairs) {
    EXPECT_EQ(initials("a(א)!"), "LLHLL");
    EXPECT_EQ(initials("a(א[γ)]"), "LLHHGLL") << "what is not paired within another pair is forgotten";
    EXPECT_EQ(initials("aא)"), "LHH") << "one that was never opened";
}

}  // namespace
}  // namespace voreltext
