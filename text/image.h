#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace voreltext {

/// A colour picture: packed rows of R, G, B, A bytes.
struct Image {
    int width = 0;
    int height = 0;
    std::vector<uint8_t> pixels;
};

}  // namespace voreltext
