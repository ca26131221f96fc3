#pragma once

#include <stdexcept>

namespace vorelstyle {

/// What is wrong with a style, the only exception of this library's own. Its text is one line: where in
/// the style (a path such as "outerShadow.size", or the line of a syntax error), then the fault and the
/// range; before that "style 'NAME': " of a style that was read with a name.
class StyleError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

}  // namespace vorelstyle
