#pragma once

#include "case.h"

namespace vorel_bench {

/// The seconds of the fastest call, without its reset(). The job is painted until its calls have taken
/// `seconds`, at least three times, but what takes more than a second only once.
double fastestCall(Job& job, double seconds);

}  // namespace vorel_bench
