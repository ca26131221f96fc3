#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <memory>
#include <utility>
#include <vector>

#include "../support/core_compare.h"
#include "../support/literal_cores.h"
#include "../support/mask_gallery.h"

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

}  // namespace
