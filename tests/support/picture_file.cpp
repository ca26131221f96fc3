#include "picture_file.h"

#include <algorithm>
#include <cstdlib>

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wconversion"
#pragma GCC diagnostic ignored "-Wshadow"
#pragma GCC diagnostic ignored "-Wmissing-field-initializers"
#pragma GCC diagnostic ignored "-Wunused-function"
#define STBI_ONLY_PNG
#define STB_IMAGE_STATIC
#define STB_IMAGE_WRITE_STATIC
#define STB_IMAGE_IMPLEMENTATION
#define STB_IMAGE_WRITE_IMPLEMENTATION
#include <stb/stb_image.h>
#include <stb/stb_image_write.h>
#pragma GCC diagnostic pop

namespace vorel_test {

using literal::Picture;

Picture readPng(const std::string& path) {
    Picture picture;
    int channels = 0;
    unsigned char* data = stbi_load(path.c_str(), &picture.width, &picture.height, &channels, 4);
    if (data == nullptr) return {};
    picture.bytes.assign(data, data + size_t{4} * static_cast<size_t>(picture.width * picture.height));
    stbi_image_free(data);
    return picture;
}

bool writePng(const std::string& path, const Picture& picture) {
    return stbi_write_png(path.c_str(), picture.width, picture.height, 4, picture.bytes.data(),
                          4 * picture.width) != 0;
}

Picture sideBySide(const Picture& expected, const Picture& actual) {
    Picture all = {3 * expected.width, expected.height, {}};
    const auto rowBytes = static_cast<size_t>(4 * expected.width);
    for (size_t y = 0; y < static_cast<size_t>(expected.height); ++y) {
        const uint8_t* e = expected.bytes.data() + y * rowBytes;
        const uint8_t* a = actual.bytes.data() + y * rowBytes;
        all.bytes.insert(all.bytes.end(), e, e + rowBytes);
        for (size_t i = 0; i < rowBytes; ++i) {
            all.bytes.push_back(i % 4 == 3 ? 255 : static_cast<uint8_t>(std::abs(e[i] - a[i])));
        }
        all.bytes.insert(all.bytes.end(), a, a + rowBytes);
    }
    return all;
}

}  // namespace vorel_test
