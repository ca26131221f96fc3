#include "text/canvas.h"

#include <gtest/gtest.h>

#include <array>
#include <limits>
#include <string>
#include <vector>

#include "text/error.h"

namespace voreltext {
namespace {

constexpr Margins kNoEffects{0, 0, 0, 0};

/// The message of what `call` throws.
template <typename Call>
std::string faultOf(Call call) {
    try {
        call();
    } catch (const TextError& error) {
        return error.what();
    }
    return "none";
}

TEST(Canvas, WithoutSides_SurroundsTheBox) {
    CanvasRequest request;
    request.padding = 8;
    const Canvas canvas = placedOn(request, {3, -70, 103, 20}, {1, 2, 3, 4});
    EXPECT_EQ(canvas.width, 8 + 1 + 100 + 3 + 8);
    EXPECT_EQ(canvas.height, 8 + 2 + 90 + 4 + 8);
    EXPECT_EQ(canvas.x + 3, 8 + 1) << "the box begins behind padding and effects";
    EXPECT_EQ(canvas.y - 70, 8 + 2);
}

TEST(Canvas, NineAnchors_PutTheBoxAtTheirPlaces) {
    CanvasRequest request;
    request.width = 200;
    request.height = 101;
    request.margin = 10;
    const Box box{-5, -30, 45, 10};  // 50 x 40
    // The room is 180 x 81: 130 columns and 41 rows are free.
    constexpr std::array<int, 3> kLefts{10, 10 + 65, 10 + 130};
    constexpr std::array<int, 3> kTops{10, 10 + 20, 10 + 41};
    for (int i = 0; i < 9; ++i) {
        request.anchor = static_cast<Anchor>(i);
        const Canvas canvas = placedOn(request, box, {20, 20, 20, 20});
        EXPECT_EQ(canvas.width, 200);
        EXPECT_EQ(canvas.height, 101);
        EXPECT_EQ(canvas.x + box.left, kLefts[static_cast<size_t>(i % 3)]) << i;
        EXPECT_EQ(canvas.y + box.top, kTops[static_cast<size_t>(i / 3)]) << i;
    }
}

TEST(Canvas, LargerBox_ReachesBeyondOnTheOtherSide) {
    CanvasRequest request;
    request.width = 100;
    const Box box{0, 0, 121, 10};
    request.anchor = Anchor::left;
    EXPECT_EQ(placedOn(request, box, kNoEffects).x, 0);
    request.anchor = Anchor::right;
    EXPECT_EQ(placedOn(request, box, kNoEffects).x, -21);
    request.anchor = Anchor::center;
    EXPECT_EQ(placedOn(request, box, kNoEffects).x, -11) << "the odd pixel is on the right, as for 21";
}

TEST(Canvas, OneSideAlone_LeavesTheOtherToTheText) {
    CanvasRequest request;
    request.width = 300;
    request.margin = 50;
    request.padding = 4;
    request.anchor = Anchor::bottomRight;
    const Canvas canvas = placedOn(request, {0, -40, 100, 10}, {7, 7, 7, 7});
    EXPECT_EQ(canvas.width, 300);
    EXPECT_EQ(canvas.x, 300 - 50 - 100);
    EXPECT_EQ(canvas.height, 4 + 7 + 50 + 7 + 4);
    EXPECT_EQ(canvas.y, 4 + 7 + 40);
}

TEST(Canvas, BeyondTheLargestPicture_IsRefused) {
    CanvasRequest request;
    request.width = TextLayout::kMaxSide;
    request.height = TextLayout::kMaxSide;
    EXPECT_THROW(placedOn(request, {0, 0, 1, 1}, kNoEffects), TextError);
    request.height = 10;
    EXPECT_NO_THROW(placedOn(request, {0, 0, 1, 1}, kNoEffects));
}

TEST(Canvas, NumbersOfAnySize_AreRefusedOrFarOutside) {
    constexpr int kMost = std::numeric_limits<int>::max();
    constexpr int kLeast = std::numeric_limits<int>::min();
    CanvasRequest request;
    request.padding = kMost;
    EXPECT_THROW(placedOn(request, {0, 0, 1, 1}, kNoEffects), TextError);
    request.padding = kLeast;
    EXPECT_THROW(placedOn(request, {0, 0, 1, 1}, kNoEffects), TextError);
    request.padding = 0;
    EXPECT_THROW(placedOn(request, {0, 0, 1, 1}, {kMost, 0, kMost, 0}), TextError);
    request.width = 100;
    request.height = 100;
    request.anchor = Anchor::topLeft;
    request.margin = kMost;
    EXPECT_GT(placedOn(request, {0, 0, 1, 1}, kNoEffects).x, TextLayout::kMaxSide);
    request.anchor = Anchor::bottomRight;
    EXPECT_LT(placedOn(request, {0, 0, 1, 1}, kNoEffects).y, -TextLayout::kMaxSide);
    request.margin = kLeast;
    EXPECT_GT(placedOn(request, {0, 0, 1, 1}, kNoEffects).y, TextLayout::kMaxSide);
}

TEST(Canvas, WithoutABox_MayBeEmpty) {
    const Canvas canvas = placedOn({}, {}, kNoEffects);
    EXPECT_EQ(canvas.width, 0);
    EXPECT_EQ(canvas.height, 0);
}

TEST(Room, IsWhatTheMarginsLeave) {
    CanvasRequest request;
    request.width = 100;
    request.margin = 49;
    const Room room = roomOf(request);
    EXPECT_EQ(room.width, 2);
    EXPECT_FALSE(room.height);
    EXPECT_TRUE(room.holds({0, 0, 2, 9999}));
    EXPECT_FALSE(room.holds({0, 0, 3, 1}));
}

TEST(Room, MarginsThatLeaveNone_AreRefused) {
    CanvasRequest request;
    request.height = 100;
    request.margin = 50;
    EXPECT_EQ(faultOf([&] { roomOf(request); }),
              "margins of 50 pixels leave no room in a canvas of 100");
    request.margin = 0x7FFFFFFF;
    EXPECT_NE(faultOf([&] { roomOf(request); }), "none");
}

TEST(LargestThatFits, IsTheLast_OfEveryLimit) {
    for (int limit = 0; limit <= 70; ++limit) {
        int asked = 0;
        const auto fits = [&](int size) {
            ++asked;
            return size <= limit;
        };
        const std::optional<int> found = largestThatFits(64, fits);
        if (limit == 0) {
            EXPECT_FALSE(found);
        } else {
            EXPECT_EQ(found, std::min(limit, 64));
        }
        EXPECT_LE(asked, 8) << "a layout for each is costly";
    }
}

}  // namespace
}  // namespace voreltext
