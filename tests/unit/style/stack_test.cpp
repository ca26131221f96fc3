#include "style/stack.h"

#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <random>
#include <string>
#include <tuple>
#include <vector>

#include "style/error.h"
#include "style/key_text.h"
#include "style/resolved_style.h"

namespace vorelstyle {
namespace {

Style read(const std::string& json, const char* name = "") {
    return resolvedStyle(parseStyle(json, name), 100, 1);
}

Stack stackOf(const std::string& json) {
    return Stack(read(json));
}

/// The message with which the stack of a style is refused.
std::string faultOf(const Style& style, const LoadImage& load = {}) {
    try {
        const Stack stack(style, {}, {}, load);
        return "";
    } catch (const StyleError& error) {
        return error.what();
    }
}

PatternImage narrowPicture(const std::string&) {
    return {1, 1, {1, 2, 3, 4}};
}

/// The library's own key of a fill.
std::string fillKey(uint32_t fill, float opacity) {
    VFontEffect::VFEffect effects;
    effects.setTextOpacity(opacity);
    const std::unique_ptr<char[]> key(effects.getMapKey(fill));
    return key.get();
}

TEST(Stack, OneLookInItsPlace_HasTheLibrarysKeyAlone) {
    EXPECT_EQ(stackOf("{}").key(), fillKey(0, 1));
    EXPECT_EQ(stackOf(R"({"version": 2, "looks": [{"color": "#123456"}]})").key(), fillKey(0x123456, 1));
    EXPECT_EQ(stackOf(R"({"version": 2, "offset": {"x": "0%"}, "span": "block"})").key(), fillKey(0, 1));
}

TEST(Stack, Keys_StandBehindTheirPlacesTheLowestFirst) {
    const std::string key = stackOf(R"({"version": 2, "looks": [{"color": "#FF0000"},
                                            {"color": "#00FF00", "offset": {"x": 3, "y": -2}}]})")
                                .key();
    // Offsets count from -2^20 in three characters of seven bits: 0 is 64, 0, 0.
    const std::string zero = "\xC0\x80\x80";
    EXPECT_EQ(key, "P" + zero + zero + "\x80" + fillKey(0xFF0000, 1) + "P\xC0\x80\x83\xBF\xFF\xFE\x80" +
                       fillKey(0x00FF00, 1));
}

TEST(Stack, OneLookThatIsMovedOrInSpans_TellsItsPlace) {
    EXPECT_EQ(stackOf(R"({"version": 2, "offset": {"y": 1}})").key(),
              "P\xC0\x80\x80\xC0\x80\x81\x80" + fillKey(0, 1));
    EXPECT_EQ(stackOf(R"({"version": 2, "span": "glyph", "fill": false})").key(),
              "P\xC0\x80\x80\xC0\x80\x80\x87" + fillKey(0, 0));
}

/// Its effects are those of an invisible fill, but the pictures of colour fonts do not fade with it.
TEST(Stack, LookWithoutFill_HasAnotherKeyThanAnInvisibleFill) {
    EXPECT_EQ(stackOf(R"({"textOpacity": 0})").key(), fillKey(0, 0));
    EXPECT_EQ(stackOf(R"({"version": 2, "fill": false})").key(),
              "P\xC0\x80\x80\xC0\x80\x80\x84" + fillKey(0, 0));
    const Stack stack = stackOf(R"({"version": 2, "fill": false})");
    EXPECT_FALSE(stack.looks()[0].place.isFilled);
    VFontEffect::VFEffect effects(stack.looks()[0].look.effects());
    EXPECT_EQ(effects.getTextOpacity(), 0.0F);
}

/// What of a stack its key must tell.
using Description = std::vector<std::tuple<int, int, int, bool, uint32_t>>;

Description randomDescription(std::mt19937& random) {
    const auto upTo = [&](int most) {
        return static_cast<int>(random() % static_cast<unsigned>(most + 1));
    };
    Description looks;
    for (int count = 1 + upTo(3); count > 0; --count) {
        const int reach = upTo(3) == 0 ? kMaxOffset : 2;
        const bool isFilled = upTo(3) != 0;
        looks.emplace_back(upTo(2 * reach) - reach, upTo(2 * reach) - reach, upTo(3), isFilled,
                           isFilled ? static_cast<uint32_t>(upTo(1)) : 0);
    }
    return looks;
}

Style styleOf(const Description& looks) {
    Style style;
    style.looks.clear();
    for (const auto& [x, y, span, isFilled, fill] : looks) {
        LookStyle look;
        look.offsetX = {static_cast<float>(x)};
        look.offsetY = {static_cast<float>(y)};
        look.span = static_cast<Span>(span);
        look.isFilled = isFilled;
        if (isFilled) look.color = fill;
        style.looks.push_back(look);
    }
    return style;
}

bool isPlain(const Description& looks) {
    const auto& [x, y, span, isFilled, fill] = looks.front();
    return looks.size() == 1 && x == 0 && y == 0 && span == 0 && isFilled;
}

TEST(Stack, StacksThatDiffer_HaveDifferentKeys) {
    std::mt19937 random(20251122);
    std::map<std::string, Description> known;
    for (int i = 0; i < 20000; ++i) {
        const Description looks = randomDescription(random);
        const std::string key = Stack(styleOf(looks)).key();
        const auto [place, isNew] = known.emplace(key, looks);
        ASSERT_EQ(place->second, looks);
    }
    EXPECT_GT(known.size(), 5000U);
}

/// The words in which a key tells of these looks.
std::vector<std::string> wordsOf(const Description& looks) {
    const std::vector<std::string> spans{"", ", by line", ", by word", ", by glyph"};
    std::vector<std::string> words;
    for (const auto& [x, y, span, isFilled, fill] : looks) {
        if (!isPlain(looks)) {
            const bool moved = x != 0 || y != 0;
            const std::string offset = std::to_string(x) + ", " + std::to_string(y);
            words.push_back("place: " + (moved ? "moved by " + offset : "not moved") +
                            spans[static_cast<size_t>(span)] + (isFilled ? "" : ", not filled"));
        }
        words.push_back(std::string("text: colour #") + (!isFilled   ? "00000000"
                                                         : fill == 0 ? "FF000000"
                                                                     : "FF000001"));
    }
    return words;
}

TEST(Stack, Keys_AreToldInWordsAgain) {
    std::mt19937 random(1);
    for (int i = 0; i < 5000; ++i) {
        const Description looks = randomDescription(random);
        std::vector<std::string> words;
        for (const KeyFragment& fragment : keyFragments(Stack(styleOf(looks)).key()))
            words.push_back(std::string(fragment.name) + ": " + fragment.meaning);
        ASSERT_EQ(words, wordsOf(looks));
    }
}

TEST(Stack, ChosenFillAndOpacity_AreThoseOfTheTopmostFilledLook) {
    const Style style = read(R"({"version": 2, "looks": [
        {"color": "#000001", "textOpacity": 0.5}, {"text": {"color": "#000002"}},
        {"fill": false, "stroke": {"size": 1, "color": "#000000", "position": "outside"}}]})");
    const Stack chosen(style, 0xABCDEF, 0.25F);
    EXPECT_EQ(chosen.topFill(), 1U);
    EXPECT_EQ(chosen.looks()[0].look.key(), fillKey(1, 0.5F));
    EXPECT_EQ(chosen.looks()[1].look.key(), fillKey(0xABCDEF, 0.25F));
    EXPECT_EQ(chosen.looks()[2].look.key(), Stack(style).looks()[2].look.key());
    EXPECT_EQ(Stack(style).looks()[1].look.key(), fillKey(2, 1));
}

TEST(Stack, ChosenFillWithoutAFilledLook_IsNotUsed) {
    const Style style = read(R"({"version": 2, "looks": [{"fill": false}, {"fill": false}]})");
    EXPECT_FALSE(Stack(style).topFill());
    EXPECT_EQ(Stack(style, 0xABCDEF, 1.0F).key(), Stack(style).key());
}

TEST(Stack, InvisibleFill_CanBeChosenAsToday) {
    const Style style = read(R"({"textOpacity": 0})");
    EXPECT_EQ(Stack(style).topFill(), 0U);
    EXPECT_EQ(Stack(style, 0xABCDEF, 1.0F).key(), fillKey(0xABCDEF, 1));
}

TEST(Stack, EffectsWithoutACore_AreNamedWithTheirLook) {
    const std::string relief =
        R"("bevel": {"size": 1, "angle": 0, "altitude": 0, "highlightColor": "#000000", "shadowColor": "#000000"})";
    EXPECT_EQ(stackOf("{" + relief + "}").unpainted(), std::vector<std::string>{"bevel"});
    EXPECT_EQ(stackOf(R"({"version": 2, "looks": [{}, {)" + relief + "}]}").unpainted(),
              std::vector<std::string>{"looks[1].bevel"});
}

TEST(Stack, NotesOfPatterns_NameTheirLook) {
    const Style style =
        read(R"({"version": 2, "looks": [{}, {"pattern": {"image": "a.png", "width": 20}}]})");
    const Stack stack(style, {}, {}, narrowPicture);
    ASSERT_EQ(stack.notes().size(), 1U);
    EXPECT_EQ(stack.notes()[0].rfind("looks[1].pattern.width: 20 pixels", 0), 0U) << stack.notes()[0];
}

TEST(Stack, FaultsOfPatterns_NameStyleAndLook) {
    const std::string look = R"({"pattern": {"image": "a.png"}})";
    EXPECT_EQ(faultOf(read(look, "looks/a.json")),
              "style 'looks/a.json': pattern.image: there is nothing to load 'a.png' with");
    EXPECT_EQ(faultOf(read(R"({"version": 2, "looks": [{}, )" + look + "]}", "b.json")),
              "style 'b.json': looks[1].pattern.image: there is nothing to load 'a.png' with");
}

TEST(Stack, LengthsThatAreNotResolved_AreRefused) {
    EXPECT_EQ(faultOf(parseStyle(R"({"version": 2, "looks": [{}, {"outerGlow":
                                     {"size": "4%", "color": "#000000"}}]})")),
              "looks[1].outerGlow.size: is a share of the font's size, not in pixels");
    const std::string is = ": is no whole number of pixels within 32767";
    EXPECT_EQ(faultOf(parseStyle(R"({"version": 2, "offset": {"x": "4%"}})")), "offset.x" + is);
    EXPECT_EQ(faultOf(parseStyle(R"({"version": 2, "offset": {"y": 0.5}})")), "offset.y" + is);
    Style far;
    far.looks[0].offsetX = {32768};
    EXPECT_EQ(faultOf(far), "offset.x" + is);
    far.looks[0].offsetX = {std::numeric_limits<float>::quiet_NaN()};
    EXPECT_EQ(faultOf(far), "offset.x" + is);
}

}  // namespace
}  // namespace vorelstyle
