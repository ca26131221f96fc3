#pragma once

#include <voreleffect/VFBitmap.h>

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <variant>
#include <vector>

#include "style/json_object.h"

/// A look as a style file describes it: one record per add-call of the library, in file order.
/// The fields carry the names, units and ranges of the add-calls' arguments (VFEffect.h); colours
/// are 0xRRGGBB.
namespace vorelstyle {

using Stops = std::vector<VFontEffect::VFGradient>;

struct Shadow {
    float angle;
    float distance;
    float size;
    uint32_t color;
    float opacity;
};
struct OuterShadow : Shadow {};
struct InnerShadow : Shadow {};

struct Glow {
    float size;
    uint32_t color;
    float opacity;
    Stops gradient;  ///< empty: the glow has the one colour `color`
};
struct OuterGlow : Glow {};
struct InnerGlow : Glow {};

struct Relief {
    int style;
    float size;
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
    float size;
    uint32_t color;
    float opacity;
    int strokeStyle;
    int position;  ///< 0 centre, 1 outside, 2 inside
};

struct Pattern {
    std::string image;  ///< the name of a PNG file, relative to the style file
    float scale;
    float opacity;
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

struct Style {
    std::string description;
    std::optional<uint32_t> color;     ///< the fill, unless the caller chooses one
    std::optional<float> textOpacity;  ///< the text's opacity, unless the caller chooses one
    std::vector<Effect> effects;       ///< in the order of the file: the last lies on top
    std::string name;  ///< under which messages speak of it, such as its file; may be empty
};

/// Whether the text's fill is among the effects, with a place and an opacity of its own.
bool hasTextFill(const Style& style);

/// What the style's text takes where nobody chooses: its fill, else black, and its opacity, else 1.
uint32_t fillOf(const Style& style);
float opacityOf(const Style& style);

/// Reads a style file's text. What its faults call it, and the style's name, is `name`. No file is
/// opened. Throws StyleError.
Style parseStyle(std::string_view json, std::string_view name = {});

/// Reads a style without a name that stands somewhere in a document. Throws StyleError.
Style readStyle(JsonValue json);

}  // namespace vorelstyle
