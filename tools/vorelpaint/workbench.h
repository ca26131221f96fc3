#pragma once

#include "compose/system/workbench.h"
#include "font_choice.h"

namespace vorelpaint {

/// What one thread keeps from one picture to the next, within bounds; pictures are the same without it.
struct Workbench : vorelcompose::SystemWorkbench {
    Workbench() : SystemWorkbench(fontSource()) {}
};

}  // namespace vorelpaint
