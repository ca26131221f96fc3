#pragma once

#include <cstddef>
#include <string>

#include "options.h"

namespace vorelpaint {

/// What one job of a batch asks for: the line is a JSON object whose keys are the names of the settings
/// of a picture; what it does not say is taken from `common`. Throws ToolError.
Options parseJob(const std::string& line, const Options& common);

struct BatchResult {
    size_t jobs = 0;
    size_t failed = 0;
};

/// Paints the jobs of the batch that the options name. Every fault of a job is said in one line with the
/// number of its line, and the next job goes on. Throws ToolError when the batch itself cannot be read,
/// and before anything is painted when two of its jobs have one output. In a pipe, which cannot be read
/// twice, that is the fault of the second one.
BatchResult paintBatch(const Options& common);

}  // namespace vorelpaint
