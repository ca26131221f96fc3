#pragma once

#include <string_view>
#include <vector>

#include "style/json_object.h"
#include "style/style.h"

namespace vorelstyle {

/// The keys of effects in a look.
std::vector<std::string_view> effectNames();
bool isEffect(std::string_view name);

/// Reads the effect of this name, which the look has. Throws StyleError.
Effect readEffect(const JsonObject& look, std::string_view name, int version);

/// Refuses a key that the first version of the format has not.
void requireVersion2(const JsonObject& object, std::string_view key, int version);

}  // namespace vorelstyle
