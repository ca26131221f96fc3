#include "unit/text/made_font.h"

#include <deque>
#include <map>

namespace vorel_test {
namespace {

/// Big-endian numbers one after the other.
class Table {
  public:
    Table& u8(size_t value) {
        mBytes += static_cast<char>(value & 0xFF);
        return *this;
    }
    Table& u16(size_t value) { return u8(value >> 8).u8(value); }
    Table& u32(size_t value) { return u16(value >> 16).u16(value); }
    Table& i16(int value) { return u16(static_cast<uint16_t>(value)); }
    Table& i8(int value) { return u8(static_cast<uint8_t>(value)); }
    Table& zeros(size_t count) {
        mBytes.append(count, '\0');
        return *this;
    }
    Table& text(const std::string& bytes) {
        mBytes += bytes;
        return *this;
    }
    size_t size() const { return mBytes.size(); }
    const std::string& bytes() const { return mBytes; }

  private:
    std::string mBytes;
};

using Tables = std::map<std::string, std::string>;

uint32_t crcOf(const std::string& bytes) {
    uint32_t crc = 0xFFFFFFFF;
    for (const char byte : bytes) {
        crc ^= static_cast<uint8_t>(byte);
        for (int bit = 0; bit < 8; ++bit)
            crc = crc >> 1 ^ ((crc & 1) != 0 ? 0xEDB88320 : 0);
    }
    return ~crc;
}

uint32_t adlerOf(const std::string& bytes) {
    uint32_t low = 1;
    uint32_t high = 0;
    for (const char byte : bytes) {
        low = (low + static_cast<uint8_t>(byte)) % 65521;
        high = (high + low) % 65521;
    }
    return high << 16 | low;
}

std::string chunk(const std::string& name, const std::string& bytes) {
    return Table().u32(bytes.size()).text(name + bytes).u32(crcOf(name + bytes)).bytes();
}

/// Not compressed.
std::string pngOf(const MadePicture& picture) {
    std::string rows;
    const auto pitch = static_cast<size_t>(picture.width) * 4;
    for (size_t y = 0; y < static_cast<size_t>(picture.height); ++y) {
        rows += '\0';
        rows.append(picture.pixels.begin() + static_cast<ptrdiff_t>(y * pitch),
                    picture.pixels.begin() + static_cast<ptrdiff_t>((y + 1) * pitch));
    }
    Table deflated;
    deflated.u16(0x7801).u8(1);
    for (const size_t length : {rows.size(), ~rows.size()})
        deflated.u8(length).u8(length >> 8);
    deflated.text(rows).u32(adlerOf(rows));
    Table header;
    header.u32(static_cast<size_t>(picture.width)).u32(static_cast<size_t>(picture.height));
    header.u8(8).u8(6).zeros(3);
    return "\x89PNG\r\n\x1A\n" + chunk("IHDR", header.bytes()) + chunk("IDAT", deflated.bytes()) +
           chunk("IEND", "");
}

std::string outlineOf(const std::optional<Rectangle>& box) {
    if (!box) return "";
    Table glyph;
    glyph.i16(1).i16(box->left).i16(box->bottom).i16(box->right).i16(box->top);
    glyph.u16(3).u16(0);
    for (int i = 0; i < 4; ++i)
        glyph.u8(1);
    const int width = box->right - box->left;
    const int height = box->top - box->bottom;
    glyph.i16(box->left).i16(0).i16(width).i16(0);
    glyph.i16(box->bottom).i16(height).i16(0).i16(-height);
    return glyph.bytes();
}

/// With the sign for what is missing before them.
std::vector<MadeGlyph> allOf(const MadeFont& font) {
    const int half = font.unitsPerEm / 2;
    std::vector<MadeGlyph> all{{0, half, Rectangle{0, 0, half, half}}};
    all.insert(all.end(), font.glyphs.begin(), font.glyphs.end());
    return all;
}

void addMetrics(Tables& tables, const MadeFont& font, const std::vector<MadeGlyph>& all) {
    tables["head"] = Table()
                         .u32(0x10000)
                         .u32(0x10000)
                         .u32(0)
                         .u32(0x5F0F3CF5)
                         .u16(0)
                         .i16(font.unitsPerEm)
                         .zeros(16)
                         .i16(0)
                         .i16(font.descender)
                         .i16(font.unitsPerEm)
                         .i16(font.ascender)
                         .u16(0)
                         .u16(1)
                         .i16(2)
                         .i16(1)
                         .i16(0)
                         .bytes();
    tables["hhea"] = Table()
                         .u32(0x10000)
                         .i16(font.ascender)
                         .i16(font.descender)
                         .i16(font.lineGap)
                         .i16(font.unitsPerEm)
                         .zeros(22)
                         .u16(all.size())
                         .bytes();
    tables["maxp"] = Table().u32(0x10000).u16(all.size()).u16(4).u16(1).zeros(22).bytes();
    Table advances;
    for (const MadeGlyph& glyph : all)
        advances.i16(glyph.advance).i16(glyph.outline ? glyph.outline->left : 0);
    tables["hmtx"] = advances.bytes();
}

void addCharacters(Tables& tables, const std::vector<MadeGlyph>& all) {
    std::map<uint32_t, size_t> glyphOf;
    for (size_t i = 1; i < all.size(); ++i) {
        if (all[i].code != 0) glyphOf[all[i].code] = i;
    }
    Table groups;
    for (const auto& [code, glyph] : glyphOf)
        groups.u32(code).u32(code).u32(glyph);
    tables["cmap"] = Table()
                         .u16(0)
                         .u16(1)
                         .u16(3)
                         .u16(10)
                         .u32(12)
                         .u16(12)
                         .u16(0)
                         .u32(16 + groups.size())
                         .u32(0)
                         .u32(glyphOf.size())
                         .text(groups.bytes())
                         .bytes();
    Table names;
    names.u16(0).u16(2).u16(30);
    names.u16(3).u16(1).u16(0x409).u16(1).u16(8).u16(0);
    names.u16(3).u16(1).u16(0x409).u16(2).u16(10).u16(8);
    for (const char letter : std::string("MadePlain"))
        names.u16(static_cast<uint8_t>(letter));
    tables["name"] = names.bytes();
}

void addOutlines(Tables& tables, const std::vector<MadeGlyph>& all) {
    Table places;
    Table outlines;
    for (const MadeGlyph& glyph : all) {
        places.u32(outlines.size());
        outlines.text(outlineOf(glyph.outline));
        outlines.zeros((4 - outlines.size() % 4) % 4);
    }
    tables["loca"] = places.u32(outlines.size()).bytes();
    tables["glyf"] = outlines.zeros(4).bytes();
}

void addLayers(Tables& tables, const MadeFont& font, const std::vector<MadeGlyph>& all) {
    Table bases;
    Table layers;
    size_t count = 0;
    size_t first = 0;
    for (size_t i = 0; i < all.size(); ++i) {
        if (all[i].layers.empty()) continue;
        bases.u16(i).u16(first).u16(all[i].layers.size());
        for (const MadeLayer& layer : all[i].layers)
            layers.u16(layer.glyph).u16(layer.colour);
        first += all[i].layers.size();
        ++count;
    }
    tables["COLR"] = Table()
                         .u16(0)
                         .u16(count)
                         .u32(14)
                         .u32(14 + bases.size())
                         .u16(first)
                         .text(bases.bytes())
                         .text(layers.bytes())
                         .bytes();
    const size_t colours = font.colours.size();
    Table palette;
    palette.u16(0).u16(colours).u16(1).u16(colours).u32(14).u16(0);
    for (const uint32_t colour : font.colours)
        palette.u8(colour >> 8).u8(colour >> 16).u8(colour >> 24).u8(colour);
    tables["CPAL"] = palette.bytes();
}

/// The pictures of a size in CBDT, which follow on `data`; the table of their places.
std::string addBitmapData(Table& data, const MadeFont& font, const std::vector<MadeGlyph>& all,
                          int ppem) {
    Table places;
    places.u16(0).u16(all.size() - 1).u32(8);
    places.u16(1).u16(17).u32(data.size());
    const size_t begin = data.size();
    for (const MadeGlyph& glyph : all) {
        places.u32(data.size() - begin);
        if (!glyph.picture) continue;
        const MadePicture& picture = *glyph.picture;
        const std::string png = pngOf(picture);
        data.i8(picture.height).i8(picture.width).i8(picture.left).i8(picture.top);
        data.i8(glyph.advance * ppem / font.unitsPerEm).u32(png.size()).text(png);
    }
    places.u32(data.size() - begin);
    return places.bytes();
}

/// The same pictures at each size in CBDT, their places in CBLC.
void addBitmaps(Tables& tables, const MadeFont& font, const std::vector<MadeGlyph>& all) {
    Table data;
    data.u32(0x30000);
    Table sizes;
    sizes.u32(0x30000).u32(font.ppems.size());
    Table places;
    for (const int ppem : font.ppems) {
        const std::string table = addBitmapData(data, font, all, ppem);
        sizes.u32(8 + 48 * font.ppems.size() + places.size()).u32(table.size()).u32(1).u32(0);
        places.text(table);
        for (int direction = 0; direction < 2; ++direction) {
            sizes.i8(font.ascender * ppem / font.unitsPerEm).i8(font.descender * ppem / font.unitsPerEm);
            sizes.i8(ppem).zeros(9);
        }
        sizes.u16(0).u16(all.size() - 1).i8(ppem).i8(ppem).u8(32).u8(1);
    }
    tables["CBDT"] = data.bytes();
    tables["CBLC"] = sizes.text(places.bytes()).bytes();
}

/// The first size of pictures in sbix.
void addApplesPictures(Tables& tables, const MadeFont& font, const std::vector<MadeGlyph>& all) {
    Table places;
    Table data;
    const size_t begin = 4 + 4 * (all.size() + 1);
    for (const MadeGlyph& glyph : all) {
        places.u32(begin + data.size());
        if (!glyph.picture) continue;
        data.i16(glyph.picture->left).i16(glyph.picture->top - glyph.picture->height);
        data.text("png ").text(pngOf(*glyph.picture));
    }
    places.u32(begin + data.size());
    tables["sbix"] = Table()
                         .u16(1)
                         .u16(1)
                         .u32(1)
                         .u32(12)
                         .i16(font.ppems.front())
                         .u16(72)
                         .text(places.bytes())
                         .text(data.bytes())
                         .bytes();
}

std::string fileOf(const Tables& tables) {
    Table file;
    file.u32(0x10000).u16(tables.size()).zeros(6);
    size_t place = 12 + 16 * tables.size();
    for (const auto& [name, bytes] : tables) {
        file.text(name).u32(0).u32(place).u32(bytes.size());
        place += (bytes.size() + 3) / 4 * 4;
    }
    for (const auto& [name, bytes] : tables)
        file.text(bytes).zeros((4 - bytes.size() % 4) % 4);
    return file.bytes();
}

}  // namespace

std::string MadeFont::bytes() const {
    const std::vector<MadeGlyph> all = allOf(*this);
    Tables tables;
    addMetrics(tables, *this, all);
    addCharacters(tables, all);
    if (pictures != Pictures::withoutOutlines) addOutlines(tables, all);
    if (!colours.empty()) addLayers(tables, *this, all);
    if (pictures == Pictures::withoutOutlines) addBitmaps(tables, *this, all);
    if (pictures == Pictures::besideOutlines) addApplesPictures(tables, *this, all);
    return fileOf(tables);
}

voreltext::Font openMade(const MadeFont& font, int sizePx) {
    static std::deque<std::string> all;
    all.push_back(font.bytes());
    return {voreltext::FontBytes{reinterpret_cast<const uint8_t*>(all.back().data()), all.back().size()},
            sizePx};
}

MadeFont letters() {
    MadeFont font;
    for (uint32_t code = 'a'; code <= 'z'; ++code)
        font.glyphs.push_back({code, 640, Rectangle{64, 0, 576, 512}});
    for (uint32_t code = 'A'; code <= 'Z'; ++code)
        font.glyphs.push_back({code, 640, Rectangle{64, 0, 576, 768}});
    font.glyphs.push_back({'-', 320, Rectangle{64, 192, 256, 256}});
    font.glyphs.push_back({' ', 320, {}});
    return font;
}

}  // namespace vorel_test
