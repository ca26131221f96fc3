#pragma once

#include <functional>
#include <string>

namespace vorelpaint {

/// Takes a line that says what is odd, but by itself no reason to stop.
using Note = std::function<void(const std::string& line)>;

}  // namespace vorelpaint
