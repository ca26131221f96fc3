#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

namespace vorelstyle {

/// Reads "#RRGGBB" as 0xRRGGBB; nothing for any other spelling.
std::optional<uint32_t> parseColour(std::string_view text);

}  // namespace vorelstyle
