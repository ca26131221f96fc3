#pragma once

#include <string>

namespace voreltext {

/// A number as messages show it, with a point in every locale and six digits at most: "0.5", "900".
std::string decimal(double number);

}  // namespace voreltext
