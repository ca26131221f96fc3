#pragma once

#include <string>

/// What the program prints on standard output, and what it says beside that: lines on standard error.
namespace vorelpaint {

/// Takes the numbers of standard streams that are not open, so that no file has them that is opened
/// later; reading and writing fails as before.
void reserveStandardStreams();

/// Text on standard output. Throws ToolError when it does not get there.
void print(const std::string& text);

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
