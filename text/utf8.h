#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

namespace voreltext {

/// The code points of `text`. Throws TextError, naming the byte, where it is not well-formed UTF-8.
std::vector<uint32_t> decodeUtf8(std::string_view text);

}  // namespace voreltext
