#include "style_file.h"

#include <array>
#include <utility>

#include "error.h"
#include "file_io.h"
#include "png_reader.h"
#include "ranges.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

using vorelstyle::LoadImage;
using vorelstyle::PatternImage;
using vorelstyle::Style;
using vorelstyle::StyleError;

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

Style loadStyle(const fs::path& path) {
    return vorelstyle::parseStyle(readFile(path.string(), kMaxStyleBytes), path.string());
}

LoadImage imagesOf(const Style& style) {
    return [directory = fs::path(style.name).parent_path()](const std::string& image) -> PatternImage {
        try {
            voreltext::Image read = readPng(directory / image);
            return {read.width, read.height, std::move(read.pixels)};
        } catch (const ToolError& error) {
            throw StyleError(error.what());
        }
    };
}

std::vector<std::string> presetNames() {
    return vorelstyle::presetNames(presetDir());
}

fs::path findPreset(const std::string& name) {
    return vorelstyle::presetFile(presetDir(), name);
}

}  // namespace vorelpaint
