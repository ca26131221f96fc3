#pragma once

#include <stdexcept>
#include <string>

namespace vorelstyle {

/// What is wrong with a style, the only exception of this library's own. Its text is one line: where in
/// the style (a path such as "looks[1].outerShadow.size", or the line of a syntax error), then the fault
/// and the range; before that "style 'NAME': " of a style that was read with a name.
class StyleError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

/// What `act` returns; the text of a StyleError that it throws gets `prefix` before it.
template <typename Act>
auto withFaultsUnder(const std::string& prefix, const Act& act) {
    try {
        return act();
    } catch (const StyleError& error) {
        throw StyleError(prefix + error.what());
    }
}

}  // namespace vorelstyle
