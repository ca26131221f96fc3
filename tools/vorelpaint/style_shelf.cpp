#include "style_shelf.h"

#include <algorithm>
#include <filesystem>
#include <tuple>
#include <utility>
#include <variant>

#include "style_file.h"

namespace vorelpaint {
namespace {

using vorelstyle::ColourRange;
using vorelstyle::Effect;
using vorelstyle::LookStyle;
using vorelstyle::Pattern;
using vorelstyle::Style;

std::vector<FileMark> picturesOf(const Style& style) {
    std::vector<FileMark> marks;
    const std::filesystem::path directory = std::filesystem::path(style.name).parent_path();
    for (const LookStyle& look : style.looks) {
        for (const Effect& effect : look.effects) {
            if (const auto* pattern = std::get_if<Pattern>(&effect))
                marks.push_back(markOf(directory / pattern->image));
        }
    }
    return marks;
}

bool areSame(const std::vector<ColourRange>& ones, const std::vector<ColourRange>& others) {
    const auto tied = [](const ColourRange& range) {
        return std::tie(range.begin, range.end, range.colour);
    };
    return std::equal(
        ones.begin(), ones.end(), others.begin(), others.end(),
        [&](const ColourRange& one, const ColourRange& other) { return tied(one) == tied(other); });
}

}  // namespace

bool StyleShelf::StyleKey::operator==(const StyleKey& other) const {
    return path == other.path && mark == other.mark;
}

bool StyleShelf::LooksKey::operator==(const LooksKey& other) const {
    const auto tied = [](const LooksKey& key) {
        return std::tie(key.style, key.pictures, key.size, key.effectScale, key.color, key.opacity);
    };
    return tied(*this) == tied(other) && areSame(colours, other.colours);
}

std::shared_ptr<const LayerSet> StyleShelf::looks(const Options& options, int size,
                                                  const std::vector<ColourRange>& colours,
                                                  const Note& note) {
    const auto [chosen, isKept] = style(options);
    const LooksKey key{chosen,        picturesOf(*chosen), size,   options.effectScale,
                       options.color, options.opacity,     colours};
    std::shared_ptr<const NotedLooks> noted = isKept ? mLooks.find(key) : nullptr;
    if (!noted) {
        auto made = std::make_shared<NotedLooks>();
        made->looks.emplace(options, *chosen, size, colours, made->notes.taker());
        if (isKept) mLooks.keep(key, made, made->looks->pictureBytes());
        noted = made;
    }
    noted->notes.giveTo(note);
    return {noted, &*noted->looks};
}

/// One that stands in a job or nowhere is in no file.
StyleShelf::ChosenStyle StyleShelf::style(const Options& options) {
    const std::optional<std::filesystem::path> path = chosenStyleFile(options);
    if (!path || *path == "-") return {std::make_shared<const Style>(chosenStyle(options)), false};
    const StyleKey key{path->string(), markOf(*path)};
    std::shared_ptr<const Style> kept = mStyles.find(key);
    if (kept) return {kept, true};
    kept = std::make_shared<const Style>(loadStyle(*path));
    mStyles.keep(key, kept);
    return {kept, true};
}

}  // namespace vorelpaint
