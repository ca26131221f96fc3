/// What vorelpaint --write-cpp wrote, compiled into this program, paints what it paints.
#include <gtest/gtest.h>
#include <voreleffect/voreleffect.h>

#include <algorithm>
#include <cstddef>
#include <memory>
#include <ostream>
#include <string>
#include <utility>
#include <vector>

#include "compose/layer_set.h"
#include "font_choice.h"
#include "style_file.h"

#define VOREL_WRITTEN_LOOK(function, style) void function(VFontEffect::VFEffect& look);
#define VOREL_WRITTEN_STACK(function, type, count, style) \
    struct type {                                         \
        void (*add)(VFontEffect::VFEffect & look);        \
        int offsetX;                                      \
        int offsetY;                                      \
        const char* span;                                 \
    };                                                    \
    extern const type function##Looks[count];
#include "written_looks.inc"
#undef VOREL_WRITTEN_LOOK
#undef VOREL_WRITTEN_STACK

namespace vorelpaint {
namespace {

using vorelstyle::Place;
using vorelstyle::Stack;
using vorelstyle::StackedLook;
using vorelstyle::Style;
using voreltext::Align;
using voreltext::Canvas;
using voreltext::Font;
using voreltext::Fonts;
using voreltext::Image;
using voreltext::Layer;
using voreltext::TextLayout;

struct WrittenLook {
    void (*add)(VFontEffect::VFEffect& look);
    int offsetX;
    int offsetY;
    std::string span;
};

struct WrittenStyle {
    const char* name;
    const char* style;
    std::vector<WrittenLook> looks;
};

std::ostream& operator<<(std::ostream& out, const WrittenStyle& style) {
    return out << style.name;
}

template <typename Written, size_t kCount>
std::vector<WrittenLook> looksOf(const Written (&written)[kCount]) {
    std::vector<WrittenLook> looks;
    for (const Written& look : written)
        looks.push_back({look.add, look.offsetX, look.offsetY, look.span});
    return looks;
}

const std::vector<WrittenStyle>& writtenStyles() {
    static const std::vector<WrittenStyle> styles{
#define VOREL_WRITTEN_LOOK(function, style) {#function, style, {{function, 0, 0, "block"}}},
#define VOREL_WRITTEN_STACK(function, type, count, style) {#function, style, looksOf(function##Looks)},
#include "written_looks.inc"
#undef VOREL_WRITTEN_LOOK
#undef VOREL_WRITTEN_STACK
    };
    return styles;
}

std::unique_ptr<VFontEffect::VFEffect> setOf(const WrittenLook& look) {
    auto set = std::make_unique<VFontEffect::VFEffect>();
    look.add(*set);
    return set;
}

/// The place in the words of the written array.
WrittenLook wordsOf(const Place& place) {
    return {nullptr, place.offsetX, place.offsetY,
            std::string(vorelstyle::kSpanNames[static_cast<size_t>(place.span)])};
}

Layer layerOf(const VFontEffect::VFEffect& effects, const WrittenLook& look) {
    const auto& names = vorelstyle::kSpanNames;
    const auto span = std::find(names.begin(), names.end(), look.span) - names.begin();
    return {&effects, look.offsetX, look.offsetY, static_cast<voreltext::Span>(span)};
}

class WrittenLooks : public ::testing::TestWithParam<WrittenStyle> {
  protected:
    WrittenLooks() : mStyle(resolved(GetParam().style)), mStack(mStyle, {}, {}, imagesOf(mStyle)) {
        for (const WrittenLook& look : GetParam().looks)
            mWritten.push_back(setOf(look));
    }

    const std::vector<StackedLook>& stacked() const { return mStack.looks(); }
    const std::vector<std::unique_ptr<VFontEffect::VFEffect>>& written() const { return mWritten; }

  private:
    /// As vorelpaint resolves it where it is asked for neither a size nor a scale.
    static Style resolved(const char* file) {
        Options options;
        options.style = file;
        return resolvedStyle(chosenStyle(options), Options().size, 1);
    }

    Style mStyle;
    Stack mStack;
    std::vector<std::unique_ptr<VFontEffect::VFEffect>> mWritten;
};

TEST_P(WrittenLooks, HaveTheSameKeysAndPlaces) {
    ASSERT_EQ(written().size(), stacked().size());
    for (size_t i = 0; i < written().size(); ++i) {
        const std::unique_ptr<char[]> key(written()[i]->getMapKey());
        EXPECT_EQ(stacked()[i].look.key(), key.get());
        const WrittenLook expected = wordsOf(stacked()[i].place);
        EXPECT_EQ(GetParam().looks[i].offsetX, expected.offsetX);
        EXPECT_EQ(GetParam().looks[i].offsetY, expected.offsetY);
        EXPECT_EQ(GetParam().looks[i].span, expected.span);
    }
}

TEST_P(WrittenLooks, PaintTheSamePixels) {
    ASSERT_EQ(written().size(), stacked().size());
    std::vector<Layer> expected;
    std::vector<Layer> painted;
    for (size_t i = 0; i < written().size(); ++i) {
        const StackedLook& look = stacked()[i];
        expected.push_back(layerOf(look.look.effects(), wordsOf(look.place)));
        painted.push_back(layerOf(*written()[i], GetParam().looks[i]));
    }
    Fonts fonts{Font(findFont("DejaVu Sans"), 64)};
    const TextLayout text(fonts, voreltext::decodeUtf8("Quick\nfox"), {Align::center});
    const Canvas canvas = placedOn({}, text.inkBox(), marginsOf(expected));
    const Image picture = paint(expected, text, canvas);
    EXPECT_TRUE(paint(painted, text, canvas).pixels == picture.pixels);
    EXPECT_GT(*std::max_element(picture.pixels.begin(), picture.pixels.end()), 0);
}

INSTANTIATE_TEST_SUITE_P(Styles, WrittenLooks, ::testing::ValuesIn(writtenStyles()),
                         [](const auto& style) { return std::string(style.param.name); });

}  // namespace
}  // namespace vorelpaint
