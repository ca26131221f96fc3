#pragma once

#include "compose/system/style_files.h"
#include "compose/system/system_font_source.h"
#include "compose/workbench.h"

namespace vorelcompose {

/// A workbench that keeps the styles of files, too.
struct SystemWorkbench : Workbench {
    using Workbench::Workbench;

    StyleShelf styles;
};

}  // namespace vorelcompose
