#pragma once

#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>

#include "compose/vorelcompose.h"

namespace vorelscript {

/// What is wrong with a request: the path of the key, and what may stand there.
class RequestError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

/// What is asked of a picture, with its text.
struct TextRequest {
    vorelcompose::Request request;
    std::string text;
    bool hasMarkup = false;
    bool isPremultiplied = false;  ///< it stays so, and has no background
    vorelcompose::Background background;
};

/// Reads a request. Its keys, all but `text` and `fonts` with a usual value:
///
///     text           at most 64 KiB of UTF-8
///     markup         whether the text has any: false
///     fonts          names of 1 to 16 fonts, in the order in which they are asked
///     size           of the font in pixels, 1 to 1000: 96
///     align          left, center, right, start or end: left
///     lineHeight     0.5 to 10 line heights of the font: 1
///     letterSpacing  -200 to 200 pixels, or that many percent of the size as in "5%": 0
///     features       of OpenType, ["liga=0"]: none
///     variations     axes of the first font, [{"axis": "wght", "value": 700}]: none
///     color          the fill of the topmost look that has one, "#RRGGBB"
///     opacity        of that text, 0 to 1
///     effectScale    multiplies the effects' sizes, 0.05 to 20: 1
///     width, height  of the picture, 1 to 16384 pixels: what the text needs
///     anchor         where the text stands in these, such as top-left: center
///     margin         pixels between it and their edges, 0 to 8000: 0
///     fit            what is done with a text that is larger, none, shrink or wrap: none
///     box            what counts as its box, ink or line: ink
///     padding        pixels around it where no width or height is given, 0 to 1000: 8
///     background     transparent, checkerboard or a colour: transparent
///     premultiplied  leaves the pixels so: false
///     strict         takes every note for an error: false
///
/// Throws RequestError, and ComposeError for a fit without the sides that it needs.
TextRequest textRequest(std::string_view json);

/// Of a style, what is written as C++. Throws RequestError.
struct SourceRequest {
    std::string name;
    vorelcompose::Request request;
};
SourceRequest sourceRequest(std::string_view json);

/// Throws RequestError for a size or a scale out of its range.
vorelcompose::Request sizeRequest(int size, float effectScale);

}  // namespace vorelscript
