#pragma once

#include <stdexcept>

namespace vorelpaint {

/// A failure that ends the program. Its text is one line that says what is wrong and where.
class ToolError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

}  // namespace vorelpaint
