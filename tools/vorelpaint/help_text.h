#pragma once

#include <string>
#include <vector>

namespace vorelpaint {

constexpr const char* kPurpose = "Paints text with effects into a PNG file.";

/// What the help and the manual page say beside the settings.
const std::vector<std::string>& exampleCommands();

/// A paragraph under its heading.
struct Topic {
    std::string heading;
    std::string text;  ///< one line, to be wrapped
};
const std::vector<Topic>& topics();

/// Examples and topics as they end the help.
std::string helpFooter();

}  // namespace vorelpaint
