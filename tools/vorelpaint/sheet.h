#pragma once

#include "compose/note.h"
#include "options.h"

namespace vorelpaint {

/// Paints the text in every preset with the presets' names into the output file: in a grid, or for
/// several sizes with a row for each preset and a column for each size. Throws ToolError.
void paintSheet(const Options& options, const Note& note);

/// The number of columns that makes a sheet of `count` cells of this size as nearly square as it gets
/// without being higher than wide.
int sheetColumns(int count, int cellWidth, int cellHeight);

}  // namespace vorelpaint
