#include <cstring>

#include "whole_looks.h"

/// What a host loads and unloads: a plugin, and with it the library.

/// Paints every look once, into pictures one behind another.
extern "C" VF_API void paintWholeLooks(unsigned char* pixels) {
    using namespace vorel_test;
    for (const WholeLook look : kWholeLooks) {
        const literal::Picture picture = paintedWhole<VFontEffect::VFEffect>(look);
        std::memcpy(pixels, picture.bytes.data(), picture.bytes.size());
        pixels += picture.bytes.size();
    }
}
