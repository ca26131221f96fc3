#include "effect/placement.h"

#include <gtest/gtest.h>

#include <climits>

#include "tests/support/fake_core.h"

/// The table of placements, each row worked out by hand from what the effects are.
namespace vorel_test {
namespace {

using namespace VFontEffect;
using namespace VFontEffect::internal;

enum Under { kAlways, kInPlainRuns, kNever };
enum Needs { kAnyRun, kLayeredRun };
enum Target { kDestination, kOuterLayer, kBoth };

/// Expects the placement of a core of that type and record.
void expectPlacement(int type, VFProperty* record, Under under, Needs needs, Target target) {
    FakeCore core(type, record);
    const Placement& placement = placementOf(core);
    EXPECT_EQ(placement.underText, under != kNever) << type;
    EXPECT_EQ(placement.underTextLayered, under == kAlways) << type;
    EXPECT_EQ(placement.needsOuterLayer, needs == kLayeredRun) << type;
    EXPECT_EQ(placement.inOuterLayer, target != kDestination) << type;
    EXPECT_EQ(placement.inDestination, target != kOuterLayer) << type;
}

void expectStroke(int position, Under under, Needs needs, Target target) {
    VFStrokeProperty record(4.0F, 0, 1.0F, 0, position);
    for (const int type : {kStroke, kReservedStroke})
        expectPlacement(type, &record, under, needs, target);
}

void expectBevel(int style, Under under, Target target) {
    VFBevelProperty record(style, 0, 0, 0, 0, 0, 1, 0, 0, 0, 1, 0, 1);
    expectPlacement(kBevel, &record, under, kAnyRun, target);
}

TEST(Placement, ShadowAndGlowOutsideAndTheBaseDefault_LieBeneath) {
    expectPlacement(kOuterShadow, nullptr, kAlways, kAnyRun, kOuterLayer);
    expectPlacement(kOuterGlow, nullptr, kAlways, kAnyRun, kOuterLayer);
    expectPlacement(kNoEffect, nullptr, kAlways, kAnyRun, kOuterLayer);
}

TEST(Placement, EffectsInsideTheGlyphAndItsFill_LieWithin) {
    for (const int type :
         {kInnerShadow, kInnerGlow, kLinearGradient, kRadialGradient, kPattern, kText}) {
        expectPlacement(type, nullptr, kNever, kAnyRun, kDestination);
    }
}

TEST(Placement, UnknownTypes_LieWithin) {
    for (const int type : {0, 14, -1, INT_MIN, INT_MAX})
        expectPlacement(type, nullptr, kNever, kAnyRun, kDestination);
}

TEST(Placement, Emboss_LiesAstrideTheEdge) {
    expectPlacement(kEmboss, nullptr, kInPlainRuns, kLayeredRun, kBoth);
}

TEST(Placement, Bevel_LiesWithinWithStyleOneOnly) {
    expectBevel(1, kNever, kDestination);
    for (const int style : {0, 2, 3, -1, INT_MIN, INT_MAX})
        expectBevel(style, kAlways, kOuterLayer);
}

TEST(Placement, Stroke_FollowsItsPosition) {
    expectStroke(0, kInPlainRuns, kLayeredRun, kBoth);
    expectStroke(1, kAlways, kAnyRun, kOuterLayer);
    expectStroke(2, kNever, kAnyRun, kDestination);
}

TEST(Placement, StrokeAtAnUnknownPosition_IsNotUnderTheTextButInTheOuterLayer) {
    for (const int position : {3, -1, INT_MIN, INT_MAX})
        expectStroke(position, kNever, kAnyRun, kOuterLayer);
}

TEST(Placement, WithoutARecord_BevelLiesBeneathAndAStrokeIsAtAnUnknownPosition) {
    expectPlacement(kBevel, nullptr, kAlways, kAnyRun, kOuterLayer);
    expectPlacement(kStroke, nullptr, kNever, kAnyRun, kOuterLayer);
    expectPlacement(kReservedStroke, nullptr, kNever, kAnyRun, kOuterLayer);
}

}  // namespace
}  // namespace vorel_test
