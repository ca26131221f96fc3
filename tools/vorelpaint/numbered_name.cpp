#include "numbered_name.h"

#include <algorithm>

namespace vorelpaint {
namespace {

/// The digits that "%d" or "%05d" at `at` asks for, `at` behind it; nothing when neither stands there.
std::optional<size_t> takeNumber(const std::string& text, size_t& at) {
    size_t digits = 0;
    size_t next = at + 1;
    if (next + 1 < text.size() && text[next] == '0' && text[next + 1] >= '1' && text[next + 1] <= '9') {
        digits = static_cast<size_t>(text[next + 1] - '0');
        next += 2;
    }
    if (next >= text.size() || text[next] != 'd') return std::nullopt;
    at = next + 1;
    return digits;
}

}  // namespace

std::optional<NumberedName> NumberedName::parse(const std::string& path) {
    NumberedName name;
    size_t at = path.rfind('/') + 1;  // npos + 1 is 0
    name.mBefore = path.substr(0, at);
    std::string* part = &name.mBefore;
    while (at < path.size()) {
        if (path[at] != '%' || path.compare(at, 2, "%%") == 0) {
            *part += path[at];
            at += path[at] == '%' ? 2 : 1;
            continue;
        }
        const std::optional<size_t> digits = takeNumber(path, at);
        if (!digits || part == &name.mBehind) return std::nullopt;
        name.mDigits = *digits;
        part = &name.mBehind;
    }
    if (part == &name.mBefore) return std::nullopt;
    return name;
}

std::string NumberedName::with(int64_t number) const {
    const std::string digits = std::to_string(number);
    const std::string zeros(mDigits - std::min(mDigits, digits.size()), '0');
    return mBefore + zeros + digits + mBehind;
}

}  // namespace vorelpaint
