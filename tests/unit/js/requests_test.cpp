#include "requests.h"

#include <gtest/gtest.h>

namespace vorelscript {
namespace {

TEST(TextRequest, TakesWhatIsUsualWhereNothingIsAsked) {
    const TextRequest asked = textRequest(R"({"text": "a", "fonts": ["x"]})");
    const vorelcompose::Request usual;
    EXPECT_EQ(asked.text, "a");
    EXPECT_EQ(asked.request.fonts, std::vector<std::string>{"x"});
    EXPECT_EQ(asked.request.size, usual.size);
    EXPECT_EQ(asked.request.lineHeight, 1);
    EXPECT_EQ(asked.request.effectScale, 1);
    EXPECT_EQ(asked.request.letterSpacing.value, 0);
    EXPECT_EQ(asked.request.canvas.padding, usual.canvas.padding);
    EXPECT_EQ(asked.request.canvas.anchor, voreltext::Anchor::center);
    EXPECT_FALSE(asked.request.canvas.width || asked.request.color || asked.request.opacity);
    EXPECT_FALSE(asked.hasMarkup || asked.isPremultiplied || asked.request.strict);
    EXPECT_EQ(asked.background.kind, vorelcompose::Background::Kind::transparent);
}

TEST(TextRequest, ReadsEachKey) {
    const TextRequest asked = textRequest(
        R"({"text": "a", "fonts": ["x", "y"], "markup": true, "size": 20, "align": "end", "lineHeight": 1.5,
            "letterSpacing": "5%", "features": ["liga=0"], "variations": [{"axis": "wght", "value": 650.5}],
            "color": "#123456", "opacity": 0.5, "effectScale": 0.05, "width": 300, "height": 200,
            "anchor": "bottom-right", "margin": 3, "fit": "wrap", "box": "line", "padding": 0,
            "background": "#F80", "strict": true})");
    const vorelcompose::Request& request = asked.request;
    EXPECT_EQ(request.fonts.size(), 2U);
    EXPECT_EQ(request.size, 20);
    EXPECT_EQ(request.align, voreltext::Align::end);
    EXPECT_EQ(request.lineHeight, 1.5F);
    EXPECT_TRUE((request.letterSpacing == vorelstyle::Length{5, vorelstyle::Length::Unit::percent}));
    EXPECT_EQ(request.features, std::vector<std::string>{"liga=0"});
    ASSERT_EQ(request.variations.size(), 1U);
    EXPECT_EQ(request.variations[0].axis, "wght");
    EXPECT_EQ(request.variations[0].value, 650.5F);
    EXPECT_EQ(request.color, 0x123456U);
    EXPECT_EQ(request.opacity, 0.5F);
    EXPECT_EQ(request.effectScale, 0.05F);
    EXPECT_EQ(request.canvas.width, 300);
    EXPECT_EQ(request.canvas.height, 200);
    EXPECT_EQ(request.canvas.anchor, voreltext::Anchor::bottomRight);
    EXPECT_EQ(request.canvas.margin, 3);
    EXPECT_EQ(request.canvas.padding, 0);
    EXPECT_EQ(request.fit, vorelcompose::Fit::wrap);
    EXPECT_EQ(request.box, vorelcompose::TextBox::line);
    EXPECT_TRUE(asked.hasMarkup && request.strict);
    EXPECT_EQ(asked.background.colour, 0xFF8800U);
}

std::string faultOf(const std::string& members) {
    try {
        textRequest(R"({"text": "a", "fonts": ["x"])" + members + "}");
    } catch (const RequestError& error) {
        return error.what();
    }
    return "";
}

TEST(TextRequest, RefusesWhatIsOutOfItsRange) {
    EXPECT_EQ(faultOf(R"(, "size": 0)"), "size: 0 is out of range, 1 to 1000");
    EXPECT_EQ(faultOf(R"(, "effectScale": 0.04)"), "effectScale: 0.04 is out of range, 0.05 to 20");
    EXPECT_EQ(faultOf(R"(, "width": 1.5)"), "width: must be a whole number from 1 to 16384, not 1.5");
    EXPECT_EQ(faultOf(R"(, "background": "red")"),
              "background: 'red' is none of transparent, checkerboard, #RRGGBB, #RGB");
    EXPECT_EQ(faultOf(R"(, "variations": [{"axis": "weight", "value": 1}])"),
              "variations: 'weight' is no axis of four letters");
    EXPECT_NE(faultOf(R"(, "colour": "#000")"), "");
    EXPECT_NE(faultOf(R"(, "premultiplied": true, "background": "#000")"), "");
    EXPECT_EQ(faultOf(R"(, "premultiplied": true, "background": "transparent")"), "");
}

TEST(TextRequest, RefusesATextThatIsTooLong) {
    const std::string longest(vorelcompose::kMaxTextBytes, 'x');
    const auto ofText = [](const std::string& text) {
        return textRequest(R"({"fonts": ["x"], "text": ")" + text + "\"}");
    };
    EXPECT_EQ(ofText(longest).text, longest);
    EXPECT_THROW(ofText(longest + "x"), RequestError);
}

TEST(TextRequest, RefusesAFitWithoutItsSide) {
    EXPECT_THROW(textRequest(R"({"text": "a", "fonts": ["x"], "fit": "wrap"})"),
                 vorelcompose::ComposeError);
}

}  // namespace
}  // namespace vorelscript
