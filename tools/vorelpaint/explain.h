#pragma once

#include <iosfwd>

#include "options.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// Tells how a look that has not painted yet will be painted: the order of its effects, its margins, its
/// cache key; with a text, which may be null, also what each effect takes, measured over several runs.
/// Throws TextError.
void explain(std::ostream& out, const Options& options, const vorelstyle::Style& style,
             vorelstyle::Look& look, const voreltext::TextLayout* text);

}  // namespace vorelpaint
