#pragma once

#include <voreleffect/VFBitmap.h>

#include <cstddef>
#include <cstdint>
#include <vector>

namespace vorel_test {

inline std::vector<uint8_t> bytesOf(const VFontEffect::VFBitmap& bitmap) {
    if (bitmap.mData == nullptr) return {};
    const size_t count = size_t{bitmap.mWidth} * bitmap.mHeight * bitmap.mBytesPerPixel;
    return {bitmap.mData, bitmap.mData + count};
}

}  // namespace vorel_test
