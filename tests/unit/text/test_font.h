#pragma once

#include <fstream>
#include <iterator>
#include <string>

namespace vorel_test {

/// The bytes of the font of the tests.
inline std::string testFontBytes() {
    std::ifstream file(VOREL_TEST_FONT, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

}  // namespace vorel_test
