#pragma once

#include <stdexcept>

namespace vorelcompose {

/// A picture that cannot be had, beside what is wrong with its style (StyleError) or with its text and
/// fonts (TextError). Its text is one line that says what is wrong and where.
class ComposeError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

/// A text without a visible character, which is nothing to paint.
class InvisibleText : public ComposeError {
  public:
    InvisibleText() : ComposeError("nothing to paint: the text has no visible character") {}
};

}  // namespace vorelcompose
