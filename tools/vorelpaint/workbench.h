#pragma once

#include "font_shelf.h"
#include "style_shelf.h"
#include "text_shelf.h"

namespace vorelpaint {

/// What one thread keeps from one picture to the next, within bounds; pictures are the same without it.
struct Workbench {
    FontShelf fonts;
    TextShelf texts;
    StyleShelf styles;
};

}  // namespace vorelpaint
