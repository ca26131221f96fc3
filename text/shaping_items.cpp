#include "text/shaping_items.h"

#include <fribidi.h>

#include <algorithm>

namespace voreltext {
namespace {

/// The levels as the line shows them: what shows nothing at its end has the line's own direction.
std::vector<int8_t> levelsOf(const ShapingRun& run) {
    std::vector<int8_t> levels(run.levels, run.levels + run.length);
    const int8_t own = run.isRightToLeft ? 1 : 0;
    for (size_t i = run.length; i-- > 0;) {
        if (!FRIBIDI_IS_EXPLICIT_OR_BN_OR_WS(fribidi_get_bidi_type(run.codes[i]))) break;
        levels[i] = own;
    }
    return levels;
}

/// In the order of the text.
std::vector<ShapingItem> logicalItems(const ShapingRun& run, const std::vector<int8_t>& levels) {
    std::vector<ShapingItem> items;
    for (size_t i = 0; i < run.length; ++i) {
        const bool isSame = i > 0 && levels[i] == levels[i - 1] && run.fonts[i] == run.fonts[i - 1] &&
                            run.scripts[i] == run.scripts[i - 1];
        if (!isSame) items.push_back({i, i, run.fonts[i], run.scripts[i], levels[i] % 2 != 0});
        items.back().end = i + 1;
    }
    return items;
}

}  // namespace

std::vector<ShapingItem> itemsOf(const ShapingRun& run) {
    const std::vector<int8_t> levels = levelsOf(run);
    std::vector<ShapingItem> items = logicalItems(run, levels);
    const int8_t highest = levels.empty() ? int8_t{0} : *std::max_element(levels.begin(), levels.end());
    for (int8_t level = highest; level > 0; --level) {
        const auto isWithin = [&](const ShapingItem& item) { return levels[item.begin] >= level; };
        for (auto end = items.begin(); end != items.end();) {
            const auto begin = std::find_if(end, items.end(), isWithin);
            end = std::find_if_not(begin, items.end(), isWithin);
            std::reverse(begin, end);
        }
    }
    return items;
}

}  // namespace voreltext
