#pragma once

#include <string>

namespace vorelpaint {

/// The manual page, made of the settings and of what the help says, as groff reads it.
std::string manualPage();

}  // namespace vorelpaint
