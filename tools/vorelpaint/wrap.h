#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace vorelpaint {

/// The words of `text` in lines of at most `width` bytes, each behind `indent` blanks; a longer word has
/// a line of its own. No line feed at the end.
std::string wrapped(std::string_view text, size_t width, size_t indent);

}  // namespace vorelpaint
