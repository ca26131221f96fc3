#include <gtest/gtest.h>

#include <cmath>
#include <string>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using literal::Stop;
using VFontEffect::VFGradient;
using VFontEffect::VFInnerGlow;
using VFontEffect::VFInnerGlowProperty;
using VFontEffect::VFOuterGlow;
using VFontEffect::VFOuterGlowProperty;

constexpr uint32_t kBlack = 0xFF000000;
constexpr uint32_t kWhite = 0xFFFFFFFF;
constexpr uint32_t kRed = 0xFFFF0000;
constexpr uint32_t kGreen = 0xFF00FF00;
constexpr uint32_t kBlue = 0xFF0000FF;

using Table = std::vector<uint32_t>;

/// The two cores share their loops: every test runs on both.
template <class Core>
struct RecordOf;
template <>
struct RecordOf<VFOuterGlow> {
    using Type = VFOuterGlowProperty;
};
template <>
struct RecordOf<VFInnerGlow> {
    using Type = VFInnerGlowProperty;
};

template <class Core>
class GrowthLoops : public ::testing::Test {
  protected:
    Table table(float size, uint32_t color, const std::vector<Stop>& stops, float fadeStart = 0.3F,
                int curve = 0) {
        std::vector<VFGradient> array = libraryStops(stops);
        typename RecordOf<Core>::Type record(size, color, 1.0F, static_cast<int>(array.size()),
                                             array.empty() ? nullptr : array.data());
        Core core;
        core.setProperty(&record);
        return tableOf(core, fadeStart, curve);
    }

    static Table tableOf(Core& core, float fadeStart, int curve) {
        // The entry behind the table must stay as it is.
        Table entries(258, 0xABCDEF01);
        core.makeColorLUT(entries.data(), fadeStart, curve);
        EXPECT_EQ(0xABCDEF01U, entries.back());
        entries.pop_back();
        return entries;
    }

    std::vector<uint8_t> grown(std::vector<uint8_t> mask, int passes, int width, int height) {
        Core core;
        core.increaseByBoxFilter(mask.data(), passes, width, height);
        return mask;
    }

    int offset(float size) {
        typename RecordOf<Core>::Type record(size, kWhite, 1.0F, 0, nullptr);
        Core core;
        core.setProperty(&record);
        EXPECT_EQ(core.getOffset(), core.getLeftOffset());
        EXPECT_EQ(core.getOffset(), core.getRightOffset());
        EXPECT_EQ(core.getOffset(), core.getTopOffset());
        EXPECT_EQ(core.getOffset(), core.getBottomOffset());
        return core.getOffset();
    }
};

struct CoreNames {
    template <class Core>
    static std::string GetName(int index) {
        return index == 0 ? "Outer" : "Inner";
    }
};

using Cores = ::testing::Types<VFOuterGlow, VFInnerGlow>;
TYPED_TEST_SUITE(GrowthLoops, Cores, CoreNames);

uint32_t alphaOf(uint32_t color) {
    return color >> 24;
}
uint32_t rgbOf(uint32_t color) {
    return color & 0x00FFFFFF;
}

// --- Reach ----------------------------------------------------------------------------------------

TYPED_TEST(GrowthLoops, Offset_RoundsHalvesUp) {
    EXPECT_EQ(0, this->offset(0.0F));
    EXPECT_EQ(10, this->offset(10.0F));
    EXPECT_EQ(10, this->offset(10.4F));
    EXPECT_EQ(11, this->offset(10.5F));
    EXPECT_EQ(100, this->offset(100.0F));
}

TYPED_TEST(GrowthLoops, Offset_MatchesTheLiteralForm) {
    for (int tenth = 0; tenth <= 1100; ++tenth) {
        const float size = static_cast<float>(tenth) * 0.1F;
        ASSERT_EQ(literal::glowOffset(size), this->offset(size)) << size;
    }
}

// --- Colour table -----------------------------------------------------------------------------------

TYPED_TEST(GrowthLoops, Table_OfSizeZeroIsTransparent) {
    const Table nothing(257, 0);
    EXPECT_EQ(nothing, this->table(0.0F, kWhite, {}));
    EXPECT_EQ(nothing, this->table(-0.0F, kWhite, {}));
    EXPECT_EQ(nothing, this->table(0.0F, kWhite, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}}));
}

TYPED_TEST(GrowthLoops, Table_WithoutARecordIsTransparent) {
    TypeParam core;
    EXPECT_EQ(Table(257, 0), this->tableOf(core, 0.3F, 0));
}

TYPED_TEST(GrowthLoops, Table_OfOneColourFadesFromEntry76) {
    const Table table = this->table(5.0F, 0xFF102030, {});
    for (size_t i = 0; i <= 76; ++i)
        ASSERT_EQ(0xFF102030, table[i]) << i;
    for (size_t i = 77; i <= 255; ++i)
        ASSERT_EQ(0x102030U, rgbOf(table[i])) << i;
    // m = 256 * (256 - i) / 180: 128 at 166 (255 * 128 >> 8 = 127), 64 at 211 (63), 1 at 255 (0).
    EXPECT_EQ(127U, alphaOf(table[166]));
    EXPECT_EQ(63U, alphaOf(table[211]));
    EXPECT_EQ(0U, alphaOf(table[255]));
    EXPECT_EQ(0U, table[256]);
}

TYPED_TEST(GrowthLoops, Table_KeepsTheAlphaOfTheColour) {
    const Table table = this->table(5.0F, 0x80FFFFFF, {});
    EXPECT_EQ(0x80FFFFFFU, table[0]);
    EXPECT_EQ(0x40FFFFFFU, table[166]);  // 128 * 128 >> 8
}

TYPED_TEST(GrowthLoops, Table_OfOneStopIsThatColour) {
    const Table table = this->table(5.0F, kWhite, {{0xFF304050, 1.0F, 0.7F}});
    EXPECT_EQ(0xFF304050, table[0]);
    EXPECT_EQ(0xFF304050, table[76]);
    EXPECT_EQ(0x304050U, rgbOf(table[255]));
    EXPECT_EQ(0U, table[256]);
}

TYPED_TEST(GrowthLoops, Table_OfTwoStopsIsALinearRamp) {
    const Table table = this->table(5.0F, kRed, {{kBlack, 1.0F, 0.0F}, {kWhite, 1.0F, 1.0F}});
    EXPECT_EQ(kBlack, table[0]);
    for (uint32_t i = 1; i <= 255; ++i) {
        const uint32_t grey = i * 255 >> 8;
        ASSERT_EQ(grey << 16 | grey << 8 | grey, rgbOf(table[i])) << i;
    }
    for (size_t i = 0; i <= 76; ++i)
        ASSERT_EQ(255U, alphaOf(table[i])) << i;
}

TYPED_TEST(GrowthLoops, Table_MixesAlphaAsWell) {
    const Table table = this->table(5.0F, 0, {{0xFF000000, 1.0F, 0.0F}, {0x00000000, 1.0F, 1.0F}});
    EXPECT_EQ(0xBF000000, table[64]);  // 255 * 192 >> 8 = 191
}

TYPED_TEST(GrowthLoops, Table_FirstSegmentStartsAtZeroWhateverTheFirstStop) {
    const Table expected = this->table(5.0F, 0, {{kBlack, 1.0F, 0.0F}, {kWhite, 1.0F, 1.0F}});
    EXPECT_EQ(expected, this->table(5.0F, 0, {{kBlack, 1.0F, 0.6F}, {kWhite, 1.0F, 1.0F}}));
}

TYPED_TEST(GrowthLoops, Table_PassesOneStopPerEntry) {
    // t = i / 256 passes 0.1, 0.1001 and 0.1002 between entries 25 and 26.
    const Table table = this->table(5.0F, 0,
                                    {{kBlack, 1.0F, 0.0F},
                                     {kRed, 1.0F, 0.1F},
                                     {kGreen, 1.0F, 0.1001F},
                                     {kBlue, 1.0F, 0.1002F},
                                     {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kGreen, table[26]) << "first shift: past the end of red to green";
    EXPECT_EQ(kBlue, table[27]) << "second shift: past the end of green to blue";
    // Third shift: (28 / 256 - 0.1002) / 0.8998 * 256 = 2.6, so 2 of 256 towards black.
    EXPECT_EQ(0xFF0000FDU, table[28]);
}

TYPED_TEST(GrowthLoops, Table_ThirdSegmentWaitsForTheNextEntry) {
    // Entry 26 lies past 0.1 and 0.101 alike, but stays in the segment between them, at its end.
    const Table table = this->table(
        5.0F, 0,
        {{kBlack, 1.0F, 0.0F}, {kBlack, 1.0F, 0.1F}, {kWhite, 1.0F, 0.101F}, {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kBlack, table[25]);
    EXPECT_EQ(kWhite, table[26]);
    // Entry 27: (27 / 256 - 0.101) / 0.899 * 256 = 1.27, so 1 of 256 towards black.
    EXPECT_EQ(0xFFFEFEFE, table[27]);
}

TYPED_TEST(GrowthLoops, Table_PassesAStopOnlyBeyondIt) {
    // Entry 64 lies on the second stop and passes none; entry 65 passes it and stays at the third.
    const Table table = this->table(
        5.0F, 0,
        {{kBlack, 1.0F, 0.0F}, {kRed, 1.0F, 0.25F}, {kWhite, 1.0F, 0.2501F}, {kBlack, 1.0F, 1.0F}});
    EXPECT_EQ(kRed, table[64]);
    EXPECT_EQ(kWhite, table[65]);
    EXPECT_EQ(0xFFFDFDFD, table[66]);  // 2 of 256 towards black
}

TYPED_TEST(GrowthLoops, Table_KeepsTheLastSegmentWhenStopsEndEarly) {
    const Table table =
        this->table(5.0F, 0, {{kBlack, 1.0F, 0.0F}, {kRed, 1.0F, 0.125F}, {kBlue, 1.0F, 0.25F}});
    EXPECT_EQ(kRed, table[32]);
    EXPECT_EQ(0xFF7F007FU, table[48]);
    for (size_t i = 64; i <= 255; ++i)
        ASSERT_EQ(rgbOf(kBlue), rgbOf(table[i])) << i;
}

TYPED_TEST(GrowthLoops, Table_CurvesBendTheRamp) {
    const std::vector<Stop> ramp{{kBlack, 1.0F, 0.0F}, {kWhite, 1.0F, 1.0F}};
    // Entry 64 stands for 0.25: its root is 0.5, its square 0.0625.
    EXPECT_EQ(0x3F3F3FU, rgbOf(this->table(5.0F, 0, ramp, 0.3F, 0)[64]));
    EXPECT_EQ(0x7F7F7FU, rgbOf(this->table(5.0F, 0, ramp, 0.3F, 1)[64]));
    EXPECT_EQ(0x0F0F0FU, rgbOf(this->table(5.0F, 0, ramp, 0.3F, 2)[64]));
    EXPECT_EQ(this->table(5.0F, 0, ramp, 0.3F, 0), this->table(5.0F, 0, ramp, 0.3F, 3));
    EXPECT_EQ(this->table(5.0F, 0, ramp, 0.3F, 0), this->table(5.0F, 0, ramp, 0.3F, -1));
}

TYPED_TEST(GrowthLoops, Table_FadeStartIsClamped) {
    // 0.99 starts at 253: m is 256 * 2 / 3 at 254 and 256 / 3 at 255.
    const Table late = this->table(5.0F, kWhite, {}, 1.0F);
    EXPECT_EQ(late, this->table(5.0F, kWhite, {}, 7.0F));
    EXPECT_EQ(255U, alphaOf(late[253]));
    EXPECT_EQ(169U, alphaOf(late[254]));
    EXPECT_EQ(84U, alphaOf(late[255]));
    // 0.01 starts at 2: half way, at 129, m is 128.
    const Table early = this->table(5.0F, kWhite, {}, 0.0F);
    EXPECT_EQ(early, this->table(5.0F, kWhite, {}, -3.0F));
    EXPECT_EQ(255U, alphaOf(early[2]));
    EXPECT_EQ(127U, alphaOf(early[129]));
    // 0.5 starts at 128: m is 128 at 192.
    EXPECT_EQ(127U, alphaOf(this->table(5.0F, kWhite, {}, 0.5F)[192]));
}

TYPED_TEST(GrowthLoops, Table_OfSegmentsWithoutLengthJumps) {
    // An infinite quotient saturates to the upper colour.
    const Table jump = this->table(5.0F, 0, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 0.0F}});
    EXPECT_EQ(kRed, jump[0]);
    EXPECT_EQ(kBlue, jump[1]);
    EXPECT_EQ(kBlue, jump[75]);
    // Not a number converts to 0: the lower colour stays.
    const Table stuck = this->table(5.0F, 0, {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, std::nanf("")}});
    EXPECT_EQ(kRed, stuck[1]);
    EXPECT_EQ(rgbOf(kRed), rgbOf(stuck[255]));
}

TYPED_TEST(GrowthLoops, Table_WithACountButNoArrayHasTheOneColour) {
    const Table plain = this->table(5.0F, 0xFF102030, {});
    for (int count : {1, 2, 256, -1}) {
        typename RecordOf<TypeParam>::Type record(5.0F, 0xFF102030, 1.0F, count, nullptr);
        TypeParam core;
        core.setProperty(&record);
        EXPECT_EQ(plain, this->tableOf(core, 0.3F, 0)) << count;
    }
}

TYPED_TEST(GrowthLoops, Table_WithAnArrayButNoCountHasTheOneColour) {
    const Table plain = this->table(5.0F, 0xFF102030, {});
    VFGradient stops[] = {{kRed, 1.0F, 0.0F}, {kBlue, 1.0F, 1.0F}};
    for (int count : {0, -1, -2147483647 - 1}) {
        typename RecordOf<TypeParam>::Type record(5.0F, 0xFF102030, 1.0F, count, stops);
        TypeParam core;
        core.setProperty(&record);
        EXPECT_EQ(plain, this->tableOf(core, 0.3F, 0)) << count;
    }
}

TYPED_TEST(GrowthLoops, Table_OfRandomStopsMatchesTheLiteralForm) {
    forSeeds(1000, 3000, [&](Random& random) {
        const int count = random.chance(5) ? 256 : random.between(0, 9);
        const std::vector<Stop> stops = randomStops(random, count);
        const uint32_t color = randomStraight(random);
        float fadeStart = random.chance(50) ? 0.3F : random.real(-0.2F, 1.2F);
        if (random.chance(2)) fadeStart = std::nanf("");
        const int curve = random.between(0, 2);
        EXPECT_EQ(literal::glowColours(5.0F, color, stops, fadeStart, curve),
                  this->table(5.0F, color, stops, fadeStart, curve));
    });
}

TYPED_TEST(GrowthLoops, Table_IsNotWrittenWithoutATable) {
    typename RecordOf<TypeParam>::Type record(5.0F, kWhite, 1.0F, 0, nullptr);
    TypeParam core;
    core.makeColorLUT(nullptr, 0.3F, 0);
    core.setProperty(&record);
    core.makeColorLUT(nullptr, 0.3F, 0);
    EXPECT_EQ(kWhite, this->tableOf(core, 0.3F, 0)[0]) << "the core is as good as before";
}

// --- Growth -----------------------------------------------------------------------------------------

TYPED_TEST(GrowthLoops, Growth_SpreadsALonePixelToItsNeighbours) {
    std::vector<uint8_t> mask(100, 0);
    mask[55] = 255;
    const std::vector<uint8_t> result = this->grown(mask, 1, 10, 10);
    for (int y = 0; y < 10; ++y) {
        for (int x = 0; x < 10; ++x) {
            const bool near = x >= 4 && x <= 6 && y >= 4 && y <= 6;
            EXPECT_EQ(near ? 63 : 0, result[static_cast<size_t>(y * 10 + x)]) << x << " " << y;
        }
    }
}

TYPED_TEST(GrowthLoops, Growth_OfTwoPassesWorksOnTheFirst) {
    std::vector<uint8_t> mask(49, 0);
    mask[24] = 255;
    // Quarters of 1, 2, 3, 4, 6 and 9 times 63.
    const std::vector<uint8_t> expected{0, 0,  0,  0,   0,  0,  0,  //
                                        0, 15, 31, 47,  31, 15, 0,  //
                                        0, 31, 63, 94,  63, 31, 0,  //
                                        0, 47, 94, 141, 94, 47, 0,  //
                                        0, 31, 63, 94,  63, 31, 0,  //
                                        0, 15, 31, 47,  31, 15, 0,  //
                                        0, 0,  0,  0,   0,  0,  0};
    EXPECT_EQ(expected, this->grown(mask, 2, 7, 7));
}

TYPED_TEST(GrowthLoops, Growth_KeepsEndRowsAndClearsEndColumns) {
    // Four or more full neighbours saturate.
    const std::vector<uint8_t> expected{255, 255, 255, 255,  //
                                        0,   255, 255, 0,    //
                                        0,   255, 255, 0,    //
                                        255, 255, 255, 255};
    EXPECT_EQ(expected, this->grown(std::vector<uint8_t>(16, 255), 1, 4, 4));
    EXPECT_EQ(expected, this->grown(std::vector<uint8_t>(16, 255), 3, 4, 4));
}

TYPED_TEST(GrowthLoops, Growth_TruncatesTheQuarter) {
    std::vector<uint8_t> mask(9, 0);
    mask[4] = 7;
    EXPECT_EQ(1, this->grown(mask, 1, 3, 3)[4]);
    mask[4] = 3;
    EXPECT_EQ(0, this->grown(mask, 1, 3, 3)[4]);
    EXPECT_EQ(225, this->grown(std::vector<uint8_t>(9, 100), 1, 3, 3)[4]);
}

TYPED_TEST(GrowthLoops, Growth_OfOneOrTwoRowsChangesNothing) {
    const std::vector<uint8_t> line{1, 2, 3, 4, 5, 6};
    EXPECT_EQ(line, this->grown(line, 5, 6, 1));
    EXPECT_EQ(line, this->grown(line, 5, 3, 2));
}

TYPED_TEST(GrowthLoops, Growth_OfOneOrTwoColumnsClearsTheInnerRows) {
    EXPECT_EQ((std::vector<uint8_t>{9, 9, 0, 0, 0, 0, 9, 9}),
              this->grown(std::vector<uint8_t>(8, 9), 1, 2, 4));
    EXPECT_EQ((std::vector<uint8_t>{9, 0, 0, 9}), this->grown(std::vector<uint8_t>(4, 9), 2, 1, 4));
}

TYPED_TEST(GrowthLoops, Growth_WithoutPassesChangesNothing) {
    const std::vector<uint8_t> mask(25, 200);
    EXPECT_EQ(mask, this->grown(mask, 0, 5, 5));
    EXPECT_EQ(mask, this->grown(mask, -4, 5, 5));
}

TYPED_TEST(GrowthLoops, Growth_WithoutSizesOrAMaskChangesNothing) {
    const std::vector<uint8_t> mask(25, 200);
    EXPECT_EQ(mask, this->grown(mask, 2, 0, 5));
    EXPECT_EQ(mask, this->grown(mask, 2, -5, 5));
    EXPECT_EQ(mask, this->grown(mask, 2, 5, -5));
    EXPECT_EQ(mask, this->grown(mask, 2, 5, 0));
    TypeParam core;
    core.increaseByBoxFilter(nullptr, 2, 5, 5);
}

TYPED_TEST(GrowthLoops, Growth_OfRandomMasksMatchesTheLiteralForm) {
    forSeeds(2000, 1500, [&](Random& random) {
        const auto mask = randomMask(random, random.between(1, 70), random.between(1, 24));
        const int passes = random.between(0, 6);
        std::vector<uint8_t> expected = mask.bytes;
        literal::boxFilter(expected, passes, mask.width, mask.height);
        EXPECT_EQ(expected, this->grown(mask.bytes, passes, mask.width, mask.height))
            << mask.width << " x " << mask.height << ", passes " << passes;
    });
}

TYPED_TEST(GrowthLoops, Growth_OfManyPassesMatchesTheLiteralForm) {
    // Several tiles in each direction, of which some stop changing and start again.
    forSeeds(4000, 250, [&](Random& random) {
        const int width = random.between(1, 210);
        const int height = random.between(1, 90);
        const bool isSparse = random.chance(50);
        const auto mask =
            isSparse ? noiseMask(random, width, height, 99) : randomMask(random, width, height);
        const int passes = random.between(1, 60);
        std::vector<uint8_t> expected = mask.bytes;
        literal::boxFilter(expected, passes, width, height);
        EXPECT_EQ(expected, this->grown(mask.bytes, passes, width, height))
            << width << " x " << height << ", passes " << passes;
    });
}

TYPED_TEST(GrowthLoops, Growth_OfFaintPixelsDiesOutLikeTheLiteralForm) {
    // Below 4 a lone pixel vanishes in one pass; small groups of them come and go.
    forSeeds(5000, 300, [&](Random& random) {
        auto mask = noiseMask(random, random.between(3, 140), random.between(3, 40), 70);
        for (uint8_t& coverage : mask.bytes)
            coverage = static_cast<uint8_t>(coverage % 4);
        const int passes = random.between(1, 30);
        std::vector<uint8_t> expected = mask.bytes;
        literal::boxFilter(expected, passes, mask.width, mask.height);
        EXPECT_EQ(expected, this->grown(mask.bytes, passes, mask.width, mask.height));
    });
}

TYPED_TEST(GrowthLoops, Growth_OfFullMasksMatchesTheLiteralForm) {
    for (int width = 1; width <= 130; ++width) {
        const int height = 3 + width % 40;
        const auto pixels = static_cast<size_t>(width * height);
        for (int passes : {1, 2, 5}) {
            std::vector<uint8_t> expected(pixels, 255);
            literal::boxFilter(expected, passes, width, height);
            ASSERT_EQ(expected, this->grown(std::vector<uint8_t>(pixels, 255), passes, width, height))
                << width << " x " << height << ", passes " << passes;
        }
    }
}

TYPED_TEST(GrowthLoops, Growth_OfInkAtTheEdgesMatchesTheLiteralForm) {
    forSeeds(6000, 400, [&](Random& random) {
        const int width = random.between(1, 100);
        const int height = random.between(3, 50);
        std::vector<uint8_t> mask(static_cast<size_t>(width * height), 0);
        for (int i = random.between(1, 6); i > 0; --i) {
            const bool atSide = random.chance(50);
            const int x = atSide ? (random.chance(50) ? 0 : width - 1) : random.between(0, width - 1);
            const int y = atSide ? random.between(0, height - 1) : (random.chance(50) ? 0 : height - 1);
            mask[static_cast<size_t>(y * width + x)] = random.byte();
        }
        const int passes = random.between(1, 20);
        std::vector<uint8_t> expected = mask;
        literal::boxFilter(expected, passes, width, height);
        EXPECT_EQ(expected, this->grown(mask, passes, width, height))
            << width << " x " << height << ", passes " << passes;
    });
}

TYPED_TEST(GrowthLoops, Growth_OfTheGalleryMatchesTheLiteralForm) {
    for (const NamedMask& named : maskGallery()) {
        for (int passes : {1, 2, 19}) {
            std::vector<uint8_t> expected = named.mask.bytes;
            literal::boxFilter(expected, passes, named.mask.width, named.mask.height);
            ASSERT_EQ(expected,
                      this->grown(named.mask.bytes, passes, named.mask.width, named.mask.height))
                << named.name << ", passes " << passes;
        }
    }
}

}  // namespace
