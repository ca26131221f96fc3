#include "text_face.h"

#include <gtest/gtest.h>

#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

#include "byte_fonts.h"
#include "compose/vorelcompose.h"

namespace {

const std::vector<uint8_t>& fontBytes() {
    static const std::vector<uint8_t> bytes = [] {
        std::ifstream file(VOREL_TEST_FONT, std::ios::binary);
        return std::vector<uint8_t>(std::istreambuf_iterator<char>(file), {});
    }();
    return bytes;
}

struct Free {
    void operator()(vorel_fonts* fonts) const { vorel_fonts_free(fonts); }
    void operator()(vorel_style* style) const { vorel_style_free(style); }
    void operator()(vorel_steps* steps) const { vorel_steps_free(steps); }
    void operator()(vorel_answer* answer) const { vorel_answer_free(answer); }
};
template <typename Thing>
using Held = std::unique_ptr<Thing, Free>;

/// What `call` makes; null, and a test that fails, when it does not.
template <typename Thing, typename Call>
Held<Thing> made(const Call& call) {
    Thing* thing = nullptr;
    EXPECT_EQ(call(&thing), VOREL_OK) << vorel_text_error();
    return Held<Thing>(thing);
}

std::string textOf(const Held<vorel_answer>& answer) {
    return {vorel_answer_text(answer.get()), vorel_answer_length(answer.get())};
}

std::vector<uint8_t> bytesOf(const Held<vorel_answer>& answer) {
    const uint8_t* const data = vorel_answer_data(answer.get());
    return {data, data + vorel_answer_size(answer.get())};
}

constexpr const char* kStyle = R"({"version": 2, "description": "Two", "looks": [
    {"color": "#102030", "offset": {"x": 3, "y": 0}}, {"color": "#E0A020", "stroke":
    {"size": "5%", "color": "#FFFFFF", "position": "outside"}}]})";

class TextFace : public ::testing::Test {
  protected:
    TextFace() : fonts(made<vorel_fonts>(vorel_fonts_new)) { add("mine"); }

    void add(const char* name) {
        const std::vector<uint8_t> bytes = fontBytes();  // gone when it has been added
        made<vorel_answer>([&](vorel_answer** answer) {
            return vorel_fonts_add(fonts.get(), name, bytes.data(), bytes.size(), 0, answer);
        });
    }
    static Held<vorel_style> styleOf(const std::string& json) {
        return made<vorel_style>([&](vorel_style** style) {
            return vorel_style_new(json.data(), json.size(), "", nullptr, 0, style);
        });
    }
    vorel_status paint(const std::string& asked, const vorel_style* style = nullptr) {
        vorel_answer* answer = nullptr;
        const vorel_status status =
            vorel_text_picture(fonts.get(), asked.data(), asked.size(), style, &answer);
        vorel_answer_free(answer);
        return status;
    }
    Held<vorel_steps> stepsOf(const std::string& asked, const vorel_style* style) {
        return made<vorel_steps>([&](vorel_steps** steps) {
            return vorel_steps_new(fonts.get(), asked.data(), asked.size(), style, steps);
        });
    }

    Held<vorel_fonts> fonts;
    const std::string request =
        R"({"text": "Fi g", "fonts": ["mine"], "size": 40, "premultiplied": true})";
};

/// The same picture from compose.
voreltext::Image composed() {
    vorelscript::ByteFonts fonts;
    fonts.add("mine", fontBytes(), 0);
    vorelcompose::Workbench bench(fonts);
    vorelcompose::Request request;
    request.fonts = {"mine"};
    request.size = 40;
    const auto find = [] {
        return vorelcompose::FoundStyle{
            std::make_shared<vorelstyle::Style>(vorelstyle::parseStyle(kStyle)), {}};
    };
    return vorelcompose::Composition(request, vorelcompose::SourceText("Fi g", false), find, bench)
        .paint();
}

TEST_F(TextFace, PaintsWhatComposePaints) {
    const auto style = styleOf(kStyle);
    const auto answer = made<vorel_answer>([&](vorel_answer** out) {
        return vorel_text_picture(fonts.get(), request.data(), request.size(), style.get(), out);
    });
    const voreltext::Image wanted = composed();
    EXPECT_EQ(bytesOf(answer), wanted.pixels);
    EXPECT_EQ(textOf(answer).find("{\"width\":" + std::to_string(wanted.width) + ",\"height\":" +
                                  std::to_string(wanted.height) + ",\"premultiplied\":true,"),
              0U);
}

TEST_F(TextFace, PaintsTheSameStepByStepWhenItsFontsAndStyleAreGone) {
    auto style = styleOf(kStyle);
    const auto steps = stepsOf(request, style.get());
    style.reset();
    vorel_fonts_remove(fonts.get(), "mine");
    vorel_step step{};
    int count = 0;
    while (vorel_steps_prepare(steps.get(), &step) == VOREL_OK && step.look >= 0) {
        ASSERT_EQ(vorel_steps_paint(steps.get()), VOREL_OK);
        ++count;
    }
    EXPECT_EQ(count, 7);  // the glyphs and the merge of each look, and its fill; and the stroke
    EXPECT_EQ(vorel_steps_paint(steps.get()), VOREL_BAD_ARGUMENT);
    vorel_answer* answer = nullptr;
    EXPECT_EQ(vorel_steps_picture(steps.get(), VOREL_STEP_EFFECT, 1, 2, &answer), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_steps_picture(steps.get(), VOREL_STEP_EFFECT, 1, 1, &answer), VOREL_OK);
    vorel_answer_free(answer);
}

TEST_F(TextFace, LooksOfAStyleMakeTheSameStyle) {
    const std::string json =
        R"({"color": "#E0A020", "stroke": {"size": 2, "color": "#FFFFFF", "position":
        "outside"}, "outerGlow": {"size": 4, "color": "#00F0F0"}, "pattern": {"image": "a", "scale": 2}})";
    const std::vector<uint8_t> dots{255, 0, 0, 255, 0, 0, 255, 128};
    const vorel_named_pixels image{"a", {dots.data(), 2, 1, 0}};
    const auto style = made<vorel_style>([&](vorel_style** out) {
        return vorel_style_new(json.data(), json.size(), "", &image, 1, out);
    });
    const auto looks = made<vorel_answer>(
        [&](vorel_answer** answer) { return vorel_style_looks(style.get(), 40, 1, answer); });
    EXPECT_EQ(bytesOf(looks), dots);
    std::string states = textOf(looks);
    const std::string pixels = R"("width":2,"height":1,"at":0)";
    ASSERT_NE(states.find(pixels), std::string::npos) << states;
    states.replace(states.find(pixels), pixels.size(), R"("image":"a")");
    const auto again = made<vorel_style>([&](vorel_style** out) {
        return vorel_style_of_looks(states.data(), states.size(), &image, 1, out);
    });
    const auto factsOf = [](const Held<vorel_style>& of) {
        return textOf(made<vorel_answer>(
            [&](vorel_answer** answer) { return vorel_style_facts(of.get(), 40, 1, answer); }));
    };
    EXPECT_EQ(factsOf(again), factsOf(style));
}

TEST_F(TextFace, TellsWhyACallFailed) {
    EXPECT_EQ(paint("{"), VOREL_REQUEST_ERROR);
    EXPECT_NE(std::string(vorel_text_error()), "");
    EXPECT_EQ(paint(request), VOREL_OK);
    EXPECT_STREQ(vorel_text_error(), "");
    EXPECT_EQ(paint(R"({"text": "a", "fonts": ["none"]})"), VOREL_FONT_ERROR);
    EXPECT_STREQ(vorel_text_error(), "there is no font 'none'");
    EXPECT_EQ(paint(R"({"text": " ", "fonts": ["mine"]})"), VOREL_TEXT_ERROR);
    EXPECT_EQ(paint(R"({"text": "<c>", "markup": true, "fonts": ["mine"]})"), VOREL_STYLE_ERROR);
    vorel_style* style = nullptr;
    EXPECT_EQ(vorel_style_new("{}", 2, nullptr, nullptr, 0, &style), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_style_new("[]", 2, "", nullptr, 0, &style), VOREL_STYLE_ERROR);
    EXPECT_EQ(style, nullptr);
}

TEST_F(TextFace, RefusesAFontWhoseNameIsTakenOrThatIsNone) {
    vorel_answer* answer = nullptr;
    const std::vector<uint8_t>& bytes = fontBytes();
    const auto adding = [&](const char* name, size_t size) {
        return vorel_fonts_add(fonts.get(), name, bytes.data(), size, 0, &answer);
    };
    EXPECT_EQ(adding("mine", bytes.size()), VOREL_FONT_ERROR);
    EXPECT_EQ(adding("cut", 100), VOREL_FONT_ERROR);
    vorel_fonts_remove(fonts.get(), "mine");
    EXPECT_EQ(adding("mine", bytes.size()), VOREL_OK);
    EXPECT_EQ(textOf(Held<vorel_answer>(answer)),
              R"({"name":"DejaVu Sans Book","family":"DejaVu Sans"})");
}

TEST_F(TextFace, RefusesNull) {
    vorel_answer* answer = nullptr;
    EXPECT_EQ(vorel_fonts_new(nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_text_picture(nullptr, "{}", 2, nullptr, &answer), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_text_picture(fonts.get(), "{}", 2, nullptr, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_text_layout(fonts.get(), nullptr, 0, &answer), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_style_plan(nullptr, 40, 1, &answer), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_answer_size(nullptr), 0U);
    vorel_fonts_free(nullptr);
    vorel_style_free(nullptr);
    vorel_steps_free(nullptr);
    vorel_answer_free(nullptr);
}

}  // namespace
