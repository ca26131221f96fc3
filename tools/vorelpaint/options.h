#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "background.h"
#include "film_options.h"
#include "png_writer.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// What happens to a text that is larger than its canvas leaves room for.
enum class Fit {
    none,    ///< it is cut off
    shrink,  ///< the font becomes smaller
    wrap,    ///< lines are broken
};

/// What of a text is placed on its canvas, and has the padding around it.
enum class TextBox {
    ink,   ///< the smallest box around the glyphs
    line,  ///< the line boxes: one height for every text of a font, one width for what is written
};

/// One of `count` parts of a batch.
struct Shard {
    int index;  ///< from 1
    int count;
};

/// What is asked for, by the command line or by one job of a batch.
struct Options {
    std::optional<std::string> text;
    std::optional<std::string> textFile;
    bool markup = false;
    std::vector<std::string> fonts{"DejaVu Sans"};  ///< in the order in which they are asked
    std::vector<std::string> features;
    std::vector<voreltext::FontVariation> variations;  ///< of the first font
    int size = 96;
    voreltext::Align align = voreltext::Align::left;
    float lineHeight = 1;
    vorelstyle::Length letterSpacing;

    std::optional<uint32_t> color;
    std::optional<float> opacity;
    float effectScale = 1;
    std::optional<std::string> style;
    std::optional<std::string> preset;
    std::optional<vorelstyle::Style>
        inlineStyle;  ///< only a job can hold one; it goes before the other two

    Background background;
    std::optional<std::string> output;
    PngEffort png = PngEffort::normal;
    voreltext::CanvasRequest canvas{std::nullopt, std::nullopt, voreltext::Anchor::center, 0, 8};
    Fit fit = Fit::none;
    TextBox box = TextBox::ink;

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
    bool strict = false;
    bool version = false;
    bool manual = false;
    std::optional<std::string> completion;
};

/// Reads the command line. Nothing after --help, which it answers on standard output. Throws ToolError.
std::optional<Options> parseOptions(int argc, const char* const* argv);

/// Refuses what is asked of a canvas that has no such side. Throws ToolError.
void checkCanvas(const Options& options);

/// Refuses to print where the picture is written. Throws ToolError.
void checkStandardOutput(const Options& options);

}  // namespace vorelpaint
