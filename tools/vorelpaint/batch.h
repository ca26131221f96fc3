#pragma once

#include <cstddef>

#include "options.h"

namespace vorelpaint {

struct BatchResult {
    size_t jobs = 0;  ///< of the shard, with those that were there
    size_t failed = 0;
};

/// Paints the jobs of the batch that the options name, or of its shard, on as many threads as they ask
/// for: files, messages and reports come in the order of the lines, whatever their number. Every fault
/// of a job is said in one line with the number of its line, and the next job goes on. Throws ToolError
/// when the batch itself cannot be read, and before anything is painted when two of its jobs have one
/// output. In a pipe, which cannot be read twice, that is the fault of the second one.
BatchResult paintBatch(const Options& common);

}  // namespace vorelpaint
