#include "wrap.h"

#include <algorithm>

namespace vorelpaint {

std::string wrapped(std::string_view text, size_t width, size_t indent) {
    const std::string margin(indent, ' ');
    std::string lines;
    size_t used = 0;  // bytes of the last line; 0 before the first
    while (!text.empty()) {
        const std::string_view word = text.substr(0, text.find(' '));
        text.remove_prefix(std::min(text.size(), word.size() + 1));
        if (word.empty()) continue;
        if (used != 0 && used + 1 + word.size() <= width) {
            lines.append(" ").append(word);
            used += 1 + word.size();
        } else {
            lines.append(used == 0 ? "" : "\n").append(margin).append(word);
            used = indent + word.size();
        }
    }
    return lines;
}

}  // namespace vorelpaint
