#pragma once

#include <ctime>

#include "case.h"

namespace vorel_bench {

/// In seconds.
double now(clockid_t clock);

/// What times the next call when the fastest one took so many seconds. A thread's own clock stops when
/// another process has the core, but reading it takes a system call that a short call would feel.
clockid_t clockFor(double fastest);

/// The seconds of the fastest call, without its reset(). The job is painted until its calls have taken
/// `seconds`, at least three times, but what takes more than a second only once.
double fastestCall(Job& job, double seconds);

/// From now on large blocks of memory stay with the process. Those that come from the system anew for
/// each call take longer than many an effect, page by page, and are their caller's choice of an
/// allocator.
void keepLargeBlocks();

}  // namespace vorel_bench
