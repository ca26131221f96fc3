#include "core/portable_math.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace VFontEffect::internal {
namespace {

/// The float nearest to a value known to more than double precision.
float nearest(long double value) {
    return static_cast<float>(value);
}

/// Every angle that a whole number of degrees becomes in the shadows and in the linear gradient.
template <class Visit>
void forEachAngle(Visit visit) {
    for (int degrees = -720; degrees <= 720; ++degrees) {
        visit(static_cast<float>(degrees) * 3.14159F / 180.0F);
        visit(static_cast<float>(degrees) * -0.01745328F);
    }
}

TEST(PortableMath, WholeDegrees_GiveTheNearestFloat) {
    forEachAngle([](float angle) {
        EXPECT_EQ(portableTurn(angle).sine, nearest(std::sin(static_cast<long double>(angle)))) << angle;
        EXPECT_EQ(portableTurn(angle).cosine, nearest(std::cos(static_cast<long double>(angle))))
            << angle;
        EXPECT_EQ(portableTurn(angle).tangent, nearest(std::tan(static_cast<long double>(angle))))
            << angle;
    });
}

TEST(PortableMath, WholeDegrees_StayWithinAUnitOfTheCLibrary) {
    forEachAngle([](float angle) {
        EXPECT_FLOAT_EQ(portableTurn(angle).sine, std::sin(angle));
        EXPECT_FLOAT_EQ(portableTurn(angle).cosine, std::cos(angle));
        EXPECT_FLOAT_EQ(portableTurn(angle).tangent, std::tan(angle));
    });
}

TEST(PortableMath, OtherAngles_GiveTheNearestFloat) {
    for (float angle = -1000.0F; angle < 1000.0F; angle += 0.37F) {
        EXPECT_EQ(portableTurn(angle).sine, nearest(std::sin(static_cast<long double>(angle)))) << angle;
        EXPECT_EQ(portableTurn(angle).cosine, nearest(std::cos(static_cast<long double>(angle))))
            << angle;
    }
}

TEST(PortableMath, AnglesBeyondTheReduction_AreTheCLibrarys) {
    for (const float angle : {100001.0F, -3e7F, 1e30F}) {
        EXPECT_EQ(portableTurn(angle).sine, std::sin(angle));
        EXPECT_EQ(portableTurn(angle).cosine, std::cos(angle));
        EXPECT_EQ(portableTurn(angle).tangent, std::tan(angle));
    }
    EXPECT_TRUE(std::isnan(portableTurn(std::numeric_limits<float>::infinity()).cosine));
    EXPECT_TRUE(std::isnan(portableTurn(std::numeric_limits<float>::quiet_NaN()).sine));
}

TEST(PortableMath, Exponential_GivesTheNearestFloat) {
    EXPECT_EQ(portableExp(0.0F), 1.0F);
    for (int i = 0; i <= 100000; ++i) {
        const float x = static_cast<float>(i) * -0.0008F;
        EXPECT_EQ(portableExp(x), nearest(std::exp(static_cast<long double>(x)))) << x;
    }
}

TEST(PortableMath, ExponentialBelowItsRange_IsZero) {
    EXPECT_EQ(portableExp(-80.5F), 0.0F);
    EXPECT_EQ(portableExp(-std::numeric_limits<float>::infinity()), 0.0F);
    EXPECT_EQ(portableExp(std::numeric_limits<float>::quiet_NaN()), 0.0F);
}

}  // namespace
}  // namespace VFontEffect::internal
