#pragma once

#include <functional>
#include <string_view>

#include "options.h"

namespace vorelpaint {

/// Takes what a film has where nothing else is given: centred lines at the bottom, which are broken and
/// whose boxes are of one height. `isGiven` tells of a setting by its name.
void takeFilmDefaults(Options& options, const std::function<bool(std::string_view)>& isGiven);

/// Refuses what a film is asked for that cannot be together. Throws ToolError.
void checkFilm(const Options& options);

/// Whether there is nothing behind its cues.
bool isTransparentFilm(const Options& options);

}  // namespace vorelpaint
