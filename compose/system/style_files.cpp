#include "compose/system/style_files.h"

#include <memory>
#include <utility>
#include <variant>
#include <vector>

#include "compose/error.h"
#include "compose/limits.h"
#include "compose/system/file_bytes.h"
#include "compose/system/mark_of.h"
#include "compose/system/png_reader.h"

namespace vorelcompose {
namespace {

namespace fs = std::filesystem;

using vorelstyle::Effect;
using vorelstyle::LoadImage;
using vorelstyle::LookStyle;
using vorelstyle::Pattern;
using vorelstyle::PatternImage;
using vorelstyle::Style;
using vorelstyle::StyleError;

std::vector<FileMark> picturesOf(const Style& style) {
    std::vector<FileMark> marks;
    const fs::path directory = fs::path(style.name).parent_path();
    for (const LookStyle& look : style.looks) {
        for (const Effect& effect : look.effects) {
            if (const auto* pattern = std::get_if<Pattern>(&effect))
                marks.push_back(markOf(directory / pattern->image));
        }
    }
    return marks;
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
        } catch (const ComposeError& error) {
            throw StyleError(error.what());
        }
    };
}

FoundStyle foundStyle(Style style) {
    auto kept = std::make_shared<const Style>(std::move(style));
    LoadImage load = imagesOf(*kept);
    return {std::move(kept), std::move(load)};
}

bool StyleShelf::Key::operator==(const Key& other) const {
    return path == other.path && mark == other.mark;
}

FoundStyle StyleShelf::style(const fs::path& path) {
    const Key key{path.string(), markOf(path)};
    std::shared_ptr<const Style> kept = mStyles.find(key);
    if (!kept) {
        kept = std::make_shared<const Style>(loadStyle(path));
        mStyles.keep(key, kept);
    }
    return {kept, imagesOf(*kept), picturesOf(*kept), true};
}

}  // namespace vorelcompose
