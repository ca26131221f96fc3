#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace vorelstyle {

/// One effect's part of a cache key.
struct KeyFragment {
    int type;             ///< of the effect, as VFEffect.h numbers them
    char letter;          ///< that it begins with
    std::string meaning;  ///< "size 2, colour #FF000000, style 0, outside"
};

/// The fragments of a key that VFEffect::getMapKey returned, in their order.
std::vector<KeyFragment> keyFragments(std::string_view key);

/// Bytes in hexadecimal: "54808f".
std::string hexadecimal(std::string_view bytes);

}  // namespace vorelstyle
