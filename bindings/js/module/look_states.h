#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "compose/vorelcompose.h"
#include "json_writer.h"

/// Looks as a script holds them: JSON objects with "fill", a number 0xRRGGBB, "fillOpacity", "isFilled",
/// "textOpacity" and "effects", in their order. Each effect has "kind", its name in a style file, and
/// what the calls of look.h take:
///
///     outerShadow, innerShadow   color, angle, distance, size, opacity
///     outerGlow, innerGlow       size, color, opacity, stops
///     linearGradient             angle, scale, opacity, stops
///     radialGradient             scale, opacity, stops
///     stroke                     size, color, opacity, position: outside, inside or centre
///     pattern                    scale, opacity and its pixels
///
/// Stops are objects of color, place and opacity.
namespace vorelscript {

using Images = std::map<std::string, vorelstyle::PatternImage>;

/// Writes the state of a look of a style whose lengths are resolved. The pixels of its pattern go behind
/// `pixels`: the effect has "width", "height" and "at", where they begin. Throws StyleError for what is
/// not painted.
void writeState(JsonWriter& json, const vorelstyle::LookStyle& look, const vorelstyle::LoadImage& load,
                std::vector<uint8_t>& pixels);

/// The style of a JSON array of states, the last on top. A pattern has "image", its name in the style.
/// Throws StyleError for what is no state.
vorelstyle::Style styleOfStates(std::string_view json);

}  // namespace vorelscript
