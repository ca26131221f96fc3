#include "style_file.h"

#include <algorithm>
#include <array>

#include "file_io.h"
#include "joined.h"

namespace vorelpaint {
namespace {

namespace fs = std::filesystem;

constexpr size_t kMaxStyleBytes = size_t{1} << 17;

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
    const std::string text = readFile(path.string(), kMaxStyleBytes);
    try {
        Style style = parseStyle(text, path.parent_path());
        style.file = path;
        return style;
    } catch (const StyleError& error) {
        throw ToolError(faultPrefix(path) + error.what());
    }
}

std::string faultPrefix(const fs::path& file) {
    return file.empty() ? "" : "style '" + file.string() + "': ";
}

std::vector<std::string> presetNames() {
    std::vector<std::string> names;
    for (const fs::directory_entry& entry : fs::directory_iterator(presetDir())) {
        if (entry.path().extension() == ".json") names.push_back(entry.path().stem().string());
    }
    std::sort(names.begin(), names.end());
    return names;
}

fs::path findPreset(const std::string& name) {
    const std::vector<std::string> names = presetNames();
    if (std::find(names.begin(), names.end(), name) == names.end()) {
        throw ToolError("no preset '" + name + "'; there are " + joined(names));
    }
    return presetDir() / (name + ".json");
}

}  // namespace vorelpaint
