#include "compose/system/presets.h"

#include <algorithm>

#include "style/error.h"
#include "style/nearest.h"

namespace vorelcompose {

namespace fs = std::filesystem;

using vorelstyle::StyleError;

std::vector<std::string> presetNames(const fs::path& directory) {
    try {
        std::vector<std::string> names;
        for (const fs::directory_entry& entry : fs::directory_iterator(directory)) {
            if (entry.path().extension() == ".json") names.push_back(entry.path().stem().string());
        }
        std::sort(names.begin(), names.end());
        return names;
    } catch (const fs::filesystem_error& error) {
        throw StyleError(error.what());
    }
}

fs::path presetFile(const fs::path& directory, const std::string& name) {
    const std::vector<std::string> names = presetNames(directory);
    if (std::find(names.begin(), names.end(), name) == names.end()) {
        throw StyleError("no preset '" + name + "'" + vorelstyle::choices(name, names, "there are"));
    }
    return directory / (name + ".json");
}

}  // namespace vorelcompose
