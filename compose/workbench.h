#pragma once

#include "compose/font_shelf.h"
#include "compose/look_shelf.h"
#include "compose/text_shelf.h"

namespace vorelcompose {

/// What one thread keeps from one picture to the next, within bounds; pictures are the same without it.
struct Workbench {
    /// The source must outlive it.
    explicit Workbench(FontSource& source) : fonts(source) {}

    FontShelf fonts;
    TextShelf texts;
    LookShelf looks;
};

}  // namespace vorelcompose
