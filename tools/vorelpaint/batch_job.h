#pragma once

#include <string>

#include "options.h"

namespace vorelpaint {

/// What one job of a batch asks for: the line is a JSON object whose keys are the names of the settings
/// of a picture; what it does not say is taken from `common`. Throws ToolError or ComposeError.
Options parseJob(const std::string& line, const Options& common);

}  // namespace vorelpaint
