#pragma once

#include <string>

namespace vorelpaint {

/// The script that completes vorelpaint's options in "bash", "zsh" or "fish".
std::string completionScript(const std::string& shell);

}  // namespace vorelpaint
