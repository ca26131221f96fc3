#pragma once

#include <memory>
#include <string>

#include "compose/composition.h"
#include "font_of_bytes.h"

namespace vorelcompose {

/// Compositions of short texts in the font that is brought along.
class Composed {
  public:
    Composed() {
        request.fonts = {"mine"};
        request.size = 24;
    }

    Composition of(const char* style, const std::string& text = "Fi g", bool hasMarkup = false) {
        const auto find = [style] {
            return FoundStyle{std::make_shared<vorelstyle::Style>(vorelstyle::parseStyle(style)), {}};
        };
        return {request, SourceText(text, hasMarkup), find, mBench};
    }

    Request request;

  private:
    FontOfBytes mFonts;
    Workbench mBench{mFonts};
};

constexpr const char* kPlainLook = R"({
    "outerShadow": {"angle": 135, "distance": 3, "size": 3, "color": "#102030", "opacity": 0.8},
    "stroke": {"size": 2, "color": "#20C0FF", "position": "outside"},
    "linearGradient": {"angle": 90, "opacity": 0.5,
                       "gradient": [{"location": 0, "color": "#F00"}, {"location": 1, "color": "#0F0"}]},
    "innerShadow": {"angle": 135, "distance": 2, "size": 2, "color": "#000080", "opacity": 0.7},
    "color": "#E0D040"})";

constexpr const char* kCentredLook = R"({
    "outerGlow": {"size": 5, "color": "#F0F"},
    "stroke": {"size": 3, "color": "#2040FF", "position": "center", "opacity": 0.6},
    "innerGlow": {"size": 3, "color": "#FFF"},
    "color": "#80A020"})";

constexpr const char* kStackOfLooks = R"({"version": 2, "looks": [
    {"offset": {"x": 3, "y": -2}, "span": "word", "textOpacity": 0.5,
     "outerGlow": {"size": 6, "color": "#F80"}, "stroke": {"size": 3, "color": "#000", "position": "outside"}},
    {"span": "glyph", "color": "#48C",
     "radialGradient": {"opacity": 0.5, "gradient": [{"location": 0, "color": "#FFF"},
                                                     {"location": 1, "color": "#000"}]},
     "innerGlow": {"size": 2, "color": "#FF0"}},
    {"span": "line", "offset": {"x": -1, "y": 0}, "fill": false,
     "stroke": {"size": 1, "color": "#FFF", "position": "outside"}}]})";

}  // namespace vorelcompose
