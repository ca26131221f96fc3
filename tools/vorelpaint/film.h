#pragma once

#include "compose/note.h"
#include "options.h"

/// Subtitles as a film: burnt into a clip, or on their own.
namespace vorelpaint {

/// Makes the film, and reports its cues where that is asked for. Its frames have the sides of the clip,
/// else those that are given, else 1920 x 1080 pixels; where none is given, the font has an eighteenth
/// of the shorter side and the margin a twentieth. Throws ToolError, StyleError or TextError; no begun
/// film is left then.
void makeFilm(const Options& options, const Note& note);

}  // namespace vorelpaint
