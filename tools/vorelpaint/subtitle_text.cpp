#include "subtitle_text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <optional>
#include <utility>

#include "style/vorelstyle.h"
#include "trimmed.h"
#include "unicode/utf8.h"

namespace vorelpaint {
namespace {

using vorelstyle::isSameWord;

constexpr const char* kNoBreakSpace = "\xC2\xA0";

/// Without the lines at its ends that are blank.
std::string withoutBlankEnds(const std::string& text) {
    const size_t first = text.find_first_not_of(" \t\n");
    if (first == std::string::npos) return "";
    const size_t feed = text.rfind('\n', first);
    const size_t begin = feed == std::string::npos ? 0 : feed + 1;
    return text.substr(begin, text.find_last_not_of(" \t\n") + 1 - begin);
}

// --- character references ---------------------------------------------------------------------------

constexpr std::array<std::pair<std::string_view, const char*>, 8> kReferences{{{"amp", "&"},
                                                                               {"lt", "<"},
                                                                               {"gt", ">"},
                                                                               {"quot", "\""},
                                                                               {"apos", "'"},
                                                                               {"nbsp", kNoBreakSpace},
                                                                               {"lrm", "\xE2\x80\x8E"},
                                                                               {"rlm", "\xE2\x80\x8F"}}};

/// Of "#65" or "#x41"; nothing for what is no character.
std::optional<std::string> numbered(std::string_view name) {
    const bool isHex = name.size() > 1 && (name[1] == 'x' || name[1] == 'X');
    const std::string_view digits = name.substr(isHex ? 2 : 1);
    uint32_t code = 0;
    const char* end = digits.data() + digits.size();
    const auto [stop, error] = std::from_chars(digits.data(), end, code, isHex ? 16 : 10);
    const bool isSurrogate = code >= 0xD800 && code <= 0xDFFF;
    if (error != std::errc{} || stop != end || code == 0 || code > 0x10FFFF || isSurrogate) {
        return std::nullopt;
    }
    return vorelunicode::encoded(code);
}

/// With the & and the ; of it. Further on none is looked for.
constexpr size_t kLongestReference = 16;

/// The character of the reference whose & stands at `at`, which is moved behind it; nothing when none
/// does.
std::optional<std::string> takeReference(std::string_view written, size_t& at) {
    const size_t length = written.substr(at, kLongestReference).find(';');
    if (length == std::string_view::npos || length == 1) return std::nullopt;
    const size_t end = at + length;
    const std::string_view name = written.substr(at + 1, end - at - 1);
    std::optional<std::string> character;
    if (name.front() == '#') character = numbered(name);
    for (const auto& [known, meant] : kReferences) {
        if (name == known) character = meant;
    }
    if (character) at = end + 1;
    return character;
}

/// The text at `at`, which is moved behind it: a reference, or else one byte.
std::string takeText(std::string_view written, size_t& at) {
    if (written[at] == '&') {
        if (std::optional<std::string> character = takeReference(written, at)) return *character;
    }
    return {written[at++]};
}

std::string withoutReferences(std::string_view written) {
    std::string text;
    for (size_t at = 0; at < written.size();)
        text += takeText(written, at);
    return text;
}

// --- SubRip -----------------------------------------------------------------------------------------

constexpr std::array<std::string_view, 11> kSrtTags{"b",    "i",    "u", "s",    "em", "strong",
                                                    "font", "span", "c", "ruby", "rt"};

/// What the tag at `at` stands for, and `at` behind it; nothing when no known tag stands there.
std::optional<std::string> takeSrtTag(std::string_view written, size_t& at) {
    const size_t end = written.find_first_of("<>", at + 1);
    if (end == std::string_view::npos || written[end] != '>') return std::nullopt;
    std::string_view tag = written.substr(at + 1, end - at - 1);
    if (!tag.empty() && tag.front() == '/') tag.remove_prefix(1);
    const std::string_view name = tag.substr(0, tag.find_first_of(" \t./="));
    const auto isNamed = [&](std::string_view known) { return isSameWord(name, known); };
    const bool isBreak = isNamed("br");
    if (!isBreak && std::none_of(kSrtTags.begin(), kSrtTags.end(), isNamed)) return std::nullopt;
    at = end + 1;
    return isBreak ? "\n" : "";
}

/// Whether one begins at `at`, where `lastEnd` is the place of the last } of the text.
bool isOverrideBlock(std::string_view written, size_t at, size_t lastEnd) {
    return written.substr(at, 2) == "{\\" && lastEnd != std::string_view::npos && at < lastEnd;
}

// --- WebVTT -----------------------------------------------------------------------------------------

/// Notes the classes of a tag, "v.loud.far Fred", and whose voice it is.
void noteNames(std::string_view tag, std::vector<std::string>& names) {
    const size_t space = std::min(tag.find_first_of(" \t\n"), tag.size());
    std::string_view head = tag.substr(0, space);
    std::string voice(tag.substr(space));
    std::replace(voice.begin(), voice.end(), '\n', ' ');
    const std::string_view name = head.substr(0, head.find('.'));
    for (size_t dot = head.find('.'); dot != std::string_view::npos; dot = head.find('.')) {
        head.remove_prefix(dot + 1);
        names.emplace_back(head.substr(0, head.find('.')));
    }
    if (name == "v") names.push_back(withoutReferences(trimmed(voice)));
}

// --- ASS --------------------------------------------------------------------------------------------

/// Whether what follows an override block is a drawing: the last \p with a number in it says so.
bool startsDrawing(std::string_view block, bool before) {
    for (size_t at = 0; (at = block.find("\\p", at)) != std::string_view::npos;) {
        at += 2;
        if (at < block.size() && block[at] >= '0' && block[at] <= '9') before = block[at] != '0';
    }
    return before;
}

/// What an escape stands for; nothing when there is none at `at`.
std::optional<const char*> escapeAt(std::string_view written, size_t at) {
    const std::string_view escape = written.substr(at, 2);
    if (escape == "\\N") return "\n";
    if (escape == "\\n") return " ";
    if (escape == "\\h") return kNoBreakSpace;
    return std::nullopt;
}

}  // namespace

std::string textOfSrt(std::string_view written) {
    const size_t lastEnd = written.rfind('}');
    std::string text;
    for (size_t at = 0; at < written.size();) {
        const std::optional<std::string> tag =
            written[at] == '<' ? takeSrtTag(written, at) : std::nullopt;
        if (tag) {
            text += *tag;
        } else if (isOverrideBlock(written, at, lastEnd)) {
            at = written.find('}', at) + 1;
        } else {
            text += takeText(written, at);
        }
    }
    return withoutBlankEnds(text);
}

VttText textOfVtt(std::string_view written) {
    VttText plain;
    for (size_t at = 0; at < written.size();) {
        if (written[at] != '<') {
            plain.text += takeText(written, at);
            continue;
        }
        const size_t end = std::min(written.find('>', at), written.size());
        noteNames(written.substr(at + 1, end - at - 1), plain.names);
        at = std::min(end + 1, written.size());
    }
    plain.text = withoutBlankEnds(plain.text);
    return plain;
}

std::string textOfAss(std::string_view written) {
    const size_t lastEnd = written.rfind('}');
    std::string text;
    bool isDrawing = false;
    for (size_t at = 0; at < written.size();) {
        if (written[at] == '{' && lastEnd != std::string_view::npos && at < lastEnd) {
            const size_t end = written.find('}', at);
            isDrawing = startsDrawing(written.substr(at, end - at), isDrawing);
            at = end + 1;
            continue;
        }
        const std::optional<const char*> escape = escapeAt(written, at);
        if (!isDrawing) text += escape ? *escape : std::string(1, written[at]);
        at += escape ? 2 : 1;
    }
    return withoutBlankEnds(text);
}

}  // namespace vorelpaint
