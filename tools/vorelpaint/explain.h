#pragma once

#include <iosfwd>

#include "options.h"
#include "painting.h"

namespace vorelpaint {

/// Tells how a look that has not painted yet will be painted: the order of its effects, its margins, its
/// cache key; with a text, which may be null, also what each effect takes, measured over several runs.
/// Throws ToolError.
void explain(std::ostream& out, const Options& options, const Style& style, Look& look,
             const TextLayout* text);

}  // namespace vorelpaint
