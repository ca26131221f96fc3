#include <gtest/gtest.h>

#include <algorithm>
#include <cstdlib>
#include <functional>
#include <string>
#include <vector>

#include "tests/support/both_sets.h"
#include "tests/support/compare.h"
#include "tests/support/literal_engine.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/picture_file.h"
#include "voreleffect/voreleffect.h"

/// A small picture per effect and placement, exact. The pictures are painted by the literal engine:
/// `VOREL_UPDATE_GOLDENS=1 voreleffect_tests --gtest_filter='*Golden*'` writes them anew.
namespace vorel_test {
namespace {

using literal::Engine;
using literal::Picture;
using VFontEffect::VFEffect;

constexpr int kWidth = 56;
constexpr int kHeight = 44;

/// A ring with a bar through it, soft at the edges: curves, straight edges, a hole.
const literal::Mask& ring() {
    static const literal::Mask mask = [] {
        literal::Mask outer = discMask(28, 24, 14.0F, 12.0F, 10.5F, true);
        const literal::Mask hole = discMask(28, 24, 14.0F, 12.0F, 5.0F, true);
        for (size_t i = 0; i < outer.bytes.size(); ++i) {
            outer.bytes[i] =
                std::min<uint8_t>(outer.bytes[i], static_cast<uint8_t>(255 - hole.bytes[i]));
        }
        for (size_t x = 2; x < 26; ++x)
            outer.bytes[12 * 28 + x] = 255;
        return outer;
    }();
    return mask;
}

template <class Set>
using Apply = std::function<void(Set&, Kit<Set>&)>;

struct Scene {
    const char* name;
    Apply<VFEffect> library;
    Apply<Engine> literal;
    float textOpacity = 1.0F;
};

/// One description for both sets.
template <class Describe>
Scene scene(const char* name, Describe describe, float textOpacity = 1.0F) {
    return {name, describe, describe, textOpacity};
}

const std::vector<Scene>& scenes() {
    static const std::vector<Scene> all = {
        scene("text", [](auto&, auto&) {}),
        scene(
            "text_translucent", [](auto&, auto&) {}, 0.5F),
        scene("stroke_outside", [](auto& s, auto&) { s.addStrokeText(3, 0xE03020, 1, 0, 1); }),
        scene("stroke_inside", [](auto& s, auto&) { s.addStrokeText(2, 0xE03020, 0.8F, 0, 2); }),
        scene("stroke_centre", [](auto& s, auto&) { s.addStrokeText(4, 0xE03020, 0.8F, 0, 0); }),
        scene("outer_shadow", [](auto& s, auto&) { s.addOuterShadowText(135, 5, 4, 0x202020, 0.7F); }),
        scene(
            "outer_shadow_translucent_text",
            [](auto& s, auto&) { s.addOuterShadowText(135, 5, 0, 0x202020, 0.9F); }, 0.4F),
        scene("inner_shadow", [](auto& s, auto&) { s.addInnerShadowText(135, 3, 2, 0x000000, 0.9F); }),
        scene("outer_glow", [](auto& s, auto&) { s.addOuterGlowText(5, 0xFFC000, 1, 0, nullptr); }),
        scene("outer_glow_stops",
              [](auto& s, auto& kit) { s.addOuterGlowText(6, 0, 0.9F, 3, kit.stops); }),
        scene("inner_glow", [](auto& s, auto&) { s.addInnerGlowText(2, 0xFFFFFF, 0.9F, 0, nullptr); }),
        scene("linear_gradient",
              [](auto& s, auto& kit) { s.addLinearGradientText(0, 1, 1, 3, kit.stops); }),
        scene("linear_gradient_steep",
              [](auto& s, auto& kit) { s.addLinearGradientText(60, 0.6F, 1, 3, kit.stops); }),
        scene("radial_gradient",
              [](auto& s, auto& kit) { s.addRadialGradientText(1, 1, 3, kit.stops); }),
        scene("pattern", [](auto& s, auto& kit) { s.addPatternText(&kit.tile, 1.5F, 0.9F); }),
        scene("everything",
              [](auto& s, auto& kit) {
                  s.addOuterShadowText(120, 6, 3, 0x000000, 0.6F);
                  s.addOuterGlowText(3, 0x00C0FF, 0.8F, 0, nullptr);
                  s.addStrokeText(2, 0xFFFFFF, 1, 0, 1);
                  s.addLinearGradientText(90, 1, 0.7F, 3, kit.stops);
                  s.addInnerGlowText(1, 0xFFFFFF, 0.5F, 0, nullptr);
                  s.addInnerShadowText(300, 2, 1, 0x400000, 0.8F);
              }),
    };
    return all;
}

constexpr Stage kStage = {kWidth, kHeight, 14, 10};

template <class Set, class Apply>
Picture painted(const Scene& scene, const Apply& apply) {
    Kit<Set> kit;
    Set set;
    set.setTextOpacity(scene.textOpacity);
    apply(set, kit);
    return paintedRun(set, ring(), kStage);
}

Picture paintedByLibrary(const Scene& scene) {
    return painted<VFEffect>(scene, scene.library);
}
Picture paintedLiterally(const Scene& scene) {
    return painted<Engine>(scene, scene.literal);
}

class Golden : public ::testing::TestWithParam<size_t> {};

TEST_P(Golden, LibraryPaintsTheCommittedPicture) {
    const Scene& scene = scenes()[GetParam()];
    const std::string path = std::string(VOREL_GOLDENS) + "/" + scene.name + ".png";
    if (std::getenv("VOREL_UPDATE_GOLDENS") != nullptr) {
        ASSERT_TRUE(writePng(path, paintedLiterally(scene)));
    }
    const Picture expected = readPng(path);
    ASSERT_EQ(expected.width, kWidth) << "no golden " << path;
    ASSERT_EQ(expected.height, kHeight);

    const Picture actual = paintedByLibrary(scene);
    const auto same = sameBytes(expected.bytes.data(), actual.bytes.data(), kWidth, kHeight, 4);
    if (!same) {
        const std::string report = std::string(scene.name) + ".failure.png";
        writePng(report, sideBySide(expected, actual));
        ADD_FAILURE() << same.message() << "\nexpected | difference | actual: " << report
                      << "\nafter a wanted change: VOREL_UPDATE_GOLDENS=1 voreleffect_tests "
                         "--gtest_filter='*Golden*'";
    }
}

TEST_P(Golden, LiteralFormPaintsTheCommittedPicture) {
    const Scene& scene = scenes()[GetParam()];
    const Picture expected = readPng(std::string(VOREL_GOLDENS) + "/" + scene.name + ".png");
    ASSERT_EQ(expected.bytes.size(), size_t{4} * kWidth * kHeight);
    const Picture actual = paintedLiterally(scene);
    EXPECT_TRUE(sameBytes(expected.bytes.data(), actual.bytes.data(), kWidth, kHeight, 4));
}

INSTANTIATE_TEST_SUITE_P(Scenes, Golden, ::testing::Range<size_t>(0, scenes().size()),
                         [](const auto& picked) { return std::string(scenes()[picked.param].name); });

}  // namespace
}  // namespace vorel_test
