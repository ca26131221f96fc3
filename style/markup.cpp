#include "style/markup.h"

#include <algorithm>
#include <array>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "style/colour.h"
#include "style/error.h"
#include "unicode/lines.h"
#include "unicode/utf8.h"

namespace vorelstyle {
namespace {

struct Entity {
    std::string_view name;
    char character;
};
constexpr std::array<Entity, 3> kEntities{{{"&lt;", '<'}, {"&gt;", '>'}, {"&amp;", '&'}}};

constexpr std::string_view kClosing = "</c>";
constexpr std::string_view kOpening = "<c ";
constexpr size_t kLongestTag = 32;

class MarkupReader {
  public:
    explicit MarkupReader(const std::vector<uint32_t>& source) : mSource(source) {}

    MarkedText read() {
        while (mAt < mSource.size())
            readNext();
        if (!mOpen.empty()) fail(mOpen.back().at, "the tag does not close; </c> is missing");
        return std::move(mMarked);
    }

  private:
    struct OpenTag {
        size_t at;  ///< in the source
        uint32_t colour;
    };

    void readNext() {
        if (mSource[mAt] == '<') {
            readTag();
        } else if (mSource[mAt] == '&') {
            readEntity();
        } else {
            readCharacter();
        }
    }

    void readCharacter() {
        const uint32_t code = mSource[mAt];
        const bool isAllowed =
            !vorelunicode::isControl(code) || code == '\t' || vorelunicode::endsLine(code);
        if (!isAllowed) fail(mAt, "the control character " + vorelunicode::nameOf(code));
        add(code);
        ++mAt;
    }

    void readTag() {
        if (startsWith(kClosing)) {
            if (mOpen.empty()) fail(mAt, "</c> closes nothing");
            mOpen.pop_back();
            mAt += kClosing.size();
        } else if (startsWith(kOpening)) {
            readOpening();
        } else {
            fail(mAt, "< begins no tag; tags are <c #RRGGBB> and </c>, and < itself is written &lt;");
        }
    }

    void readOpening() {
        const std::optional<std::string> tag = tagHere();
        const auto colour = tag ? parseColour(colourIn(*tag)) : std::nullopt;
        if (!colour) fail(mAt, "the tag has no colour; write <c #RRGGBB> or <c #RGB>");
        mOpen.push_back({mAt, *colour});
        mAt += tag->size() + 1;
    }

    void readEntity() {
        for (const Entity& entity : kEntities) {
            if (!startsWith(entity.name)) continue;
            add(static_cast<unsigned char>(entity.character));
            mAt += entity.name.size();
            return;
        }
        fail(mAt, "& begins neither &lt; nor &gt; nor &amp;; & itself is written &amp;");
    }

    /// Adds a character, which is written here, to the text.
    void add(uint32_t code) {
        const size_t at = mMarked.text.size();
        mMarked.text.push_back(code);
        mMarked.places.push_back(mAt);
        if (mOpen.empty()) return;
        const uint32_t colour = mOpen.back().colour;
        std::vector<ColourRange>& ranges = mMarked.colours;
        if (!ranges.empty() && ranges.back().end == at && ranges.back().colour == colour) {
            ranges.back().end = at + 1;
        } else {
            ranges.push_back({at, at + 1, colour});
        }
    }

    bool startsWith(std::string_view word) const {
        return mSource.size() - mAt >= word.size() &&
               std::equal(word.begin(), word.end(), mSource.begin() + static_cast<std::ptrdiff_t>(mAt),
                          [](char c, uint32_t code) { return static_cast<unsigned char>(c) == code; });
    }

    /// The characters from here to the next '>', without it; nothing where that is far or not ASCII.
    std::optional<std::string> tagHere() const {
        std::string tag;
        for (size_t i = mAt; i < mSource.size() && tag.size() < kLongestTag; ++i) {
            if (mSource[i] == '>') return tag;
            if (mSource[i] >= 0x80) break;
            tag += static_cast<char>(mSource[i]);
        }
        return std::nullopt;
    }

    /// What stands between the blanks of a tag that opens.
    static std::string_view colourIn(std::string_view tag) {
        tag.remove_prefix(kOpening.size());
        tag.remove_prefix(std::min(tag.find_first_not_of(' '), tag.size()));
        return tag.substr(0, tag.find_last_not_of(' ') + 1);
    }

    [[noreturn]] void fail(size_t at, const std::string& fault) const {
        throw StyleError("markup, " + vorelunicode::placeName(mSource, at) + ": " + fault);
    }

    const std::vector<uint32_t>& mSource;
    size_t mAt = 0;
    std::vector<OpenTag> mOpen;
    MarkedText mMarked;
};

}  // namespace

MarkedText parseMarkup(const std::vector<uint32_t>& text) {
    return MarkupReader(text).read();
}

}  // namespace vorelstyle
