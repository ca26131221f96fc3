#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "background.h"
#include "text_layout.h"

namespace vorelpaint {

/// What the command line asks for.
struct Options {
    std::optional<std::string> text;
    std::optional<std::string> textFile;
    std::string font = "DejaVu Sans";
    int size = 96;
    Align align = Align::left;
    std::optional<uint32_t> color;
    std::optional<float> opacity;
    float effectScale = 1;
    std::optional<std::string> style;
    std::optional<std::string> preset;
    Background background;
    std::optional<std::string> output;
    int padding = 8;
    bool listPresets = false;
    bool printKey = false;
    bool printMargins = false;
};

/// Reads the command line. Nothing after --help or --version, which it answers on standard output.
/// Throws ToolError.
std::optional<Options> parseOptions(int argc, const char* const* argv);

}  // namespace vorelpaint
