#include "style/key_text.h"

#include <array>
#include <cstdint>
#include <cstdio>

namespace vorelstyle {
namespace {

constexpr int kOffsetCharacters = 3;
constexpr int kOffsetOrigin = 1 << 20;
constexpr unsigned int kSpanBits = 3;
constexpr unsigned int kUnfilledBit = 4;
constexpr char kPlaceLetter = 'P';

/// Reads the characters behind a fragment's letter. Each carries up to seven bits; its top bit is set,
/// which tells it from a letter.
class FragmentReader {
  public:
    explicit FragmentReader(std::string_view characters) : mRest(characters) {}

    bool atEnd() const { return mRest.empty(); }

    unsigned int small() {
        if (mRest.empty()) return 0;
        const unsigned int value = static_cast<unsigned char>(mRest.front()) & 0x7FU;
        mRest.remove_prefix(1);
        return value;
    }
    unsigned int angle() {
        const unsigned int high = small();
        return high << 7 | small();
    }
    unsigned int nibbles(int count) {
        unsigned int value = 0;
        for (int i = 0; i < count; ++i)
            value = value << 4 | small();
        return value;
    }
    int offset() {
        unsigned int value = 0;
        for (int i = 0; i < kOffsetCharacters; ++i)
            value = value << 7 | small();
        return static_cast<int>(value) - kOffsetOrigin;
    }
    std::string colour() {
        std::array<char, 10> text{};
        std::snprintf(text.data(), text.size(), "#%08X", nibbles(8));
        return text.data();
    }

  private:
    std::string_view mRest;
};

std::string number(const char* name, unsigned int value) {
    return std::string(name) + " " + std::to_string(value);
}

std::string stops(FragmentReader& reader) {
    std::string text;
    while (!reader.atEnd()) {
        text += ", " + reader.colour();
        text += " at " + std::to_string(reader.small()) + "%";
    }
    return text;
}

std::string readFill(FragmentReader& reader) {
    return "colour " + reader.colour();
}

std::string readShadow(FragmentReader& reader) {
    std::string text = number("angle", reader.angle());
    text += number(", distance", reader.small());
    text += number(", size", reader.small());
    return text + ", colour " + reader.colour();
}

std::string readGlow(FragmentReader& reader) {
    std::string text = number("size", reader.small());
    text += ", colour " + reader.colour();
    return text + stops(reader);
}

std::string readGradient(FragmentReader& reader) {
    std::string text = number("angle", reader.angle());
    text += number(", scale", reader.nibbles(2)) + "%";
    return text + stops(reader);
}

std::string readStroke(FragmentReader& reader) {
    std::string text = number("size", reader.small());
    text += ", colour " + reader.colour();
    text += number(", style", reader.small());
    const unsigned int position = reader.small();
    return text + (position == 0 ? ", centred" : position == 1 ? ", outside" : ", inside");
}

std::string readPlace(FragmentReader& reader) {
    const int x = reader.offset();
    const int y = reader.offset();
    std::string text =
        x == 0 && y == 0 ? "not moved" : "moved by " + std::to_string(x) + ", " + std::to_string(y);
    const unsigned int last = reader.small();
    const unsigned int span = last & kSpanBits;
    if (span != 0) text += ", by " + std::string(kSpanNames[span]);
    return text + ((last & kUnfilledBit) != 0 ? ", not filled" : "");
}

struct Layout {
    char letter;
    int type;
    std::string (*read)(FragmentReader& reader);
};

/// The effects that leave a fragment. A pattern leaves none, and bevel and emboss have no core.
constexpr std::array<Layout, 8> kLayouts{{
    {'S', 1, readShadow},
    {'I', 2, readShadow},
    {'G', 3, readGlow},
    {'N', 4, readGlow},
    {'L', 7, readGradient},
    {'D', 8, readGradient},
    {'K', 10, readStroke},
    {'T', 12, readFill},
}};

bool isLetter(char c) {
    return static_cast<unsigned char>(c) < 0x80;
}

KeyFragment readFragment(std::string_view fragment) {
    FragmentReader reader(fragment.substr(1));
    for (const Layout& layout : kLayouts) {
        if (layout.letter == fragment.front()) {
            return {layout.type, layout.letter, effectName(layout.type), layout.read(reader)};
        }
    }
    if (fragment.front() == kPlaceLetter) return {0, kPlaceLetter, "place", readPlace(reader)};
    return {0, fragment.front(), "", ""};
}

void appendOffset(std::string& fragment, int offset) {
    const auto value = static_cast<unsigned int>(offset + kOffsetOrigin);
    for (int shift = 7 * (kOffsetCharacters - 1); shift >= 0; shift -= 7)
        fragment += static_cast<char>(0x80U | (value >> shift & 0x7FU));
}

}  // namespace

bool Place::operator==(const Place& other) const {
    return offsetX == other.offsetX && offsetY == other.offsetY && span == other.span &&
           isFilled == other.isFilled;
}

std::string placeFragment(const Place& place) {
    std::string fragment(1, kPlaceLetter);
    appendOffset(fragment, place.offsetX);
    appendOffset(fragment, place.offsetY);
    const unsigned int fill = place.isFilled ? 0 : kUnfilledBit;
    return fragment + static_cast<char>(0x80U | static_cast<unsigned int>(place.span) | fill);
}

std::vector<KeyFragment> keyFragments(std::string_view key) {
    std::vector<KeyFragment> fragments;
    while (!key.empty()) {
        size_t length = 1;
        while (length < key.size() && !isLetter(key[length]))
            ++length;
        fragments.push_back(readFragment(key.substr(0, length)));
        key.remove_prefix(length);
    }
    return fragments;
}

std::string hexadecimal(std::string_view bytes) {
    constexpr const char* kDigits = "0123456789abcdef";
    std::string text;
    for (const char c : bytes) {
        const auto byte = static_cast<unsigned char>(c);
        text += kDigits[byte >> 4];
        text += kDigits[byte & 15];
    }
    return text;
}

}  // namespace vorelstyle
