#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "style/style.h"

namespace vorelstyle {

/// One effect's part of a cache key, or the place of the look whose effects follow.
struct KeyFragment {
    int type;               ///< of the effect, as VFEffect.h numbers them; 0 for a place
    char letter;            ///< that it begins with
    std::string_view name;  ///< of the effect in a style file, or "place"; empty for an unknown letter
    std::string meaning;    ///< "size 2, colour #FF000000, style 0, outside"; "moved by 3, -2, by word"
};

/// The fragments of a key that VFEffect::getMapKey or Stack::key returned, in their order.
std::vector<KeyFragment> keyFragments(std::string_view key);

/// How a look stands in a stack.
struct Place {
    int offsetX = 0;  ///< in pixels, to the right: -kMaxOffset to kMaxOffset
    int offsetY = 0;  ///< downwards
    Span span = Span::block;
    bool isFilled = true;

    bool operator==(const Place& other) const;
    bool operator!=(const Place& other) const { return !(*this == other); }
};

/// The fragment of a key that tells the place: 'P', a letter that no effect has, and seven characters
/// of seven bits with the top bit set. Offsets are 21 bits each, the higher ones first, from -2^20 on;
/// the last character is the number of the span, plus 4 for a look that is not filled.
std::string placeFragment(const Place& place);

/// Bytes in hexadecimal: "54808f".
std::string hexadecimal(std::string_view bytes);

}  // namespace vorelstyle
