#include "cores/stroke_shape.h"

#include <gtest/gtest.h>

#include <climits>

namespace vorel_test {
namespace {

using VFontEffect::VFStrokeProperty;
using VFontEffect::internal::StrokeShape;
using VFontEffect::internal::StrokeSide;

void expectShape(float size, int position, StrokeSide side, float radiusPx, bool growsGlyph, int reach) {
    const StrokeShape shape(VFStrokeProperty(size, 0, 1.0F, 0, position));
    EXPECT_EQ(side, shape.side) << position;
    EXPECT_EQ(radiusPx, shape.radiusPx) << position;
    EXPECT_EQ(growsGlyph, shape.growsGlyph) << position;
    EXPECT_EQ(reach, shape.reach) << position;
}

TEST(StrokeShape, OfSizeSeven_FollowsThePosition) {
    expectShape(7.0F, 0, StrokeSide::centre, 3.5F, true, 4);
    expectShape(7.0F, 1, StrokeSide::outside, 7.0F, true, 7);
    expectShape(7.0F, 2, StrokeSide::inside, 7.0F, false, 0);
}

TEST(StrokeShape, OfAnUnknownPosition_IsShapedLikeOneInside) {
    for (const int position : {3, -1, INT_MIN, INT_MAX})
        expectShape(7.0F, position, StrokeSide::unknown, 7.0F, false, 0);
}

TEST(StrokeShape, Reach_RoundsHalvesUp) {
    expectShape(1.4F, 1, StrokeSide::outside, 1.4F, true, 1);
    expectShape(1.5F, 1, StrokeSide::outside, 1.5F, true, 2);
    expectShape(1.0F, 0, StrokeSide::centre, 0.5F, true, 1);
    expectShape(0.0F, 1, StrokeSide::outside, 0.0F, true, 0);
}

}  // namespace
}  // namespace vorel_test
