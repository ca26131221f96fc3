#include "text/rasteriser.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_COLOR_H
#include FT_OUTLINE_H

#include <algorithm>
#include <optional>
#include <string>
#include <vector>

#include "text/colour_layers.h"
#include "text/error.h"
#include "text/picture_scaling.h"
#include "text/units.h"

namespace voreltext {

const int32_t kOutlineFlags = FT_LOAD_NO_HINTING | FT_LOAD_NO_BITMAP;

namespace {

constexpr FT_Int32 kPictureFlags = FT_LOAD_NO_HINTING | FT_LOAD_COLOR;

[[noreturn]] void refuse(const GlyphOrigin& glyph) {
    throw TextError("glyph " + std::to_string(glyph.index) + " cannot be rasterised");
}

/// Leaves the outline in the face's slot, moved by the fraction of a pixel
/// of its origin.
FT_GlyphSlot loadOutline(const Font& font, const GlyphOrigin& glyph) {
    const FT_Face face = font.face();
    if (FT_Load_Glyph(face, glyph.index, kOutlineFlags) != 0 ||
        face->glyph->format != FT_GLYPH_FORMAT_OUTLINE) {
        throw TextError("the font has no outline for glyph " + std::to_string(glyph.index));
    }
    FT_Outline_Translate(&face->glyph->outline, glyph.x & (kUnit - 1), glyph.y & (kUnit - 1));
    return face->glyph;
}

Box outlineBox(const Font& font, const GlyphOrigin& glyph) {
    FT_BBox outline;
    FT_Outline_Get_CBox(&loadOutline(font, glyph)->outline, &outline);
    const int x = floorToPixel(glyph.x);
    const int y = floorToPixel(glyph.y);
    return {x + floorToPixel(outline.xMin), -y - ceilToPixel(outline.yMax),
            x + ceilToPixel(outline.xMax), -y - floorToPixel(outline.yMin)};
}

GlyphMask renderedOutline(const Font& font, const GlyphOrigin& glyph) {
    const FT_GlyphSlot slot = loadOutline(font, glyph);
    if (FT_Render_Glyph(slot, FT_RENDER_MODE_NORMAL) != 0) refuse(glyph);
    const FT_Bitmap& bitmap = slot->bitmap;
    const int left = floorToPixel(glyph.x) + slot->bitmap_left;
    const int top = -floorToPixel(glyph.y) - slot->bitmap_top;
    GlyphMask mask;
    mask.box = {left, top, left + static_cast<int>(bitmap.width), top + static_cast<int>(bitmap.rows)};
    mask.coverage.reserve(size_t{bitmap.width} * bitmap.rows);
    for (unsigned int row = 0; row < bitmap.rows; ++row) {
        const uint8_t* pixels = bitmap.buffer + static_cast<ptrdiff_t>(row) * bitmap.pitch;
        mask.coverage.insert(mask.coverage.end(), pixels, pixels + bitmap.width);
    }
    return mask;
}

struct PlacedPicture {
    PictureView picture;
    PicturePlace place;
};

/// The picture of a glyph, which a slot of FreeType's holds; none where it has none. `flags` are added
/// to FreeType's.
std::optional<PlacedPicture> loadPicture(const Font& font, const GlyphOrigin& glyph, FT_Int32 flags) {
    const FT_Face face = font.pictures();
    if (face == nullptr) return std::nullopt;
    const FT_Error error = FT_Load_Glyph(face, glyph.index, kPictureFlags | flags);
    const FT_GlyphSlot slot = face->glyph;
    if (error != 0 || slot->format != FT_GLYPH_FORMAT_BITMAP || slot->bitmap.width == 0 ||
        slot->bitmap.rows == 0) {
        return std::nullopt;
    }
    if (slot->bitmap.pixel_mode != FT_PIXEL_MODE_BGRA) {
        if (font.hasOutlines()) return std::nullopt;
        refuse(glyph);
    }
    return PlacedPicture{
        {slot->bitmap.buffer, slot->bitmap.pitch, static_cast<int>(slot->bitmap.width),
         static_cast<int>(slot->bitmap.rows)},
        {slot->bitmap_left, -slot->bitmap_top, font.sizePx(), font.picturePpem(), glyph.x, -glyph.y}};
}

/// One of the outlines of a glyph that lie one upon the other.
struct Layer {
    unsigned int index;
    bool isOfText;  ///< in the colour of the text
    LayerColour colour;
};

/// Of a glyph without layers none.
std::vector<Layer> layersOf(const Font& font, unsigned int index) {
    constexpr FT_UInt kColourOfText = 0xFFFF;
    std::vector<Layer> layers;
    FT_Color* colours = nullptr;
    const bool areColours = font.isColour() && FT_Palette_Select(font.face(), 0, &colours) == 0;
    if (!areColours || colours == nullptr) return layers;
    FT_LayerIterator next{};
    Layer layer{};
    FT_UInt colour = 0;
    while (FT_Get_Color_Glyph_Layer(font.face(), index, &layer.index, &colour, &next) != 0) {
        layer.isOfText = colour == kColourOfText;
        const FT_Color entry = layer.isOfText ? FT_Color{0, 0, 0, 255} : colours[colour];
        layer.colour = {entry.red, entry.green, entry.blue, entry.alpha};
        layers.push_back(layer);
    }
    return layers;
}

bool areAPicture(const std::vector<Layer>& layers) {
    return std::any_of(layers.begin(), layers.end(), [](const Layer& layer) { return !layer.isOfText; });
}

Box layersBox(const Font& font, const GlyphOrigin& glyph, const std::vector<Layer>& layers) {
    Box box;
    for (const Layer& layer : layers)
        box.grow(outlineBox(font, {layer.index, glyph.x, glyph.y}));
    return box;
}

GlyphMask renderedLayers(const Font& font, const GlyphOrigin& glyph, const std::vector<Layer>& layers) {
    GlyphMask picture;
    picture.box = layersBox(font, glyph, layers);
    const size_t area =
        static_cast<size_t>(picture.box.width()) * static_cast<size_t>(picture.box.height());
    picture.coverage.resize(area);
    picture.pixels.resize(area * 4);
    for (const Layer& layer : layers)
        layOn(picture, renderedOutline(font, {layer.index, glyph.x, glyph.y}), layer.colour);
    if (!areAPicture(layers)) picture.pixels.clear();
    return picture;
}

}  // namespace

GlyphInk inkOf(const Font& font, const GlyphOrigin& glyph) {
    if (const auto placed = loadPicture(font, glyph, FT_LOAD_BITMAP_METRICS_ONLY)) {
        return {boxOf(placed->picture, placed->place), true};
    }
    if (!font.hasOutlines()) return {{}, false};
    const std::vector<Layer> layers = layersOf(font, glyph.index);
    if (layers.empty()) return {outlineBox(font, glyph), false};
    return {layersBox(font, glyph, layers), areAPicture(layers)};
}

GlyphMask rasterised(const Font& font, const GlyphOrigin& glyph) {
    if (loadPicture(font, glyph, FT_LOAD_BITMAP_METRICS_ONLY)) {
        const auto placed = loadPicture(font, glyph, 0);
        if (!placed) refuse(glyph);
        return scaledPicture(placed->picture, placed->place);
    }
    const std::vector<Layer> layers = layersOf(font, glyph.index);
    return layers.empty() ? renderedOutline(font, glyph) : renderedLayers(font, glyph, layers);
}

}  // namespace voreltext
