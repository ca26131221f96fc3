#pragma once

#include "options.h"
#include "painting.h"

namespace vorelpaint {

/// Paints the text in every preset, in a grid with the presets' names, into the output file. Throws
/// ToolError.
void paintSheet(const Options& options, const Warn& warn);

/// The number of columns that makes a sheet of `count` cells of this size as nearly square as it gets
/// without being higher than wide.
int sheetColumns(int count, int cellWidth, int cellHeight);

}  // namespace vorelpaint
