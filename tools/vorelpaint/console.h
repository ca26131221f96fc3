#pragma once

#include <string>

/// What the program says beside its output: lines on standard error.
namespace vorelpaint {

/// One line on standard error, with the program's name before it. A status that is shown stays below it.
void say(const std::string& line);

/// Whether a status would be seen: standard error is a terminal.
bool hasTerminal();

/// Shows a passing line on the terminal in place of the one before, as far as it fits; an empty one
/// removes it. Without a terminal nothing is shown.
void showStatus(const std::string& line);

/// Removes a shown status. May be called from a signal handler.
void eraseStatus();

}  // namespace vorelpaint
