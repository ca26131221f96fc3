#include "png_writer.h"

#include <libdeflate.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <new>
#include <optional>
#include <string_view>

#include "error.h"

namespace vorelpaint {
namespace {

using Bytes = std::vector<uint8_t>;
using voreltext::Image;

/// Numbers that the format gives to what a sample is.
constexpr uint8_t kRgb = 2;
constexpr uint8_t kIndexed = 3;
constexpr uint8_t kRgba = 6;

/// A pixel as one word, equal where its four channels are.
uint32_t wordAt(const Image& image, size_t pixel) {
    uint32_t word = 0;
    std::memcpy(&word, &image.pixels[pixel * 4], sizeof word);
    return word;
}

bool isOpaque(const Image& image) {
    for (size_t at = 3; at < image.pixels.size(); at += 4) {
        if (image.pixels[at] != 255) return false;
    }
    return true;
}

/// The colours of a picture by the order in which they appear, up to 256.
class Palette {
  public:
    /// The index of a colour, which is added if it is new; nothing when there is no room for it.
    std::optional<uint8_t> indexOf(uint32_t colour) {
        size_t slot = (colour * kSpread) >> (32 - kSlotBits);
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
    static constexpr uint32_t kSpread = 2654435761U;  ///< 2^32 over the golden ratio, as Knuth hashes
    static constexpr uint16_t kEmpty = 0xFFFF;

    std::vector<uint32_t> mColours;
    std::vector<uint16_t> mSlots = std::vector<uint16_t>(size_t{1} << kSlotBits, kEmpty);
};

/// The samples of a picture as they stand in the file, but for the filters.
struct Samples {
    uint8_t kind;
    size_t bytesPerPixel;
    Bytes bytes;  ///< packed rows
    std::vector<uint32_t> palette;
};

std::optional<Samples> indexed(const Image& image) {
    const size_t count = image.pixels.size() / 4;
    Palette palette;
    Samples samples{kIndexed, 1, Bytes(count), {}};
    uint32_t before = ~wordAt(image, 0);
    for (size_t i = 0; i < count; ++i) {
        const uint32_t colour = wordAt(image, i);
        if (colour == before) {
            samples.bytes[i] = samples.bytes[i - 1];
            continue;
        }
        const std::optional<uint8_t> index = palette.indexOf(colour);
        if (!index) return std::nullopt;
        samples.bytes[i] = *index;
        before = colour;
    }
    samples.palette = palette.colours();
    return samples;
}

Samples samplesOf(const Image& image) {
    if (std::optional<Samples> few = indexed(image)) return std::move(*few);
    if (!isOpaque(image)) return {kRgba, 4, image.pixels, {}};
    Samples samples{kRgb, 3, {}, {}};
    samples.bytes.reserve(image.pixels.size() / 4 * 3);
    for (size_t at = 0; at < image.pixels.size(); at += 4)
        samples.bytes.insert(samples.bytes.end(), &image.pixels[at], &image.pixels[at] + 3);
    return samples;
}

// --- filters ------------------------------------------------------------------------------------------

/// The neighbours of a byte: the same channel to the left, above, and to the left of that.
struct Neighbours {
    uint8_t left;
    uint8_t above;
    uint8_t aboveLeft;
};

uint8_t paeth(const Neighbours& at) {
    const int estimate = at.left + at.above - at.aboveLeft;
    const int toLeft = std::abs(estimate - at.left);
    const int toAbove = std::abs(estimate - at.above);
    const int toAboveLeft = std::abs(estimate - at.aboveLeft);
    if (toLeft <= toAbove && toLeft <= toAboveLeft) return at.left;
    return toAbove <= toAboveLeft ? at.above : at.aboveLeft;
}

/// What a filter, by its number in the format, expects a byte to be.
uint8_t expected(int filter, const Neighbours& at) {
    switch (filter) {
        case 1:
            return at.left;
        case 2:
            return at.above;
        case 3:
            return static_cast<uint8_t>((at.left + at.above) / 2);
        case 4:
            return paeth(at);
        default:
            return 0;
    }
}

constexpr int kFilters = 5;

/// Rows with the number of their filter in front.
class Rows {
  public:
    Rows(const uint8_t* samples, size_t rowBytes, size_t bytesPerPixel, size_t count)
        : mSamples(samples), mRowBytes(rowBytes), mBytesPerPixel(bytesPerPixel), mCount(count) {}

    Bytes unfiltered() const {
        Bytes rows;
        rows.reserve((mRowBytes + 1) * mCount);
        for (size_t y = 0; y < mCount; ++y) {
            rows.push_back(0);
            rows.insert(rows.end(), rowAt(y), rowAt(y) + mRowBytes);
        }
        return rows;
    }

    /// Each row in the filter whose bytes, as signed numbers, are smallest in sum: what PNG itself
    /// advises for pictures of many colours.
    Bytes filtered() const {
        Bytes rows;
        rows.reserve((mRowBytes + 1) * mCount);
        for (size_t y = 0; y < mCount; ++y) {
            Bytes best;
            uint64_t least = ~uint64_t{0};
            for (int filter = 0; filter < kFilters; ++filter) {
                Bytes row = filteredRow(y, filter);
                const uint64_t size = sizeOf(row);
                if (size >= least) continue;
                least = size;
                best = std::move(row);
            }
            rows.insert(rows.end(), best.begin(), best.end());
        }
        return rows;
    }

  private:
    const uint8_t* rowAt(size_t y) const { return mSamples + y * mRowBytes; }

    Bytes filteredRow(size_t y, int filter) const {
        Bytes row{static_cast<uint8_t>(filter)};
        row.reserve(mRowBytes + 1);
        for (size_t i = 0; i < mRowBytes; ++i)
            row.push_back(static_cast<uint8_t>(rowAt(y)[i] - expected(filter, neighboursOf(y, i))));
        return row;
    }

    Neighbours neighboursOf(size_t y, size_t i) const {
        const bool hasLeft = i >= mBytesPerPixel;
        const uint8_t* above = y > 0 ? rowAt(y - 1) : nullptr;
        return {hasLeft ? rowAt(y)[i - mBytesPerPixel] : uint8_t{0}, above ? above[i] : uint8_t{0},
                hasLeft && above ? above[i - mBytesPerPixel] : uint8_t{0}};
    }

    static uint64_t sizeOf(const Bytes& row) {
        uint64_t sum = 0;
        for (size_t i = 1; i < row.size(); ++i)
            sum += static_cast<uint64_t>(std::abs(static_cast<int8_t>(row[i])));
        return sum;
    }

    const uint8_t* mSamples;
    size_t mRowBytes;
    size_t mBytesPerPixel;
    size_t mCount;
};

Rows rowsOf(const Samples& samples, const Image& image, int count) {
    return {samples.bytes.data(), static_cast<size_t>(image.width) * samples.bytesPerPixel,
            samples.bytesPerPixel, static_cast<size_t>(count)};
}

// --- compression --------------------------------------------------------------------------------------

/// libdeflate's levels, 1 to 12. At 4, without filters, text pictures take a fifth of the time of
/// libpng's default and five sixths of its bytes (scripts/bench_png.sh).
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

/// Whether filters make a part of the picture smaller. Text with its effects repeats colours, which
/// filters hide from the compressor; photographs do not.
bool isWorthFiltering(const Samples& samples, const Image& image) {
    constexpr int kTried = 24;
    if (samples.kind == kIndexed) return false;
    const int count = std::min(kTried, image.height);
    const int first = (image.height - count) / 2;
    const size_t rowBytes = static_cast<size_t>(image.width) * samples.bytesPerPixel;
    const Rows middle(samples.bytes.data() + static_cast<size_t>(first) * rowBytes, rowBytes,
                      samples.bytesPerPixel, static_cast<size_t>(count));
    return deflated(middle.filtered(), 1).size() < deflated(middle.unfiltered(), 1).size();
}

Bytes compressed(const Samples& samples, const Image& image, PngEffort effort) {
    const Rows rows = rowsOf(samples, image, image.height);
    const int level = levelOf(effort);
    if (effort == PngEffort::fast) return deflated(rows.unfiltered(), level);
    if (effort == PngEffort::normal) {
        return deflated(isWorthFiltering(samples, image) ? rows.filtered() : rows.unfiltered(), level);
    }
    Bytes plain = deflated(rows.unfiltered(), level);
    Bytes filtered = deflated(rows.filtered(), level);
    return filtered.size() < plain.size() ? filtered : plain;
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
    const Samples samples = samplesOf(image);
    const Bytes pixels = compressed(samples, image, effort);
    Bytes file{0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    file.reserve(pixels.size() + 2048);
    appendHeader(file, image, samples.kind);
    if (samples.kind == kIndexed) appendPalette(file, samples.palette);
    appendChunk(file, "IDAT", pixels);
    appendChunk(file, "IEND", {});
    return file;
}

void writePng(std::FILE* file, const Image& image, PngEffort effort) {
    const Bytes bytes = encodedPng(image, effort);
    if (std::fwrite(bytes.data(), 1, bytes.size(), file) != bytes.size()) {
        throw ToolError(std::strerror(errno));
    }
}

}  // namespace vorelpaint
