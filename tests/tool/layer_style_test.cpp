#include <gtest/gtest.h>

#include <cstdint>
#include <string>

#include "painting.h"

/// What docs/layer-styles.md says of looks that stand for a layer style, on a glyph that is a rectangle.
namespace vorelpaint {
namespace {

using voreltext::Box;
using voreltext::Image;

struct Pixel {
    int red;
    int green;
    int blue;
    int alpha;
};

/// A picture of the rectangle in a style.
class Painted {
  public:
    explicit Painted(const std::string& json)
        : mComposition(composed(optionsOf(json))), mImage(mComposition.paint()) {
        const voreltext::Canvas& canvas = mComposition.canvas();
        const Box& ink = mComposition.text().layout().inkBox();
        mBox = {ink.left + canvas.x, ink.top + canvas.y, ink.right + canvas.x, ink.bottom + canvas.y};
    }

    /// Premultiplied, as painted.
    Pixel at(int x, int y) const {
        const uint8_t* p = &mImage.pixels[(static_cast<size_t>(y) * static_cast<size_t>(mImage.width) +
                                           static_cast<size_t>(x)) *
                                          4];
        return {p[0], p[1], p[2], p[3]};
    }

    /// At parts of the rectangle's width and height.
    Pixel inside(double x, double y) const {
        return at(mBox.left + static_cast<int>(x * mBox.width()),
                  mBox.top + static_cast<int>(y * mBox.height()));
    }

    const Box& box() const { return mBox; }
    int width() const { return mImage.width; }
    int height() const { return mImage.height; }

  private:
    static Options optionsOf(const std::string& json) {
        Options options;
        options.text = "\u2588";
        options.inlineStyle = vorelstyle::parseStyle(json);
        return options;
    }

    Composition mComposition;
    Image mImage;
    Box mBox{0, 0, 0, 0};
};

TEST(LayerStyle, LightAt135_ThrowsTheShadowToTheLowerRight) {
    const Painted picture(
        R"({"outerShadow": {"angle": 135, "distance": 8, "size": 0, "color": "#000"}, "color": "#FFF"})");
    const Box& box = picture.box();
    const int x = (box.left + box.right) / 2;
    const int y = (box.top + box.bottom) / 2;
    EXPECT_EQ(picture.at(box.right + 3, y).alpha, 255);
    EXPECT_EQ(picture.at(x, box.bottom + 3).alpha, 255);
    EXPECT_EQ(picture.at(box.left - 3, y).alpha, 0);
    EXPECT_EQ(picture.at(x, box.top - 3).alpha, 0);
}

TEST(LayerStyle, LightAt135_ShadesTheUpperLeftInside) {
    const Painted picture(
        R"({"innerShadow": {"angle": 135, "distance": 8, "size": 0, "color": "#000"}, "color": "#FFF"})");
    EXPECT_EQ(picture.inside(0.5, 0.02).red, 0);
    EXPECT_EQ(picture.inside(0.04, 0.5).red, 0);
    EXPECT_EQ(picture.inside(0.5, 0.96).red, 255);
    EXPECT_EQ(picture.inside(0.94, 0.5).red, 255);
}

TEST(LayerStyle, GradientAt90_RunsUpwards) {
    const Painted picture(R"({"linearGradient": {"angle": 90, "gradient": [
        {"color": "#000", "location": 0}, {"color": "#FFF", "location": 1}]}})");
    EXPECT_LT(picture.inside(0.5, 0.95).red, 30);
    EXPECT_GT(picture.inside(0.5, 0.05).red, 225);
}

TEST(LayerStyle, AnglesATurnApart_AreTheSame) {
    const auto shadowAt = [](const std::string& angle) {
        return Painted(R"({"outerShadow": {"distance": 9, "size": 3, "color": "#000", "angle": )" +
                       angle + "}}");
    };
    const Painted one = shadowAt("-45");
    const Painted other = shadowAt("315");
    ASSERT_EQ(one.width(), other.width());
    ASSERT_EQ(one.height(), other.height());
    for (int y = 0; y < one.height(); ++y) {
        for (int x = 0; x < one.width(); ++x)
            ASSERT_EQ(one.at(x, y).alpha, other.at(x, y).alpha) << x << ", " << y;
    }
}

TEST(LayerStyle, GradientOfOneStop_IsAColourOverlay) {
    const Painted picture(
        R"({"color": "#000", "linearGradient": {"angle": 0, "opacity": 0.4, "gradient": [
        {"color": "#FFF", "location": 0}]}})");
    for (const double x : {0.1, 0.5, 0.9}) {
        EXPECT_NEAR(picture.inside(x, 0.5).red, 0.4 * 255, 1.5);
        EXPECT_EQ(picture.inside(x, 0.5).alpha, 255);
    }
}

TEST(LayerStyle, MovedGlow_IsOfOneOpacityUpToThreeTenthsOfItsSize) {
    const Painted picture(
        R"({"version": 2, "color": "#000", "textOpacity": 0.5, "offset": {"x": 9, "y": 9},
        "outerGlow": {"size": 20, "color": "#000", "opacity": 0.5}})");
    const int y = (picture.box().top + picture.box().bottom) / 2 + 9;
    const int edge = picture.box().right + 9;
    EXPECT_NEAR(picture.at(edge - 10, y).alpha, 128, 1);
    EXPECT_NEAR(picture.at(edge + 1, y).alpha, 128, 2);
    EXPECT_GT(picture.at(edge + 4, y).alpha, 120);
    EXPECT_LT(picture.at(edge + 14, y).alpha, 64);
}

TEST(LayerStyle, MovedStroke_IsOfOneOpacityUpToItsEnd) {
    const Painted picture(
        R"({"version": 2, "color": "#000", "textOpacity": 0.5, "offset": {"x": 9, "y": 9},
        "stroke": {"size": 12, "color": "#000", "opacity": 0.5, "position": "outside"}})");
    const int y = (picture.box().top + picture.box().bottom) / 2 + 9;
    for (int x = picture.box().right - 10; x < picture.box().right + 9 + 11; ++x)
        EXPECT_NEAR(picture.at(x, y).alpha, 128, 1) << x;
    EXPECT_EQ(picture.at(picture.box().right + 9 + 13, y).alpha, 0);
}

TEST(LayerStyle, FillOpacity_LeavesAnOverlayAsItIs) {
    const Painted picture(
        R"({"color": "#000", "textOpacity": 0.5, "linearGradient": {"angle": 0, "gradient": [
        {"color": "#FFF", "location": 0}]}})");
    EXPECT_EQ(picture.inside(0.5, 0.5).alpha, 255);
    EXPECT_EQ(picture.inside(0.5, 0.5).red, 255);
}

TEST(LayerStyle, TextOpacity_KnocksOutWhatLiesBeneathAndTheOpacityOfTextDoesNot) {
    const std::string shadow =
        R"("outerShadow": {"angle": 135, "distance": 4, "size": 0, "color": "#000"})";
    EXPECT_NEAR(
        Painted(R"({"color": "#FFF", "textOpacity": 0.5, )" + shadow + "}").inside(0.5, 0.5).alpha, 128,
        1);
    EXPECT_EQ(
        Painted(R"({"text": {"color": "#FFF", "opacity": 0.5}, )" + shadow + "}").inside(0.5, 0.5).alpha,
        255);
}

TEST(LayerStyle, StackWithoutAnyFill_LetsThePageBeSeen) {
    const std::string looks = R"({"version": 2, "looks": [
        {"fill": false, "stroke": {"size": 12, "color": "#F00", "position": "outside"}},
        {"fill": false, "outerShadow": {"angle": 90, "distance": 5, "size": 3, "color": "#000"}}]})";
    EXPECT_EQ(Painted(looks).inside(0.5, 0.5).alpha, 0);
}

TEST(LayerStyle, LookOfAnInnerShadow_LeavesTheMiddleOfLowerLooksAsItIs) {
    const Painted picture(R"({"version": 2, "looks": [{"color": "#F80"},
        {"fill": false, "innerShadow": {"angle": 120, "distance": 3, "size": 4, "color": "#FFF"}}]})");
    const Pixel middle = picture.inside(0.5, 0.5);
    EXPECT_EQ(middle.red, 0xFF);
    EXPECT_EQ(middle.green, 0x88);
    EXPECT_EQ(middle.blue, 0);
    EXPECT_EQ(middle.alpha, 255);
    EXPECT_GT(picture.inside(0.5, 0.01).blue, 200) << "lit from above";
    EXPECT_EQ(picture.inside(0.5, 0.97).blue, 0);
}

}  // namespace
}  // namespace vorelpaint
