#include "compose/shelf.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace vorelcompose {
namespace {

using Words = Shelf<int, const std::string>;

std::shared_ptr<const std::string> word(const char* text) {
    return std::make_shared<const std::string>(text);
}

TEST(Shelf, WhatIsKept_IsFoundUnderItsKeyAlone) {
    Words shelf(2);
    shelf.keep(1, word("one"));
    EXPECT_EQ(*shelf.find(1), "one");
    EXPECT_FALSE(shelf.find(2));
    shelf.keep(1, word("uno"));
    EXPECT_EQ(*shelf.find(1), "uno");
}

TEST(Shelf, WhatWasAskedForTheLongestAgo_MakesRoom) {
    Words shelf(2);
    shelf.keep(1, word("one"));
    shelf.keep(2, word("two"));
    shelf.find(1);
    shelf.keep(3, word("three"));
    EXPECT_TRUE(shelf.find(1));
    EXPECT_FALSE(shelf.find(2));
    EXPECT_TRUE(shelf.find(3));
}

TEST(Shelf, HeavyThings_MakeRoomForEachOther) {
    Words shelf(9, 10);
    shelf.keep(1, word("one"), 4);
    shelf.keep(2, word("two"), 4);
    shelf.keep(3, word("three"), 3);
    EXPECT_FALSE(shelf.find(1)) << "4 + 4 + 3 is more than 10";
    EXPECT_TRUE(shelf.find(2));
    shelf.keep(3, word("tres"), 6);
    EXPECT_TRUE(shelf.find(2)) << "what a thing takes the place of weighs no more";
    shelf.keep(4, word("four"), 10);
    EXPECT_FALSE(shelf.find(2));
    EXPECT_FALSE(shelf.find(3));
    EXPECT_TRUE(shelf.find(4));
}

TEST(Shelf, WhatIsTooHeavy_IsNotKeptAndMovesNothing) {
    Words shelf(9, 10);
    shelf.keep(1, word("one"), 10);
    shelf.keep(2, word("two"), 11);
    EXPECT_TRUE(shelf.find(1));
    EXPECT_FALSE(shelf.find(2));
}

TEST(Shelf, WhoHoldsAThing_StillHasIt) {
    Words shelf(1);
    shelf.keep(1, word("one"));
    const auto held = shelf.find(1);
    shelf.keep(2, word("two"));
    EXPECT_EQ(*held, "one");
}

}  // namespace
}  // namespace vorelcompose
