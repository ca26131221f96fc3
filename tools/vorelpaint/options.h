#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "background.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// What is asked for, by the command line or by one job of a batch.
struct Options {
    std::optional<std::string> text;
    std::optional<std::string> textFile;
    std::string font = "DejaVu Sans";
    int size = 96;
    voreltext::Align align = voreltext::Align::left;
    std::optional<uint32_t> color;
    std::optional<float> opacity;
    float effectScale = 1;
    std::optional<std::string> style;
    std::optional<std::string> preset;
    std::optional<vorelstyle::Style>
        inlineStyle;  ///< only a job can hold one; it goes before the other two
    Background background;
    std::optional<std::string> output;
    int padding = 8;
    std::optional<std::string> batch;
    bool sheet = false;
    bool explain = false;
    bool writeCpp = false;
    bool listPresets = false;
    bool printKey = false;
    bool printMargins = false;
    bool version = false;
    bool manual = false;
    std::optional<std::string> completion;
};

/// Reads the command line. Nothing after --help, which it answers on standard output. Throws ToolError.
std::optional<Options> parseOptions(int argc, const char* const* argv);

}  // namespace vorelpaint
