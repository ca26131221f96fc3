#pragma once

#include <voreleffect/look.h>

/// A look that is described in a source of its own.
VFontEffect::Look outlined();
