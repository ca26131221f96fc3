#include "core/windows.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <vector>

#include "tests/support/core_compare.h"

/// Windows: each pixel in one of them, as few and as low ones as the memory allows.
namespace {

using namespace vorel_test;
using VFontEffect::internal::Box;
using VFontEffect::internal::intersection;
using VFontEffect::internal::WindowBands;
using VFontEffect::internal::Windows;
using VFontEffect::internal::windowsWithin;
using VFontEffect::internal::WindowWalk;

/// An operator that keeps its window and what is in reach around it.
int64_t planeBytes(const Windows& windows, int64_t reach) {
    return (windows.width + 2 * reach) * (windows.height + 2 * reach);
}

TEST(Windows, HaveEachPixelOnce) {
    forSeeds(0, 2000, [](Random& random) {
        const int left = random.between(-20, 20);
        const int top = random.between(-20, 20);
        const Box part = {left, top, left + random.between(1, 30), top + random.between(1, 30)};
        const int reach = random.between(0, 9);
        const int64_t most = random.between(1, 2000);
        const Windows windows =
            windowsWithin(most, part, reach, [&](const Windows& cut) { return planeBytes(cut, reach); });
        const bool isPixel = windows.width == 1 && windows.height == 1;
        ASSERT_TRUE(isPixel || planeBytes(windows, reach) <= most);
        std::vector<int> painted(static_cast<size_t>(part.width() * part.height()));
        windows.forEach([&](const Box& window) {
            ASSERT_FALSE(window.empty());
            ASSERT_EQ(window, intersection(window, part));
            ASSERT_LE(window.width(), windows.width);
            ASSERT_LE(window.height(), windows.height);
            for (int64_t y = window.top - part.top; y < window.bottom - part.top; ++y) {
                for (int64_t x = window.left - part.left; x < window.right - part.left; ++x)
                    ++painted[static_cast<size_t>(y * part.width() + x)];
            }
        });
        ASSERT_EQ(painted, std::vector<int>(painted.size(), 1));
    });
}

/// Notes how often each pixel is painted, and where.
struct Noted : WindowBands {
    explicit Noted(const Box& all)
        : part(all), painted(static_cast<size_t>(part.width() * part.height())) {}

    void beginWindow(const Box& begun) override {
        window = begun;
        next = begun.top;
    }
    /// 1 to 3, by where it begins.
    int64_t bandRows() const override { return std::abs(next) % 3 + 1; }
    void paintBand(const Box& band) override {
        ASSERT_EQ(next, band.top);
        const int64_t end = std::min(next + bandRows(), window.bottom);
        ASSERT_EQ(band, (Box{window.left, next, window.right, end}));
        ASSERT_LE(band.bottom, limit);
        next = band.bottom;
        for (int64_t y = band.top - part.top; y < band.bottom - part.top; ++y) {
            for (int64_t x = band.left - part.left; x < band.right - part.left; ++x)
                ++painted[static_cast<size_t>(y * part.width() + x)];
        }
    }

    Box part;
    std::vector<int> painted;
    Box window = {};
    int64_t next = 0;
    int64_t limit = 0;
};

TEST(WindowWalk, PaintsEachPixelOnce_NoneBelowTheLimitAndAllAboveWhatItReturns) {
    forSeeds(0, 2000, [](Random& random) {
        const int left = random.between(-20, 20);
        const int top = random.between(-20, 20);
        const Box part = {left, top, left + random.between(1, 30), top + random.between(1, 30)};
        const Windows windows = {part, random.between(1, 31), random.between(1, 31)};
        WindowWalk walk(windows);
        Noted noted(part);
        const std::vector<int>& painted = noted.painted;
        for (int64_t limit = top - 5; limit < part.bottom; limit += random.between(0, 9)) {
            noted.limit = limit;
            const int64_t done = walk.goAbove(limit, noted);
            ASSERT_LE(done, limit);
            // What waits is a band, or a row of windows that lie side by side.
            ASSERT_GT(done, limit - (windows.areCutAcross() ? windows.height : 3));
            const int64_t rows = std::clamp<int64_t>(done, part.top, part.bottom) - part.top;
            const auto end = painted.begin() + rows * part.width();
            ASSERT_EQ(std::count(painted.begin(), end, 1), end - painted.begin());
            ASSERT_EQ(std::count(end, painted.end(), 0), painted.end() - end);
        }
        noted.limit = part.bottom + random.between(0, 100);
        ASSERT_EQ(noted.limit, walk.goAbove(noted.limit, noted));
        ASSERT_EQ(painted, std::vector<int>(painted.size(), 1));
    });
}

TEST(Windows, ThatFitAsOne_AreNotCut) {
    const Windows windows = windowsWithin(1000, {5, 6, 105, 16}, 3,
                                          [](const Windows& cut) { return cut.width * cut.height; });
    EXPECT_EQ(windows.width, 100);
    EXPECT_EQ(windows.height, 10);
    EXPECT_FALSE(windows.areCutAcross());
    EXPECT_FALSE(windows.areCutDown());
}

TEST(Windows, OfPlanes_AreLowBeforeTheyAreNarrow) {
    const Windows windows = windowsWithin(1'000'000, {0, 0, 4096, 4096}, 10,
                                          [](const Windows& cut) { return planeBytes(cut, 10); });
    EXPECT_FALSE(windows.areCutAcross());
    EXPECT_GT(windows.height, 8 * 10);
}

TEST(Windows, OfPlanesWithALongReach_AreNotThin) {
    const Windows windows = windowsWithin(1'000'000, {0, 0, 4096, 4096}, 200,
                                          [](const Windows& cut) { return planeBytes(cut, 200); });
    EXPECT_GT(windows.height, 400);
    EXPECT_GT(windows.width, 400);
}

TEST(Windows, OfAnOperatorThatKeepsRows_StayAsHighAsTheyAre) {
    const Windows windows = windowsWithin(1'000'000, {0, 0, 50'000, 9000}, 50,
                                          [](const Windows& cut) { return 100 * cut.width; });
    EXPECT_TRUE(windows.areCutAcross());
    EXPECT_FALSE(windows.areCutDown());
}

TEST(Windows, OfTheLongestPictures_AreFoundAtOnce) {
    constexpr int64_t kLongest = INT32_MAX;
    for (const Box part : {Box{0, 0, kLongest, 1}, Box{0, 0, 1, kLongest}, Box{0, 0, 65535, 65535}}) {
        int asked = 0;
        const Windows windows = windowsWithin(1'000'000, part, 100, [&](const Windows& cut) {
            ++asked;
            return planeBytes(cut, 100);
        });
        EXPECT_LE(planeBytes(windows, 100), 1'000'000);
        EXPECT_LT(asked, 1000);
    }
}

}  // namespace
