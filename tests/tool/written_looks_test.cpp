/// The functions that vorelpaint --write-cpp wrote, compiled into this program, paint what it paints.
#include <gtest/gtest.h>
#include <voreleffect/voreleffect.h>

#include <memory>
#include <ostream>
#include <string>

#include "font_choice.h"
#include "layer_set.h"

#define VOREL_WRITTEN_LOOK(function, style) void function(VFontEffect::VFEffect& look);
#include "written_looks.inc"
#undef VOREL_WRITTEN_LOOK

namespace vorelpaint {
namespace {

using voreltext::Align;
using voreltext::Font;
using voreltext::Fonts;
using voreltext::Image;
using voreltext::TextLayout;

struct WrittenLook {
    const char* name;
    const char* style;
    void (*add)(VFontEffect::VFEffect& look);
};

std::ostream& operator<<(std::ostream& out, const WrittenLook& look) {
    return out << look.name;
}

constexpr WrittenLook kLooks[] = {
#define VOREL_WRITTEN_LOOK(function, style) {#function, style, function},
#include "written_looks.inc"
#undef VOREL_WRITTEN_LOOK
};

class WrittenLooks : public ::testing::TestWithParam<WrittenLook> {};

TEST_P(WrittenLooks, PaintTheSamePixels) {
    Options options;
    options.style = GetParam().style;
    const LayerSet looks(options, chosenStyle(options), options.size, {}, [](const std::string&) {});
    VFontEffect::VFEffect written;
    GetParam().add(written);
    const std::unique_ptr<char[]> key(written.getMapKey());
    EXPECT_EQ(looks.stack().key(), key.get());

    Fonts fonts{Font(findFont("DejaVu Sans"), 64)};
    const TextLayout text(fonts, voreltext::decodeUtf8("Quick\nfox"), {Align::center});
    VFontEffect::VFEffect effects(*looks.layers().front().effects);
    const Image expected = paint(effects, text, 2);
    const Image painted = paint(written, text, 2);
    EXPECT_EQ(painted.width, expected.width);
    EXPECT_EQ(painted.height, expected.height);
    EXPECT_TRUE(painted.pixels == expected.pixels);
}

INSTANTIATE_TEST_SUITE_P(Styles, WrittenLooks, ::testing::ValuesIn(kLooks),
                         [](const auto& look) { return std::string(look.param.name); });

}  // namespace
}  // namespace vorelpaint
