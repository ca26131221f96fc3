#pragma once

#include <png.h>
#include <voreleffect/look.h>

#include <vector>

/// An opaque page of one colour, and what is painted on it.
class Page {
  public:
    Page(int width, int height, unsigned int paper) : mWidth(width), mHeight(height) {
        const auto channel = [paper](int shift) { return static_cast<unsigned char>(paper >> shift); };
        for (int pixel = 0; pixel < width * height; ++pixel)
            mPixels.insert(mPixels.end(), {channel(16), channel(8), channel(0), 255});
    }

    VFontEffect::PictureView view() { return {mPixels.data(), mWidth, mHeight}; }
    const std::vector<unsigned char>& pixels() const { return mPixels; }  ///< R, G, B, A, packed rows

    /// Whether it could be written. Opaque pixels are straight ones, too.
    bool writePng(const char* path) const {
        png_image png = {};
        png.version = PNG_IMAGE_VERSION;
        png.width = static_cast<png_uint_32>(mWidth);
        png.height = static_cast<png_uint_32>(mHeight);
        png.format = PNG_FORMAT_RGBA;
        return png_image_write_to_file(&png, path, 0, mPixels.data(), 0, nullptr) != 0;
    }

    friend bool operator==(const Page& a, const Page& b) { return a.mPixels == b.mPixels; }

  private:
    int mWidth;
    int mHeight;
    std::vector<unsigned char> mPixels;
};
