#pragma once

#include <string>

#include "film_cues.h"
#include "options.h"

namespace vorelpaint {

/// A JSON object for each cue, one a line: when and where it is seen, what it says, and its picture
/// where each has its own.
std::string filmReport(const Options& options, const FilmCues& cues);

}  // namespace vorelpaint
