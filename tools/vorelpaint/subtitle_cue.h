#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace vorelpaint {

/// A text that is shown from one moment of a film to another.
struct Cue {
    int64_t startMs;
    int64_t endMs;                   ///< the first moment without it, after the start
    std::string text;                ///< plain, its lines separated by LF; not empty
    std::vector<std::string> names;  ///< what it can be told apart by; may be empty
    size_t line;                     ///< of the file: where its times stand, from 1
};

}  // namespace vorelpaint
