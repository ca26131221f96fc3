#include "style_file.h"

#include <array>

#include "compose/system/presets.h"
#include "error.h"
#include "file_io.h"
#include "ranges.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

using vorelstyle::Style;

constexpr const char* kStandardInput = "-";

/// The presets installed with the running program, or else those that it was built beside.
fs::path presetDir() {
    std::error_code error;
    const fs::path program = fs::read_symlink("/proc/self/exe", error);
    const std::array<fs::path, 2> places{
        program.parent_path().parent_path() / "share" / "voreleffect" / "presets",
        fs::path(VOREL_PRESET_DIR)};
    for (const fs::path& place : places) {
        if (fs::is_directory(place, error)) return place;
    }
    throw ToolError("no directory of presets at '" + places[0].string() + "' or '" + places[1].string() +
                    "'");
}

}  // namespace

std::optional<fs::path> chosenStyleFile(const Options& options) {
    if (options.inlineStyle) return std::nullopt;
    if (options.preset) return findPreset(*options.preset);
    return options.style;
}

Style chosenStyle(const Options& options) {
    if (options.inlineStyle) return *options.inlineStyle;
    const std::optional<fs::path> file = chosenStyleFile(options);
    if (!file) return {};
    if (*file != kStandardInput) return loadStyle(*file);
    return vorelstyle::parseStyle(readFileOrInput(kStandardInput, kMaxStyleBytes), kStandardInput);
}

/// One that stands in a job or nowhere is in no file.
FoundStyle chosenStyle(const Options& options, StyleShelf& shelf) {
    const std::optional<fs::path> file = chosenStyleFile(options);
    if (!file || *file == kStandardInput) return foundStyle(chosenStyle(options));
    return shelf.style(*file);
}

LayerSet looksOf(const Options& options, const std::vector<vorelstyle::ColourRange>& colours,
                 const Note& note) {
    const Style style = chosenStyle(options);
    return {options, style, imagesOf(style), options.size, colours, note};
}

std::vector<std::string> presetNames() {
    return vorelcompose::presetNames(presetDir());
}

fs::path findPreset(const std::string& name) {
    return vorelcompose::presetFile(presetDir(), name);
}

}  // namespace vorelpaint
