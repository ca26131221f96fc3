#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/core_compare.h"
#include "tests/support/guarded.h"
#include "tests/support/literal_cores.h"
#include "tests/support/mask_gallery.h"

namespace {

using namespace vorel_test;
using VFontEffect::VFECore;
using VFontEffect::VFStroke;
using VFontEffect::VFStrokeProperty;
using DilationWork = VFontEffect::VFStroke::DilationWork;

constexpr int kCentre = 0;
constexpr int kOutside = 1;
constexpr int kInside = 2;

std::unique_ptr<VFECore> coreWith(float size, uint32_t color, int position) {
    return coreOf<VFStroke, VFStrokeProperty>(size, color, 1.0F, 0, position);
}

/// The scene after a stroke by the library.
Scene stroked(const Scene& scene, float size, uint32_t color, int position) {
    return painted(*coreWith(size, color, position), scene);
}

::testing::AssertionResult matchesLiteral(const Scene& scene, float size, uint32_t color, int position) {
    auto same = paintsLike(*coreWith(size, color, position), scene, [&](Scene& expected) {
        literal::paintStroke(expected.dst, expected.sub ? &*expected.sub : nullptr, expected.mask,
                             expected.text, expected.useOuterLayer, size, color, position);
    });
    if (!same) same << "; size " << size << ", position " << position;
    return same;
}

int offsetOf(float size, int position) {
    const auto core = coreWith(size, kWhite, position);
    EXPECT_EQ(core->getOffset(), core->getLeftOffset());
    EXPECT_EQ(core->getOffset(), core->getRightOffset());
    EXPECT_EQ(core->getOffset(), core->getTopOffset());
    EXPECT_EQ(core->getOffset(), core->getBottomOffset());
    return core->getOffset();
}

/// One covered pixel in the middle of 5 x 5, alone in its box.
Scene lonePixel(uint8_t coverage) {
    Scene scene = sceneOf(filledMask(5, 5, 0), {2, 2, 3, 3});
    scene.mask.bytes[12] = coverage;
    return scene;
}

// --- The core as an object ------------------------------------------------------------------------

TEST(Stroke, NewCore_HasItsTypeAndNoRecord) {
    expectFreshCore<VFStroke>(10);
}

TEST(Stroke, Record_IsOwnedByTheCore) {
    expectOwnsItsRecord<VFStroke>(VFStrokeProperty(2.0F, 0xFF102030, 0.5F, 3, kOutside),
                                  VFStrokeProperty(4.0F, 0x80402010, 1.0F, 0, kInside),
                                  sceneOf(discMask(30, 30, 15.0F, 14.0F, 8.0F, true)));
}

TEST(Stroke, Record_IsStoredFieldForField) {
    VFStroke core;
    VFStrokeProperty record(2.25F, 0x12345678, 0.5F, 3, 7);
    core.setProperty(&record);
    const auto* stored = static_cast<VFStrokeProperty*>(core.getProperty());
    EXPECT_EQ(2.25F, stored->mSize);
    EXPECT_EQ(0x12345678U, stored->mColor);
    EXPECT_EQ(0.5F, stored->mOpacity);
    EXPECT_EQ(3, stored->mStrokeStyle);
    EXPECT_EQ(7, stored->mPosition);
}

TEST(Stroke, StyleAndOpacity_DoNotChangeThePaint) {
    const Scene scene = sceneOf(discMask(30, 30, 15.0F, 14.0F, 8.0F, true));
    const Scene plain = stroked(scene, 3.0F, kWhite, kOutside);
    const auto styled = coreOf<VFStroke, VFStrokeProperty>(3.0F, kWhite, 0.25F, 9, kOutside);
    EXPECT_TRUE(samePaint(plain, painted(*styled, scene)));
}

TEST(Stroke, Offset_OfSizeSevenFollowsThePosition) {
    EXPECT_EQ(7, offsetOf(7.0F, kOutside));
    EXPECT_EQ(4, offsetOf(7.0F, kCentre));  // 3.5 + 0.5
    EXPECT_EQ(0, offsetOf(7.0F, kInside));
    EXPECT_EQ(0, offsetOf(7.0F, -1));
}

TEST(Stroke, Offset_RoundsHalvesUp) {
    EXPECT_EQ(0, offsetOf(0.0F, kOutside));
    EXPECT_EQ(1, offsetOf(1.4F, kOutside));
    EXPECT_EQ(2, offsetOf(1.5F, kOutside));
    EXPECT_EQ(100, offsetOf(100.0F, kOutside));
    EXPECT_EQ(0, offsetOf(0.9F, kCentre));
    EXPECT_EQ(1, offsetOf(1.0F, kCentre));
    EXPECT_EQ(50, offsetOf(100.0F, kCentre));
}

TEST(Stroke, Offset_MatchesTheLiteralForm) {
    for (int tenth = 0; tenth <= 1100; ++tenth) {
        for (int position : {kCentre, kOutside, kInside}) {
            const float size = static_cast<float>(tenth) * 0.1F;
            ASSERT_EQ(literal::strokeOffset(size, position), offsetOf(size, position)) << size;
        }
    }
}

// --- Placements by hand: white over nothing shows the dilated plane ---------------------------------

TEST(Stroke, Outside_StampsTheDiscAroundOnePixel) {
    const Scene scene = lonePixel(255);
    // The diagonal lies 1.414 away: 0.586 * 255 + 0.5 = 149.9.
    const std::vector<int> expected{0, 0,   0,   0,   0,  //
                                    0, 149, 255, 149, 0,  //
                                    0, 255, 255, 255, 0,  //
                                    0, 149, 255, 149, 0,  //
                                    0, 0,   0,   0,   0};
    EXPECT_EQ(expected, alphaOf(stroked(scene, 1.0F, kWhite, kOutside).dst));
}

TEST(Stroke, Outside_LosesWhatTheKernelLacks) {
    const Scene scene = lonePixel(150);
    // Full cells hand on 150, the diagonal 150 - (255 - 149) = 44.
    const std::vector<int> expected{0, 0,   0,   0,   0,  //
                                    0, 44,  150, 44,  0,  //
                                    0, 150, 150, 150, 0,  //
                                    0, 44,  150, 44,  0,  //
                                    0, 0,   0,   0,   0};
    EXPECT_EQ(expected, alphaOf(stroked(scene, 1.0F, kWhite, kOutside).dst));
}

TEST(Stroke, Outside_FaintCoverageNeverGoesBelowZero) {
    Scene scene = sceneOf(filledMask(3, 3, 0), {1, 1, 2, 2});
    scene.mask.bytes[4] = 100;  // less than the 106 that the diagonal lacks
    EXPECT_EQ((std::vector<int>{0, 100, 0, 100, 100, 100, 0, 100, 0}),
              alphaOf(stroked(scene, 1.0F, kWhite, kOutside).dst));
}

TEST(Stroke, Outside_OfAnEmptyMaskPaintsNothing) {
    const Scene scene = sceneOf(filledMask(9, 9, 0));
    EXPECT_TRUE(samePaint(scene, stroked(scene, 3.0F, kWhite, kOutside)));
}

TEST(Stroke, Inside_GrowsTheBackgroundIntoTheGlyph) {
    Scene scene = sceneOf(filledMask(5, 5, 255), {1, 1, 4, 4});
    // Around the box of 3 x 3 lies a border of background; it reaches one pixel into the glyph.
    const std::vector<int> expected{255, 255, 255, 255, 255,  //
                                    255, 255, 255, 255, 255,  //
                                    255, 255, 0,   255, 255,  //
                                    255, 255, 255, 255, 255,  //
                                    255, 255, 255, 255, 255};
    EXPECT_EQ(expected, alphaOf(stroked(scene, 1.0F, kWhite, kInside).dst));
}

TEST(Stroke, Inside_OfAnEmptyMaskFillsTheWholePlane) {
    const Scene scene = sceneOf(filledMask(8, 8, 0), {3, 3, 5, 5});
    // The box and its border are background; the disc carries it one pixel further.
    const std::vector<int> expected{0, 0,   0,   0,   0,   0,   0,   0,  //
                                    0, 149, 255, 255, 255, 255, 149, 0,  //
                                    0, 255, 255, 255, 255, 255, 255, 0,  //
                                    0, 255, 255, 255, 255, 255, 255, 0,  //
                                    0, 255, 255, 255, 255, 255, 255, 0,  //
                                    0, 255, 255, 255, 255, 255, 255, 0,  //
                                    0, 149, 255, 255, 255, 255, 149, 0,  //
                                    0, 0,   0,   0,   0,   0,   0,   0};
    EXPECT_EQ(expected, alphaOf(stroked(scene, 1.0F, kWhite, kInside).dst));
}

TEST(Stroke, Inside_IsEveryPositionBeyondZeroAndOne) {
    const Scene scene = sceneOf(discMask(20, 20, 9.0F, 10.0F, 6.0F, true));
    const Scene inside = stroked(scene, 2.0F, kWhite, kInside);
    EXPECT_TRUE(samePaint(inside, stroked(scene, 2.0F, kWhite, 3)));
    EXPECT_TRUE(samePaint(inside, stroked(scene, 2.0F, kWhite, -1)));
}

TEST(Stroke, Centre_ReachesHalfItsSizeToBothSidesOfTheEdge) {
    Scene scene = sceneOf(filledMask(7, 7, 0));
    for (size_t i = 0; i < scene.mask.bytes.size(); ++i)
        scene.mask.bytes[i] = i % 7 >= 3 ? 255 : 0;
    const std::vector<int> alpha = alphaOf(stroked(scene, 2.0F, kWhite, kCentre).dst);
    // Coverage starts at column 3 and ends at the box: one pixel outside and one inside of each edge.
    const std::vector<int> middleRow(alpha.begin() + 21, alpha.begin() + 28);
    EXPECT_EQ((std::vector<int>{0, 0, 255, 255, 0, 0, 255}), middleRow);
}

TEST(Stroke, SizeZero_StampsSinglePixels) {
    Scene scene = sceneOf(filledMask(4, 1, 0));
    scene.mask.bytes = {0, 60, 200, 255};
    EXPECT_EQ((std::vector<int>{0, 60, 200, 255}), alphaOf(stroked(scene, 0.0F, kWhite, kOutside).dst));
    EXPECT_EQ((std::vector<int>{255, 195, 55, 0}), alphaOf(stroked(scene, 0.0F, kWhite, kInside).dst));
    EXPECT_EQ((std::vector<int>{0, 60, 55, 0}), alphaOf(stroked(scene, 0.0F, kWhite, kCentre).dst));
}

TEST(Stroke, Plane_IsPlacedOneAndTheRadiusBeforeTheBox) {
    Scene scene = sceneOf(filledMask(20, 20, 0), {9, 10, 10, 11});
    scene.mask.bytes[10 * 20 + 9] = 255;
    const std::vector<int> alpha = alphaOf(stroked(scene, 3.0F, kWhite, kOutside).dst);
    EXPECT_EQ(255, alpha[10 * 20 + 6]);
    EXPECT_EQ(255, alpha[10 * 20 + 12]);
    EXPECT_EQ(255, alpha[7 * 20 + 9]);
    EXPECT_EQ(255, alpha[13 * 20 + 9]);
    EXPECT_EQ(0, alpha[10 * 20 + 5]);
    EXPECT_EQ(0, alpha[14 * 20 + 9]);
}

// --- Blending ---------------------------------------------------------------------------------------

TEST(Stroke, CentreOutsideLayeredMode_PaintsOverTheDestination) {
    Scene scene = sceneOf(filledMask(3, 3, 0));
    scene.mask.bytes[4] = 255;
    scene.dst = filledPicture(3, 3, 0xFF112233);
    // Half of size 2: the covered pixel and its four neighbours lie within a pixel of the edge.
    const Scene result = stroked(scene, 2.0F, 0xFF804020, kCentre);
    const std::vector<int> red = channelOf(result.dst, 0);
    for (size_t at : {1U, 3U, 4U, 5U, 7U})
        EXPECT_EQ(0x80, red[at]) << at;
    // The corners are covered by 149: 0x11 * 106 gives 7, 0x80 * 149 gives 75.
    for (size_t at : {0U, 2U, 6U, 8U})
        EXPECT_EQ(7 + 75, red[at]) << at;
}

TEST(Stroke, AllOtherStrokes_SlideBeneathTheDestination) {
    Scene scene = sceneOf(discMask(12, 12, 6.0F, 6.0F, 3.0F, true));
    scene.dst = filledPicture(12, 12, 0xFF112233);
    EXPECT_TRUE(samePaint(scene, stroked(scene, 2.0F, kWhite, kOutside)));
    EXPECT_TRUE(samePaint(scene, stroked(scene, 2.0F, kWhite, kInside)));
    EXPECT_FALSE(samePaint(scene, stroked(scene, 2.0F, kWhite, kCentre)));
    scene.useOuterLayer = true;
    EXPECT_TRUE(samePaint(scene, stroked(scene, 2.0F, kWhite, kOutside)));
    EXPECT_TRUE(samePaint(scene, stroked(scene, 2.0F, kWhite, kInside)));
    EXPECT_TRUE(samePaint(scene, stroked(scene, 2.0F, kWhite, kCentre)));
}

TEST(Stroke, SecondDestination_GetsTheSamePaint) {
    Scene scene = sceneOf(discMask(16, 16, 8.0F, 8.0F, 4.0F, true));
    scene.sub = filledPicture(16, 16, 0);
    scene.useOuterLayer = true;
    const Scene result = stroked(scene, 3.0F, 0xFF804020, kCentre);
    EXPECT_FALSE(samePicture(scene.dst, result.dst));
    EXPECT_TRUE(samePicture(result.dst, *result.sub));
}

TEST(Stroke, SecondDestinationWithoutPixels_LeavesTheFirstItsPaint) {
    const Scene scene = sceneOf(discMask(16, 16, 8.0F, 8.0F, 4.0F, true));
    const auto core = coreWith(3.0F, kWhite, kOutside);
    auto mask = bitmapOf(scene.mask);
    auto dst = bitmapOf(scene.dst);
    VFontEffect::VFBitmap noPixels;
    VFontEffect::VFRect text(0, 0, 16, 16);
    VFontEffect::VFECore::ParamPostProcessing params{&dst, &mask, &text, 0, &noPixels};
    core->doPostProcessing(&params);
    const Scene expected = stroked(scene, 3.0F, kWhite, kOutside);
    EXPECT_EQ(expected.dst.bytes,
              std::vector<uint8_t>(dst.mData, dst.mData + expected.dst.bytes.size()));
    EXPECT_EQ(nullptr, noPixels.mData);
}

TEST(Stroke, LayeredModeOtherThanOne_CountsAsOff) {
    const Scene scene = sceneOf(discMask(12, 12, 6.0F, 6.0F, 3.0F, true));
    const auto core = coreWith(2.0F, kWhite, kCentre);
    auto mask = bitmapOf(scene.mask);
    auto dst = bitmapOf(filledPicture(12, 12, 0xFF000000));
    VFontEffect::VFRect text(0, 0, 12, 12);
    VFontEffect::VFECore::ParamPostProcessing params{&dst, &mask, &text, 2, nullptr};
    core->doPostProcessing(&params);
    EXPECT_EQ(255, dst.mData[(3 * 12 + 6) * 4]) << "source-over paints the opaque destination";
}

// --- Hostile input ----------------------------------------------------------------------------------

TEST(Stroke, BrokenInput_PaintsNothing) {
    for (int position : {kCentre, kOutside, kInside})
        expectNothingFromBrokenInput(*coreWith(2.0F, kWhite, position));
}

TEST(Stroke, SizesOutOfProportion_PaintNothing) {
    const float infinity = std::numeric_limits<float>::infinity();
    const Scene scene = sceneOf(discMask(12, 12, 6.0F, 6.0F, 3.0F, true));
    for (float size : {-3.0F, -40.0F, -1e9F, 256.5F, 3000.0F, 1e9F, 3e38F, infinity, -infinity}) {
        for (int position : {kCentre, kOutside, kInside}) {
            EXPECT_TRUE(samePaint(scene, stroked(scene, size, kWhite, position)))
                << size << " " << position;
        }
    }
    EXPECT_TRUE(samePaint(scene, stroked(scene, -1.5F, kWhite, kOutside)));
}

TEST(Stroke, LargestSize_MatchesTheLiteralForm) {
    Scene scene = sceneOf(filledMask(20, 20, 0), {9, 10, 10, 11});
    scene.mask.bytes[10 * 20 + 9] = 200;
    EXPECT_TRUE(matchesLiteral(scene, 256.0F, 0xC0604020, kOutside));
    EXPECT_TRUE(matchesLiteral(scene, 256.0F, 0xC0604020, kCentre));
}

TEST(Stroke, SmallNegativeAndUnorderedSizes_MatchTheLiteralForm) {
    const Scene scene = sceneOf(discMask(12, 12, 6.0F, 6.0F, 3.0F, true));
    for (float size : {-0.0F, -0.25F, -0.5F, -1.0F, -1.4F, -1.6F, -2.9F, std::nanf("")}) {
        for (int position : {kCentre, kOutside, kInside}) {
            EXPECT_TRUE(matchesLiteral(scene, size, kWhite, position));
        }
    }
}

// --- The dilation routines --------------------------------------------------------------------------

/// One dilation job with its buffers.
struct Job {
    Job(const literal::Mask& mask, float radius)
        : disc(literal::circleKernel(radius)), source(mask.bytes) {
        work.radius = disc.side / 2;
        work.kernelSide = disc.side;
        work.sourceWidth = mask.width;
        work.sourceHeight = mask.height;
        work.planeWidth = mask.width + 2 * work.radius;
        work.planeHeight = mask.height + 2 * work.radius;
        work.firstRow = 0;
        work.endRow = mask.height;
        planes.assign(2 * planePixels(), 0);
        work.plane = planes.data();
        work.source = source.data();
        work.kernel = disc.weights.data();
    }
    Job(const Job&) = delete;
    Job& operator=(const Job&) = delete;

    size_t planePixels() const {
        return static_cast<size_t>(work.planeWidth) * static_cast<size_t>(work.planeHeight);
    }
    std::vector<uint8_t> firstPlane() const { return {planes.begin(), middle()}; }
    std::vector<uint8_t> secondPlane() const { return {middle(), planes.end()}; }
    std::vector<uint8_t>::const_iterator middle() const {
        return planes.begin() + static_cast<std::ptrdiff_t>(planePixels());
    }
    std::vector<uint8_t> literalPlane(bool inverse) const {
        return literal::dilated(source, work.sourceWidth, work.sourceHeight, disc, inverse,
                                work.firstRow, work.endRow);
    }

    literal::CircleKernel disc;
    std::vector<uint8_t> source;
    std::vector<uint8_t> planes;
    DilationWork work{};
};

using Routine = int (*)(void*);
constexpr Routine kRoutines[] = {VFStroke::partalDTStrokeCenter, VFStroke::partalDTStrokeOutside,
                                 VFStroke::partalDTStrokeInside};

TEST(StrokeDilation, WholeSource_MatchesTheLiteralForm) {
    forSeeds(5000, 400, [](Random& random) {
        const auto mask = randomMask(random, random.between(1, 24), random.between(1, 24));
        const float radius = random.real(0.0F, 9.0F);
        Job centre(mask, radius);
        EXPECT_EQ(1, VFStroke::partalDTStrokeCenter(&centre.work));
        EXPECT_EQ(centre.literalPlane(false), centre.firstPlane());
        EXPECT_EQ(centre.literalPlane(true), centre.secondPlane());

        Job outside(mask, radius);
        EXPECT_EQ(1, VFStroke::partalDTStrokeOutside(&outside.work));
        EXPECT_EQ(outside.literalPlane(false), outside.firstPlane());
        EXPECT_EQ(std::vector<uint8_t>(outside.planePixels(), 0), outside.secondPlane());

        Job inside(mask, radius);
        EXPECT_EQ(1, VFStroke::partalDTStrokeInside(&inside.work));
        EXPECT_EQ(inside.literalPlane(true), inside.firstPlane());
        EXPECT_EQ(std::vector<uint8_t>(inside.planePixels(), 0), inside.secondPlane());
    });
}

TEST(StrokeDilation, OneBand_StampsOnlyItsRows) {
    forSeeds(6000, 400, [](Random& random) {
        const auto mask = randomMask(random, random.between(1, 24), random.between(1, 24));
        Job job(mask, random.real(0.0F, 9.0F));
        job.work.firstRow = random.between(0, mask.height - 1);
        job.work.endRow = random.between(job.work.firstRow + 1, mask.height);
        EXPECT_EQ(1, VFStroke::partalDTStrokeCenter(&job.work));
        EXPECT_EQ(job.literalPlane(false), job.firstPlane());
        EXPECT_EQ(job.literalPlane(true), job.secondPlane());
    });
}

TEST(StrokeDilation, BandsInAnyOrder_GiveThePlanesOfOneCall) {
    forSeeds(7000, 300, [](Random& random) {
        const auto mask = randomMask(random, random.between(1, 20), random.between(2, 30));
        const float radius = random.real(0.0F, 8.0F);
        const int cut = random.between(1, mask.height - 1);
        const int secondCut = random.between(cut, mask.height);
        for (Routine routine : kRoutines) {
            Job whole(mask, radius);
            EXPECT_EQ(1, routine(&whole.work));

            Job bands(mask, radius);
            const int cuts[][2] = {{secondCut, mask.height}, {0, cut}, {cut, secondCut}};
            for (const auto& band : cuts) {
                bands.work.firstRow = band[0];
                bands.work.endRow = band[1];
                EXPECT_EQ(band[0] < band[1] ? 1 : 0, routine(&bands.work));
            }
            EXPECT_EQ(whole.planes, bands.planes);
        }
    });
}

/// The source has as many covered rows on both sides, which belong to no band.
TEST(StrokeDilation, BandBeyondTheSource_IsCutToIt) {
    const literal::Mask mask = discMask(9, 27, 4.0F, 13.0F, 13.0F, true);
    for (Routine routine : kRoutines) {
        Job whole(mask, 2.0F);
        Job beyond(mask, 2.0F);
        for (Job* const job : {&whole, &beyond}) {
            job->work.source += 9 * 9;
            job->work.sourceHeight = 9;
        }
        whole.work.endRow = 9;
        beyond.work.firstRow = -4;
        beyond.work.endRow = 13;
        EXPECT_EQ(1, routine(&whole.work));
        EXPECT_EQ(1, routine(&beyond.work));
        EXPECT_EQ(whole.planes, beyond.planes);
    }
}

TEST(StrokeDilation, EmptyBand_ReturnsZeroAndWritesNothing) {
    const literal::Mask mask = discMask(9, 9, 4.0F, 4.0F, 3.0F, true);
    for (Routine routine : kRoutines) {
        for (const auto& band : {std::pair{0, 0}, std::pair{5, 5}, std::pair{9, 9}, std::pair{6, 2}}) {
            Job job(mask, 2.0F);
            job.work.firstRow = band.first;
            job.work.endRow = band.second;
            EXPECT_EQ(0, routine(&job.work));
            EXPECT_EQ(std::vector<uint8_t>(job.planes.size(), 0), job.planes);
        }
    }
}

TEST(StrokeDilation, MissingPointers_ReturnZeroAndWriteNothing) {
    const literal::Mask mask = discMask(9, 9, 4.0F, 4.0F, 3.0F, true);
    for (Routine routine : kRoutines) {
        EXPECT_EQ(0, routine(nullptr));
        Job job(mask, 2.0F);
        const DilationWork sound = job.work;
        job.work.source = nullptr;
        EXPECT_EQ(0, routine(&job.work));
        job.work = sound;
        job.work.kernel = nullptr;
        EXPECT_EQ(0, routine(&job.work));
        job.work = sound;
        job.work.plane = nullptr;
        EXPECT_EQ(0, routine(&job.work));
        EXPECT_EQ(std::vector<uint8_t>(job.planes.size(), 0), job.planes);
    }
}

TEST(StrokeDilation, SizesThatDoNotFit_ReturnZeroAndWriteNothing) {
    const literal::Mask mask = discMask(9, 9, 4.0F, 4.0F, 3.0F, true);
    const auto broken = [&](Routine routine, auto spoil) {
        Job job(mask, 2.0F);
        spoil(job.work);
        EXPECT_EQ(0, routine(&job.work));
        EXPECT_EQ(std::vector<uint8_t>(job.planes.size(), 0), job.planes);
    };
    for (Routine routine : kRoutines) {
        broken(routine, [](DilationWork& work) { work.radius = -1; });
        broken(routine, [](DilationWork& work) { work.radius = 3; });
        broken(routine, [](DilationWork& work) { work.kernelSide = 7; });
        broken(routine, [](DilationWork& work) { work.planeWidth = 12; });
        broken(routine, [](DilationWork& work) { work.planeHeight = 12; });
        broken(routine, [](DilationWork& work) { work.sourceWidth = 0; });
        broken(routine, [](DilationWork& work) { work.sourceWidth = -9; });
        broken(routine, [](DilationWork& work) { work.sourceHeight = 0; });
    }
}

// --- Against the literal form -----------------------------------------------------------------------

TEST(Stroke, SmallScenes_MatchTheLiteralForm) {
    forSeeds(1000, 2500, [](Random& random) {
        const Scene scene = randomScene(random, 22);
        const float size =
            random.chance(50) ? static_cast<float>(random.between(0, 12)) : random.real(0.0F, 12.0F);
        EXPECT_TRUE(matchesLiteral(scene, size, randomPremultiplied(random), random.between(0, 2)));
    });
}

TEST(Stroke, LargeSizes_MatchTheLiteralForm) {
    forSeeds(2000, 60, [](Random& random) {
        const Scene scene = randomScene(random, 12);
        EXPECT_TRUE(matchesLiteral(scene, random.real(12.0F, 100.0F), randomPremultiplied(random),
                                   random.between(0, 2)));
    });
    const Scene disc = sceneOf(discMask(40, 40, 20.0F, 20.0F, 12.0F, true), {8, 8, 33, 33});
    EXPECT_TRUE(matchesLiteral(disc, 100.0F, kWhite, kOutside));
    EXPECT_TRUE(matchesLiteral(disc, 100.0F, kWhite, kCentre));
}

TEST(Stroke, EveryMaskOfTheGallery_MatchesTheLiteralForm) {
    forGallery([](Random& random, const literal::Mask& mask) {
        for (int position : {kCentre, kOutside, kInside}) {
            const Scene scene = randomScene(random, mask);
            ASSERT_TRUE(matchesLiteral(scene, 0.0F, 0xFF102030, position));
            ASSERT_TRUE(matchesLiteral(scene, 2.6F, kWhite, position));
            ASSERT_TRUE(
                matchesLiteral(scene, random.real(4.0F, 9.0F), randomPremultiplied(random), position));
        }
    });
}

TEST(Stroke, DestinationOfAnotherSize_IsClipped) {
    forOtherDestinations(200, 14, 20, [](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 6.0F), randomPremultiplied(random),
                                   random.between(0, 2)));
    });
}

// --- The ways of dilation, which go by the size, and where they end ---------------------------------

/// The mask in the middle of an empty layer with room for an outline of that size.
Scene sceneWithRoom(const literal::Mask& mask, float size) {
    const int margin = literal::truncated(size) + 3;
    literal::Mask layer = filledMask(mask.width + 2 * margin, mask.height + 2 * margin, 0);
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            layer.bytes[static_cast<size_t>((y + margin) * layer.width + x + margin)] =
                mask.bytes[static_cast<size_t>(y * mask.width + x)];
        }
    }
    return sceneOf(layer, {margin, margin, margin + mask.width, margin + mask.height});
}

void expectLiteralForm(const literal::Mask& mask, float size) {
    const Scene scene = sceneWithRoom(mask, size);
    for (int position : {kCentre, kOutside, kInside}) {
        // Half of a centred stroke's size is its radius.
        const float record = position == kCentre ? 2.0F * size : size;
        if (record <= 256.0F) {
            ASSERT_TRUE(matchesLiteral(scene, record, kWhite, position));
        }
    }
}

/// A mask whose coverage is nowhere more than `most`.
literal::Mask faint(literal::Mask mask, int most) {
    for (uint8_t& coverage : mask.bytes)
        coverage = static_cast<uint8_t>(coverage * most / 255);
    return mask;
}

TEST(StrokeWays, EveryRadius_MatchesTheLiteralForm) {
    // Fractions change the rim; a reach of 2 and, by the level, one of 8 to 16 is the last of its way,
    // and from 24 on tiles have longer windows.
    for (int eighth = 0; eighth <= 26 * 8; ++eighth) {
        SCOPED_TRACE("radius in eighths " + std::to_string(eighth));
        Random random(static_cast<uint64_t>(eighth) + 1);
        expectLiteralForm(randomMask(random, random.between(1, 40), random.between(1, 14)),
                          static_cast<float>(eighth) / 8.0F);
        if (HasFatalFailure()) return;
    }
}

TEST(StrokeWays, MasksOfAllWidths_MatchTheLiteralForm) {
    // Narrower than any vector to wider than two of the widest.
    for (int width = 1; width <= 140; ++width) {
        SCOPED_TRACE("width " + std::to_string(width));
        Random random(static_cast<uint64_t>(width) + 100);
        expectLiteralForm(randomMask(random, width, random.between(1, 6)), random.real(0.0F, 14.0F));
        if (HasFatalFailure()) return;
    }
}

/// Short strokes of coverage far apart, some of them across the edges of 1024 pixels.
literal::Mask sparseMask(Random& random, int width, int height) {
    literal::Mask mask = filledMask(width, height, 0);
    for (int x = random.between(0, 90); x < width; x += random.between(60, 400)) {
        const int length = random.chance(50) ? 1 : random.between(2, 90);
        for (int i = x; i < std::min(x + length, width); ++i) {
            mask.bytes[static_cast<size_t>(random.between(0, height - 1) * width + i)] =
                random.chance(60) ? 255 : random.byte();
        }
    }
    return mask;
}

TEST(StrokeWays, RowsOfSeveralBlocks_MatchTheLiteralForm) {
    // Flags and tiles are looked through by vectors, of 64 bytes and of 32 numbers at most: these rows
    // have several of each.
    forSeeds(8500, 3, [](Random& random) {
        for (const float size : {3.0F, 5.25F, 8.0F})
            expectLiteralForm(sparseMask(random, 4400, 2), size);
        for (const float size : {9.0F, 23.0F, 30.0F})
            expectLiteralForm(sparseMask(random, 2300, 2), size);
    });
}

TEST(StrokeWays, SolidMasks_MatchTheLiteralForm) {
    // Full vectors below full ones; fractions that end the disc with a row of its rim alone.
    for (const int height : {2, 9, 40}) {
        const literal::Mask solid = filledMask(200, height, 255);
        for (const float size : {3.0F, 3.6F, 8.5F, 10.4F, 15.6F})
            expectLiteralForm(solid, size);
    }
}

TEST(StrokeWays, TallMasks_MatchTheLiteralForm) {
    // More rows than a band has, and than a vector of rows.
    forSeeds(8000, 30, [](Random& random) {
        expectLiteralForm(randomMask(random, random.between(1, 12), random.between(60, 150)),
                          random.real(0.0F, 20.0F));
    });
}

TEST(StrokeWays, FaintMasks_MatchTheLiteralForm) {
    // Nothing is fully covered: the largest coverage takes the place of 255.
    forSeeds(9000, 150, [](Random& random) {
        const auto mask = randomMask(random, random.between(1, 40), random.between(1, 20));
        expectLiteralForm(faint(mask, random.between(0, 254)), random.real(0.0F, 26.0F));
    });
}

TEST(StrokeWays, HairlinesWithoutAFullPixel_MatchTheLiteralForm) {
    forSeeds(10000, 60, [](Random& random) {
        literal::Mask mask = filledMask(random.between(20, 60), random.between(20, 40), 0);
        const int slope = random.between(0, 3);
        for (int i = 0; i < 40; ++i) {
            const int x = slope == 0 ? 7 : i;
            const int y = slope == 0 ? i : 5 + i * (slope - 1) / 2;
            if (x >= mask.width || y >= mask.height) continue;
            mask.bytes[static_cast<size_t>(y * mask.width + x)] = static_cast<uint8_t>(90 + 4 * i);
        }
        expectLiteralForm(mask, random.real(0.0F, 30.0F));
    });
}

TEST(StrokeWays, NoiseWithFewPixelsOfTheLargestCoverage_MatchesTheLiteralForm) {
    forSeeds(11000, 60, [](Random& random) {
        literal::Mask mask = faint(
            noiseMask(random, random.between(20, 70), random.between(10, 20), random.between(0, 99)),
            200);
        for (int i = random.between(0, 3); i > 0; --i)
            mask.bytes[static_cast<size_t>(random.between(0, mask.width * mask.height - 1))] = 255;
        expectLiteralForm(mask, random.real(0.0F, 26.0F));
    });
}

TEST(StrokeWays, HolesThatHardlyClose_MatchTheLiteralForm) {
    for (int hole = 1; hole <= 40; hole += kThinned) {
        SCOPED_TRACE("hole of " + std::to_string(hole));
        literal::Mask mask = filledMask(hole + 12, hole + 12, 255);
        for (int y = 0; y < hole; ++y)
            std::fill_n(mask.bytes.begin() + (y + 6) * mask.width + 6, hole, uint8_t{0});
        for (float size : {0.3F, 0.5F, 0.6F, 0.71F, 0.75F})
            expectLiteralForm(mask, static_cast<float>(hole) * size);
        if (HasFatalFailure()) return;
    }
}

TEST(StrokeWays, NotchBetweenTwoPixels_MatchesTheLiteralForm) {
    // Anywhere in a vector, and nearly as far apart as their discs reach.
    for (int left = 0; left < 16; ++left) {
        for (int apart = 1; apart <= 26; ++apart) {
            SCOPED_TRACE(std::to_string(apart) + " columns from " + std::to_string(left));
            literal::Mask mask = filledMask(left + apart + 1, 1, 0);
            mask.bytes[static_cast<size_t>(left)] = 255;
            mask.bytes.back() = 255;
            for (float size : {4.0F, 9.0F, 12.5F}) {
                ASSERT_TRUE(matchesLiteral(sceneWithRoom(mask, size), size, kWhite, kOutside));
            }
        }
    }
}

TEST(StrokeWays, LargestRadii_MatchTheLiteralForm) {
    // From a reach of 255 on, distances no longer fit in a byte.
    for (float size : {127.9F, 128.0F, 253.5F, 254.0F, 254.4F, 254.5F, 255.0F, 255.5F, 255.9F, 256.0F}) {
        SCOPED_TRACE(size);
        Random random(static_cast<uint64_t>(size * 10.0F));
        literal::Mask mask = filledMask(6, 3, 0);
        mask.bytes[static_cast<size_t>(random.between(0, 17))] = 255;
        mask.bytes[static_cast<size_t>(random.between(0, 17))] = random.byte();
        expectLiteralForm(mask, size);
        if (HasFatalFailure()) return;
    }
}

TEST(StrokeWays, LinesOfText_MatchTheLiteralForm) {
    const literal::Mask& line = glyphLine();
    if (line.width == 0) GTEST_SKIP() << "there is no line of glyphs";
    literal::Mask part = filledMask(150, line.height, 0);
    for (int y = 0; y < line.height; ++y) {
        std::copy_n(line.bytes.begin() + y * line.width, part.width,
                    part.bytes.begin() + y * part.width);
    }
    for (float size : {1.0F, 2.0F, 3.5F, 5.0F, 7.25F, 8.0F, 9.0F, 16.0F, 24.0F, 33.0F})
        expectLiteralForm(part, size);
}

TEST(StrokeWays, DestinationThatShowsAPart_GetsTheSameThere) {
    forOtherDestinations(150, 40, 60, [](Random& random, const Scene& scene) {
        EXPECT_TRUE(matchesLiteral(scene, random.real(0.0F, 40.0F), randomPremultiplied(random),
                                   random.between(0, 2)));
    });
}

TEST(StrokeWays, SecondDestinationLargerThanTheFirst_GetsAllOfTheOutline) {
    for (float size : {1.0F, 5.0F, 12.0F}) {
        Scene scene = sceneWithRoom(discMask(20, 14, 9.0F, 6.0F, 5.0F, true), size);
        scene.sub = filledPicture(scene.dst.width, scene.dst.height, 0);
        scene.dst = filledPicture(11, 9, 0);
        EXPECT_TRUE(matchesLiteral(scene, size, kWhite, kOutside));
    }
}

TEST(StrokeWays, NoByteOutsideTheBitmaps_IsTouched) {
    forSeeds(12000, 300, [](Random& random) {
        const int width = random.chance(5) ? random.between(1000, 4400) : random.between(1, 90);
        const int height = random.between(1, 12);
        const Edge edge = random.chance(50) ? Edge::kStart : Edge::kEnd;
        GuardedBitmap mask(width, height, 1, edge);
        GuardedBitmap dst(width, height, 4, edge);
        const auto pixels = randomMask(random, width, height);
        std::copy(pixels.bytes.begin(), pixels.bytes.end(), mask.pixels().begin());
        const int position = random.between(0, 2);
        const float size = random.real(0.0F, 30.0F);
        VFontEffect::VFRect text(0, 0, width, height);
        VFECore::ParamPostProcessing params{dst.bitmap(), mask.bitmap(), &text, 0, nullptr};
        coreWith(size, kWhite, position)->doPostProcessing(&params);

        literal::Picture expected = filledPicture(width, height, 0);
        literal::paintStroke(expected, nullptr, pixels, wholeBox(pixels), false, size, kWhite, position);
        EXPECT_EQ(expected.bytes, std::vector<uint8_t>(dst.pixels().begin(), dst.pixels().end()));
    });
}

}  // namespace
