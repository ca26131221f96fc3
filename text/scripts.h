#pragma once

#include <cstdint>
#include <vector>

namespace voreltext {

/// The script of each character as HarfBuzz numbers them. Characters of several scripts take that of
/// what is before them, a closing bracket that of its opening one, and those at the beginning that of
/// what follows; without any other they have the script Common.
std::vector<uint32_t> scriptsOf(const std::vector<uint32_t>& codes);

}  // namespace voreltext
