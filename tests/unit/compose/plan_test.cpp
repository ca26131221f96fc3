#include "compose/plan.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace vorelcompose {
namespace {

using vorelstyle::Look;
using vorelstyle::parseStyle;
using vorelstyle::Stack;

LookPlan planned(const char* json, float opacity = 1) {
    return planOf(Look(parseStyle(json).looks.front(), 0, opacity));
}

std::vector<std::string> orderOf(const LookPlan& plan) {
    std::vector<std::string> order;
    for (const PlannedEffect& effect : plan.effects) {
        order.push_back(std::string(vorelstyle::effectName(effect.type)) + ": " +
                        std::string(placeName(effect.place)));
    }
    return order;
}

bool contains(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

constexpr const char* kThree =
    R"({"outerShadow": {"angle": 0, "distance": 1, "size": 1, "color": "#000000"},
        "innerShadow": {"angle": 0, "distance": 1, "size": 1, "color": "#000000"},
        "stroke": {"size": 1, "color": "#000000", "position": "outside"}})";
constexpr const char* kCentred =
    R"({"outerGlow": {"size": 2, "color": "#000"},
        "stroke": {"size": 1, "color": "#000000", "position": "center"},
        "innerGlow": {"size": 2, "color": "#000"}})";

TEST(Plan, WhatLiesBeneath_IsPaintedBehindTheText) {
    const LookPlan plan = planned(kThree);
    EXPECT_FALSE(plan.layered);
    EXPECT_EQ(orderOf(plan),
              (std::vector<std::string>{"innerShadow: on the text", "text: the text",
                                        "stroke: beneath the text", "outerShadow: beneath the text"}));
}

TEST(Plan, TranslucentText_HasALayerForWhatIsOutside) {
    const LookPlan plan = planned(kThree, 0.99F);
    EXPECT_TRUE(plan.layered);
    EXPECT_EQ(plan.reason, "the text is translucent");
    EXPECT_EQ(orderOf(plan),
              (std::vector<std::string>{"stroke: outside the text", "innerShadow: on the text",
                                        "outerShadow: outside the text", "text: the text"}));
}

TEST(Plan, CentredStroke_LiesAcrossTheEdge) {
    const LookPlan plan = planned(kCentred);
    EXPECT_TRUE(plan.layered);
    EXPECT_EQ(plan.reason, "a stroke is centred on the edge");
    EXPECT_EQ(orderOf(plan),
              (std::vector<std::string>{"innerGlow: on the text", "stroke: across the edge",
                                        "outerGlow: outside the text", "text: the text"}));
}

TEST(Plan, OpaqueText_SaysWhyItHasOneLayer) {
    const LookPlan plan = planned("{}");
    EXPECT_FALSE(plan.layered);
    EXPECT_EQ(plan.reason, "the text is opaque, and no stroke is centred");
    ASSERT_EQ(plan.effects.size(), 1U);
    EXPECT_EQ(plan.effects.front().type, vorelstyle::kTextType);
}

TEST(Plan, EachReason_IsOneSentence) {
    for (const char* json : {"{}", kThree, kCentred}) {
        for (const float opacity : {1.0F, 0.5F}) {
            for (const PlannedEffect& effect : planned(json, opacity).effects) {
                EXPECT_EQ(effect.reason.find('.'), effect.reason.size() - 1) << effect.reason;
            }
        }
    }
}

TEST(Plan, ReasonOfAGroup_NamesItsNeighbourThere) {
    const std::vector<PlannedEffect> effects = planned(kThree).effects;
    EXPECT_TRUE(contains(effects[2].reason, "it was added after the outer shadow and so lies over it"));
    EXPECT_TRUE(contains(effects[3].reason, "the stroke was added after it and so lies over it"));
    EXPECT_FALSE(contains(effects[0].reason, "added after")) << "it is alone on the text";
}

TEST(Plan, CentredStroke_IsTheNeighbourOnBothSides) {
    const std::vector<PlannedEffect> effects = planned(kCentred).effects;
    EXPECT_TRUE(contains(effects[0].reason, "it was added after the stroke and so lies over it"));
    EXPECT_TRUE(contains(effects[2].reason, "the stroke was added after it and so lies over it"));
}

TEST(Plan, StackedLook_TellsWhatItsPlaceDoes) {
    const Stack stack(parseStyle(R"({"version": 2, "looks": [
        {"offset": {"x": 3, "y": -2}}, {"span": "word"}]})"));
    const std::vector<StackedPlan> plans = plansOf(stack);
    ASSERT_EQ(plans.size(), 2U);
    EXPECT_EQ(plans[0].place, "moved by 3, -2");
    EXPECT_EQ(plans[0].reason,
              "The text is painted as one block; the look is moved by 3, -2 pixels as a whole.");
    EXPECT_EQ(plans[1].place, "not moved, by word");
    EXPECT_EQ(plans[1].reason,
              "Each word is painted alone, with a box of its own for gradients and patterns, later ones "
              "over earlier ones; all of it lies over the looks before it, none of its effects between "
              "theirs.");
}

}  // namespace
}  // namespace vorelcompose
