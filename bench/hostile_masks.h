#pragma once

#include <vector>

#include "workload.h"

/// Masks that no text looks like: what grain, halftones, photographs and attackers hand over.
namespace vorel_bench {

/// Squares of that side in pixels, the same on every machine.
std::vector<Workload> hostileMasks(int side);

/// Lines of LINE48, as many as a square of that side holds: what the others are compared with.
Workload textPage(int side);

}  // namespace vorel_bench
