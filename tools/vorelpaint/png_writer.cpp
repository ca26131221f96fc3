#include "png_writer.h"

#include <libdeflate.h>

#include <algorithm>
#include <array>
#include <cstring>
#include <memory>
#include <new>
#include <optional>
#include <string_view>

#include "png_rows.h"

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;
using voreltext::Image;

/// Numbers that the format gives to what a sample is.
constexpr uint8_t kIndexed = 3;
constexpr std::array<uint8_t, 4> kKinds{0, 4, 2, 6};  ///< of 1 to 4 channels

bool isOpaque(const Image& image) {
    for (size_t at = 3; at < image.pixels.size(); at += 4) {
        if (image.pixels[at] != 255) return false;
    }
    return true;
}

bool isGrey(const Image& image) {
    for (size_t at = 0; at < image.pixels.size(); at += 4) {
        const uint8_t* pixel = &image.pixels[at];
        if (pixel[0] != pixel[1] || pixel[0] != pixel[2]) return false;
    }
    return true;
}

const PngChannels& channelsOf(const Image& image) {
    const bool isWhole = isOpaque(image);
    if (isGrey(image)) return isWhole ? kGrey : kGreyAlpha;
    return isWhole ? kRgb : kRgba;
}

/// The colours of a picture by the order in which they appear, up to 256.
class Palette {
  public:
    /// The index of a colour, which is added if it is new; nothing when there is no room for it.
    std::optional<uint8_t> indexOf(uint32_t colour) {
        size_t slot = spread(colour, kSlotBits);
        for (; mSlots[slot] != kEmpty; slot = (slot + 1) % mSlots.size()) {
            if (mColours[mSlots[slot]] == colour) return static_cast<uint8_t>(mSlots[slot]);
        }
        if (mColours.size() == 256) return std::nullopt;
        mSlots[slot] = static_cast<uint16_t>(mColours.size());
        mColours.push_back(colour);
        return static_cast<uint8_t>(mSlots[slot]);
    }

    const std::vector<uint32_t>& colours() const { return mColours; }

  private:
    static constexpr int kSlotBits = 10;
    static constexpr uint16_t kEmpty = 0xFFFF;

    std::vector<uint32_t> mColours;
    std::vector<uint16_t> mSlots = std::vector<uint16_t>(size_t{1} << kSlotBits, kEmpty);
};

/// A picture of few colours: an index a pixel.
struct IndexedPicture {
    Bytes indices;
    std::vector<uint32_t> palette;
};

std::optional<IndexedPicture> indexed(const Image& image) {
    const size_t count = image.pixels.size() / 4;
    Palette palette;
    IndexedPicture picture{Bytes(count), {}};
    uint32_t before = ~wordAt(image.pixels.data());
    for (size_t i = 0; i < count; ++i) {
        const uint32_t colour = wordAt(&image.pixels[4 * i]);
        if (colour == before) {
            picture.indices[i] = picture.indices[i - 1];
            continue;
        }
        const std::optional<uint8_t> index = palette.indexOf(colour);
        if (!index) return std::nullopt;
        picture.indices[i] = *index;
        before = colour;
    }
    picture.palette = palette.colours();
    return picture;
}

// --- compression --------------------------------------------------------------------------------------

/// libdeflate's levels, 1 to 12. Against 4, level 6 makes titles a few hundredths smaller and takes
/// about a fifth longer; level 3 makes soft glows up to twice as large.
int levelOf(PngEffort effort) {
    constexpr std::array<int, 3> kLevels{1, 4, 12};
    return kLevels[static_cast<size_t>(effort)];
}

struct FreeCompressor {
    void operator()(libdeflate_compressor* compressor) const { libdeflate_free_compressor(compressor); }
};

Bytes deflated(const Bytes& bytes, int level) {
    const std::unique_ptr<libdeflate_compressor, FreeCompressor> compressor(
        libdeflate_alloc_compressor(level));
    if (!compressor) throw std::bad_alloc();
    Bytes result(libdeflate_zlib_compress_bound(compressor.get(), bytes.size()));
    result.resize(libdeflate_zlib_compress(compressor.get(), bytes.data(), bytes.size(), result.data(),
                                           result.size()));
    return result;
}

/// Filters hide from the compressor which indices are the same.
Bytes compressedIndices(const Bytes& indices, const Image& image, PngEffort effort) {
    const auto width = static_cast<size_t>(image.width);
    Bytes rows;
    rows.reserve(indices.size() + static_cast<size_t>(image.height));
    for (size_t at = 0; at < indices.size(); at += width) {
        rows.push_back(0);
        rows.insert(rows.end(), &indices[at], &indices[at] + width);
    }
    return deflated(rows, levelOf(effort));
}

/// The pixels of text and its effects come again, in letters and along edges, and filters hide that from
/// the compressor. Those of photographs are all different, and become smaller by filters.
Bytes compressed(const PngRows& rows, PngEffort effort) {
    if (effort == PngEffort::small) {
        Bytes plain = deflated(unfiltered(rows), levelOf(effort));
        Bytes guessed = deflated(filtered(rows), levelOf(effort));
        return guessed.size() < plain.size() ? guessed : plain;
    }
    const bool isFiltered = effort == PngEffort::normal && isOfNewPixels(rows);
    return deflated(isFiltered ? filtered(rows) : unfiltered(rows), levelOf(effort));
}

PngRows rowsOf(const Image& image) {
    return {image.pixels.data(), static_cast<size_t>(image.width), static_cast<size_t>(image.height),
            channelsOf(image)};
}

// --- the file -----------------------------------------------------------------------------------------

/// With the highest byte first, as all numbers of the format.
void append(Bytes& file, uint32_t number) {
    for (const int shift : {24, 16, 8, 0})
        file.push_back(static_cast<uint8_t>(number >> shift));
}

void appendChunk(Bytes& file, std::string_view name, const Bytes& data) {
    append(file, static_cast<uint32_t>(data.size()));
    const size_t begin = file.size();
    file.insert(file.end(), name.begin(), name.end());
    file.insert(file.end(), data.begin(), data.end());
    append(file, libdeflate_crc32(0, &file[begin], file.size() - begin));
}

void appendHeader(Bytes& file, const Image& image, uint8_t kind) {
    constexpr uint8_t kBitsPerSample = 8;
    Bytes header;
    append(header, static_cast<uint32_t>(image.width));
    append(header, static_cast<uint32_t>(image.height));
    header.insert(header.end(), {kBitsPerSample, kind, 0, 0, 0});
    appendChunk(file, "IHDR", header);
}

void appendPalette(Bytes& file, const std::vector<uint32_t>& palette) {
    Bytes colours;
    Bytes alphas;
    for (const uint32_t colour : palette) {
        std::array<uint8_t, 4> channels{};
        std::memcpy(channels.data(), &colour, channels.size());
        colours.insert(colours.end(), channels.begin(), channels.end() - 1);
        alphas.push_back(channels[3]);
    }
    appendChunk(file, "PLTE", colours);
    // Opaque ones at the end are left out.
    while (!alphas.empty() && alphas.back() == 255)
        alphas.pop_back();
    if (!alphas.empty()) appendChunk(file, "tRNS", alphas);
}

}  // namespace

Bytes encodedPng(const Image& image, PngEffort effort) {
    Bytes file{0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    const PngRows rows = rowsOf(image);
    const bool isByteAPixel = rows.channels.count == 1;
    if (const std::optional<IndexedPicture> few = isByteAPixel ? std::nullopt : indexed(image)) {
        appendHeader(file, image, kIndexed);
        appendPalette(file, few->palette);
        appendChunk(file, "IDAT", compressedIndices(few->indices, image, effort));
    } else {
        appendHeader(file, image, kKinds[rows.channels.count - 1]);
        appendChunk(file, "IDAT", compressed(rows, effort));
    }
    appendChunk(file, "IEND", {});
    return file;
}

}  // namespace vorelpaint
