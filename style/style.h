#pragma once

#include <voreleffect/VFBitmap.h>

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "style/json_object.h"
#include "style/length.h"

/// Looks as a style file describes them: one record per add-call of the library, in file order. The
/// fields carry the names, units and ranges of the add-calls' arguments (VFEffect.h); colours are
/// 0xRRGGBB, and lengths may be shares of the font's size until resolvedStyle has made them pixels.
namespace vorelstyle {

using Stops = std::vector<VFontEffect::VFGradient>;

struct Shadow {
    float angle;
    Length distance;
    Length size;
    uint32_t color;
    float opacity;
};
struct OuterShadow : Shadow {};
struct InnerShadow : Shadow {};

struct Glow {
    Length size;
    uint32_t color;
    float opacity;
    Stops gradient;  ///< empty: the glow has the one colour `color`
};
struct OuterGlow : Glow {};
struct InnerGlow : Glow {};

struct Relief {
    int style;
    Length size;
    float depth;
    int technique;
    int direction;
    int soften;
    float opacity;
    float angle;
    float altitude;
    uint32_t highlightColor;
    float highlightOpacity;
    uint32_t shadowColor;
    float shadowOpacity;
};
struct Bevel : Relief {};
struct Emboss : Relief {};

struct LinearGradient {
    float angle;
    float scale;
    float opacity;
    Stops gradient;
};

struct RadialGradient {
    float scale;
    float opacity;
    Stops gradient;
};

struct Stroke {
    Length size;
    uint32_t color;
    float opacity;
    int strokeStyle;
    int position;  ///< 0 centre, 1 outside, 2 inside
};

struct Pattern {
    std::string image;  ///< the name of a PNG file, relative to the style file
    float scale;
    float opacity;
    std::optional<Length> width;  ///< of one tile, above 0; goes before `scale`
};

struct TextFill {
    uint32_t color;
    float opacity;
};

using Effect = std::variant<OuterShadow, InnerShadow, OuterGlow, InnerGlow, Bevel, Emboss,
                            LinearGradient, RadialGradient, Stroke, Pattern, TextFill>;

/// The effect's key in a style file, such as "outerShadow".
std::string_view effectName(const Effect& effect);

/// The library's numbers of some kinds of effects (VFEffect.h).
constexpr int kStrokeType = 10;
constexpr int kPatternType = 11;
constexpr int kTextType = 12;

/// The number of the kind of effect, and the key of the kind of that number.
int effectType(const Effect& effect);
std::string_view effectName(int type);

/// What is painted as one run, with a text box of its own, which gradients and patterns fill.
enum class Span { block, line, word, glyph };

/// The spans' names in a style file, in their order.
constexpr std::array<std::string_view, 4> kSpanNames{"block", "line", "word", "glyph"};

/// One look: the text with effects around and upon it.
struct LookStyle {
    std::optional<uint32_t> color;     ///< the fill, unless the caller chooses one
    std::optional<float> textOpacity;  ///< the text's opacity, unless the caller chooses one
    bool isFilled =
        true;        ///< false leaves the fill out: what lies beneath the glyphs is cut out of them
    Length offsetX;  ///< to the right
    Length offsetY;  ///< downwards
    Span span = Span::block;
    std::vector<Effect> effects;  ///< in the order of the file: the last lies on top
    std::string description;      ///< of this look in a list; may be empty
};

/// Looks that are painted one over the other.
struct Style {
    int version = 1;  ///< of the format of the file
    std::string description;
    std::vector<LookStyle> looks = std::vector<LookStyle>(1);  ///< never empty; the last lies on top
    bool isList = false;  ///< whether the file has a list of looks, which the paths of messages tell
    std::string name;     ///< under which messages speak of it, such as its file; may be empty
};

/// Whether the text's fill is among the effects, with a place and an opacity of its own.
bool hasTextFill(const LookStyle& look);

/// What the look's text takes where nobody chooses: its fill, else black, and its opacity, else 1. The
/// opacity of a look that is not filled is 0.
uint32_t fillOf(const LookStyle& look);
float opacityOf(const LookStyle& look);

/// The position of the topmost look that is filled, whose fill and opacity a caller may choose; nothing
/// when none is.
std::optional<size_t> topFill(const Style& style);

/// What the path of anything in the look at a position begins with: "looks[1]." in a list, else nothing.
std::string lookPath(const Style& style, size_t position);

/// Reads a style file's text. What its faults call it, and the style's name, is `name`. No file is
/// opened. Throws StyleError.
Style parseStyle(std::string_view json, std::string_view name = {});

/// Reads a style without a name that stands somewhere in a document. Throws StyleError.
Style readStyle(JsonValue json);

}  // namespace vorelstyle
