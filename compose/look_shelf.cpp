#include "compose/look_shelf.h"

#include <algorithm>
#include <tuple>

namespace vorelcompose {
namespace {

using vorelstyle::ColourRange;

bool areSame(const std::vector<ColourRange>& ones, const std::vector<ColourRange>& others) {
    const auto tied = [](const ColourRange& range) {
        return std::tie(range.begin, range.end, range.colour);
    };
    return std::equal(
        ones.begin(), ones.end(), others.begin(), others.end(),
        [&](const ColourRange& one, const ColourRange& other) { return tied(one) == tied(other); });
}

}  // namespace

bool LookShelf::LooksKey::operator==(const LooksKey& other) const {
    const auto tied = [](const LooksKey& key) {
        return std::tie(key.style, key.pictures, key.size, key.effectScale, key.color, key.opacity);
    };
    return tied(*this) == tied(other) && areSame(colours, other.colours);
}

std::shared_ptr<const LayerSet> LookShelf::looks(const Request& request, const FoundStyle& found,
                                                 int size, const std::vector<ColourRange>& colours,
                                                 const Note& note) {
    const LooksKey key{found.style,   found.pictures,  size,   request.effectScale,
                       request.color, request.opacity, colours};
    std::shared_ptr<const NotedLooks> noted = found.isKept ? mLooks.find(key) : nullptr;
    if (!noted) {
        auto made = std::make_shared<NotedLooks>();
        made->looks.emplace(request, *found.style, found.load, size, colours, made->notes.taker());
        if (found.isKept) mLooks.keep(key, made, made->looks->pictureBytes());
        noted = made;
    }
    noted->notes.giveTo(note);
    return {noted, &*noted->looks};
}

}  // namespace vorelcompose
