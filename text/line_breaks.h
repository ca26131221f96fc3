#pragma once

#include <cstdint>
#include <vector>

namespace voreltext {

/// For each character whether a line may end behind it, by the Unicode line breaking algorithm (UAX
/// #14). The characters have no line end among them; behind the last there is always a break.
///
/// Between two pictographs lines may break. Thai, Lao, Khmer and Burmese, which have no blanks between
/// words, break at zero width spaces (U+200B): there is no dictionary.
std::vector<bool> lineBreaks(const std::vector<uint32_t>& codes);

}  // namespace voreltext
