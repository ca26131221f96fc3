#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "compose/vorelcompose.h"
#include "film_options.h"
#include "png_writer.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

using namespace vorelcompose;  // the words in which a picture is asked for

/// One of `count` parts of a batch.
struct Shard {
    int index;  ///< from 1
    int count;
};

/// What is asked for, by the command line or by one job of a batch.
struct Options : Request {
    std::optional<std::string> text;
    std::optional<std::string> textFile;
    bool markup = false;

    std::optional<std::string> style;
    std::optional<std::string> preset;
    std::optional<vorelstyle::Style>
        inlineStyle;  ///< only a job can hold one; it goes before the other two

    Background background;
    std::optional<std::string> output;
    PngEffort png = PngEffort::normal;

    FilmOptions film;

    std::optional<std::string> batch;
    std::optional<Shard> shard;
    bool skipExisting = false;
    std::optional<int> jobs;  ///< threads; as many as there are cores without
    bool sheet = false;
    std::vector<int> sheetSizes;  ///< empty: the one size
    bool explain = false;
    bool writeCpp = false;
    bool listPresets = false;
    bool printKey = false;
    bool printMargins = false;
    bool report = false;
    bool version = false;
    bool manual = false;
    std::optional<std::string> completion;
};

/// Reads the command line. Nothing after --help, which it answers on standard output. Throws ToolError.
std::optional<Options> parseOptions(int argc, const char* const* argv);

/// Refuses what is asked of a canvas that has no such side, or of the one of a sheet. Throws ToolError
/// or ComposeError.
void checkCanvasOf(const Options& options);

/// Refuses to print where the picture is written. Throws ToolError.
void checkStandardOutput(const Options& options);

}  // namespace vorelpaint
