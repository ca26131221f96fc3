#pragma once

#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <string>

namespace vorelpaint {

/// A failure that ends the program. Its text is one line that says what is wrong and where.
class ToolError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

/// Throws what could not be done, with the system's reason, which errno holds.
[[noreturn]] inline void failWithErrno(const std::string& what) {
    throw ToolError(what + ": " + std::strerror(errno));
}

/// A name as it stands in a message.
inline std::string inQuotes(const std::string& name) {
    return "'" + name + "'";
}

}  // namespace vorelpaint
