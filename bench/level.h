#pragma once

#include <functional>
#include <string>
#include <vector>

namespace vorel_bench {

/// An instruction-set level of the library.
struct Level {
    std::string label;
    std::function<void()> choose;  ///< makes the library use it from now on
};

/// The levels that this build and this CPU have, the best first.
std::vector<Level> levels();

}  // namespace vorel_bench
