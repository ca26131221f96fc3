#include "compose/system/png_reader.h"

#include <png.h>

#include <memory>
#include <string>

#include "compose/error.h"
#include "compose/limits.h"

namespace vorelcompose {
namespace {

using voreltext::Image;

/// libpng's record of one picture; what it holds is freed with it.
class PngRecord {
  public:
    PngRecord() { mRecord.version = PNG_IMAGE_VERSION; }
    ~PngRecord() { png_image_free(&mRecord); }
    PngRecord(const PngRecord&) = delete;
    PngRecord& operator=(const PngRecord&) = delete;

    png_image* operator->() { return &mRecord; }
    png_image* get() { return &mRecord; }

  private:
    png_image mRecord{};
};

}  // namespace

Image readPng(const std::filesystem::path& path) {
    const std::string name = "'" + path.string() + "'";
    std::error_code ignored;
    if (!std::filesystem::exists(path, ignored)) throw ComposeError(name + " does not exist");
    if (!std::filesystem::is_regular_file(path, ignored)) throw ComposeError(name + " is no file");
    PngRecord png;
    if (png_image_begin_read_from_file(png.get(), path.c_str()) == 0) {
        throw ComposeError(name + " is no readable PNG: " + png->message);
    }
    if (png->width > kMaxPatternSide || png->height > kMaxPatternSide) {
        throw ComposeError(name + " has more than " + std::to_string(kMaxPatternSide) +
                           " pixels on a side");
    }
    png->format = PNG_FORMAT_RGBA;
    Image image{static_cast<int>(png->width), static_cast<int>(png->height), {}};
    image.pixels.resize(PNG_IMAGE_SIZE(*png.get()));
    if (png_image_finish_read(png.get(), nullptr, image.pixels.data(), 0, nullptr) == 0) {
        throw ComposeError(name + " is no readable PNG: " + png->message);
    }
    return image;
}

}  // namespace vorelcompose
