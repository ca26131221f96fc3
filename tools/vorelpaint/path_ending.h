#pragma once

#include <string_view>

namespace vorelpaint {

/// What stands behind the last point of a file's name: "png"; nothing where there is none.
inline std::string_view endingOf(std::string_view path) {
    const size_t dot = path.find_last_of("./");
    if (dot == std::string_view::npos || path[dot] != '.') return {};
    return path.substr(dot + 1);
}

}  // namespace vorelpaint
