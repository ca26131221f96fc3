#pragma once

#include <cstdint>
#include <vector>

namespace voreltext {

/// The characters that are one for the reader: a letter with its marks, a flag.
using Cluster = std::vector<uint32_t>;

/// How a cluster asks to be shown.
enum class Presentation {
    any,      ///< in the font that comes first
    text,     ///< without colours: it says so (U+FE0E)
    picture,  ///< in colours: it says so (U+FE0F), or is a flag or made of several pictographs
};
Presentation presentationOf(const Cluster& cluster);

/// Whether a cluster is a picture where nothing else is asked for, as most emoji are.
bool isPictureByDefault(const Cluster& cluster);

}  // namespace voreltext
