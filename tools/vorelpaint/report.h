#pragma once

#include <string>

#include "options.h"
#include "painting.h"

namespace vorelpaint {

/// What is to be known of a picture, as one line of JSON; docs/vorelpaint.md tells its keys. Places are
/// in pixels of the picture, boxes half-open.
std::string reportOf(const Options& options, const Composition& composition);

}  // namespace vorelpaint
