#pragma once

#include <functional>
#include <string>

namespace vorelstyle {

/// Takes a line that says what is painted otherwise than the style asks for; it begins with the path.
using Note = std::function<void(const std::string& line)>;

/// The shortest spelling of a number that is read as the same one, such as 0.1, in any locale.
std::string spelled(double number);
std::string spelled(float number);

}  // namespace vorelstyle
