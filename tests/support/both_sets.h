#pragma once

#include <cstdint>
#include <vector>

#include "literal_engine.h"
#include "literal_image.h"
#include "voreleffect/voreleffect.h"

/// One description of a look for the library's effect set and for the literal engine: the add-calls
/// have the same names, only stops and patterns differ in type.
namespace vorel_test {

template <class Set>
struct Kit;

template <>
struct Kit<VFontEffect::VFEffect> {
    VFontEffect::VFGradient stops[3] = {
        {0xFFFFD000U, 1.0F, 0.0F}, {0xFFE02010U, 1.0F, 0.5F}, {0xFF2030C0U, 0.8F, 1.0F}};
    VFontEffect::VFBitmap tile{4, 4, 4};

    Kit() { fillTile(tile.mData); }
    static void fillTile(unsigned char* bytes);
};

template <>
struct Kit<literal::Engine> {
    literal::Stop stops[3] = {
        {0xFFFFD000U, 1.0F, 0.0F}, {0xFFE02010U, 1.0F, 0.5F}, {0xFF2030C0U, 0.8F, 1.0F}};
    literal::Tile tile{4, 4, std::vector<uint8_t>(64)};

    Kit() { Kit<VFontEffect::VFEffect>::fillTile(tile.bytes.data()); }
};

/// A 4 x 4 checker of an opaque and a translucent colour, in A, R, G, B.
inline void Kit<VFontEffect::VFEffect>::fillTile(unsigned char* bytes) {
    const unsigned char pixels[2][4] = {{255, 240, 80, 40}, {160, 40, 80, 240}};
    for (size_t i = 0; i < 16; ++i) {
        for (size_t c = 0; c < 4; ++c)
            bytes[4 * i + c] = pixels[(i % 4 / 2 + i / 8) % 2][c];
    }
}

constexpr uint32_t kInk = 0x3060A0;

/// Where the one glyph of a run stands, and the size of the run.
struct Stage {
    int width;
    int height;
    int glyphX;
    int glyphY;
};

/// A whole run of one glyph in kInk on a transparent destination.
inline literal::Picture paintedRun(VFontEffect::VFEffect& set, const literal::Mask& mask,
                                   const Stage& stage) {
    delete[] set.getMapKey(kInk);
    set.initEffect(stage.width, stage.height);
    VFontEffect::VFBitmap picture(static_cast<unsigned>(stage.width),
                                  static_cast<unsigned>(stage.height), 4);
    set.setDstBitmap(&picture);
    std::vector<uint8_t> coverage = mask.bytes;
    VFontEffect::VFGlyph glyph = {coverage.data(), static_cast<unsigned short>(mask.width),
                                  static_cast<unsigned short>(mask.height)};
    set.renderEffectLayer(stage.glyphX, stage.glyphY, &glyph);
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    const auto bytes = size_t{4} * static_cast<size_t>(stage.width * stage.height);
    return {stage.width, stage.height, {picture.mData, picture.mData + bytes}};
}

inline literal::Picture paintedRun(literal::Engine& set, const literal::Mask& mask, const Stage& stage) {
    set.getMapKey(kInk);
    set.initEffect(stage.width, stage.height);
    const auto bytes = size_t{4} * static_cast<size_t>(stage.width * stage.height);
    literal::Picture picture = {stage.width, stage.height, std::vector<uint8_t>(bytes)};
    set.setDstBitmap(&picture);
    set.renderEffectLayer(stage.glyphX, stage.glyphY, &mask);
    set.doEffectPostProcessing();
    set.compositeLayers(picture);
    return picture;
}

}  // namespace vorel_test
