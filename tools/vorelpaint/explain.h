#pragma once

#include <string>

#include "options.h"
#include "painting.h"

namespace vorelpaint {

/// How looks that have not painted yet will be painted: the order of their effects, their margins and
/// cache key. Throws TextError.
std::string explanationOf(const Options& options, const LayerSet& looks);

/// The same of a picture, with what each effect takes, measured over several runs.
std::string explanationOf(const Options& options, const Composition& composition);

}  // namespace vorelpaint
