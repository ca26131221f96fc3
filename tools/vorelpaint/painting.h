#pragma once

#include <functional>
#include <string>

#include "options.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

/// The steps from what is asked for to a picture in its file. Each throws ToolError, StyleError or
/// TextError.
namespace vorelpaint {

/// Takes a line that says what is odd, but no reason to stop.
using Warn = std::function<void(const std::string& line)>;

/// The style that is asked for, resolved at its scale; an empty one when none is.
vorelstyle::Style chosenStyle(const Options& options);

std::string chosenText(const Options& options);

/// The look of a style with the fill and the opacity that are asked for.
vorelstyle::Look makeLook(const Options& options, const vorelstyle::Style& style, const Warn& warn);

/// The text in its font, which must outlive it. Refuses a text without ink.
voreltext::TextLayout layOutText(const Options& options, const voreltext::Font& font, const Warn& warn);

/// The picture on its background into its file.
void writePicture(const Options& options, voreltext::Image picture);

/// All of these steps.
void paintPicture(const Options& options, const Warn& warn);

}  // namespace vorelpaint
