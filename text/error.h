#pragma once

#include <stdexcept>

namespace voreltext {

/// A text, font or picture that cannot be had, the only exception of this library's own. Its text is one
/// line that says why.
class TextError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

}  // namespace voreltext
