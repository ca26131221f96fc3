#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace vorelstyle {

/// Reads "#RRGGBB", or "#RGB" for "#RRGGBB" of twice the same digits, as 0xRRGGBB; nothing for any other
/// spelling.
std::optional<uint32_t> parseColour(std::string_view text);

}  // namespace vorelstyle
