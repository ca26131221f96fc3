#include "text/picture_scaling.h"

#include <algorithm>

#include "text/units.h"

namespace voreltext {
namespace {

constexpr size_t kChannels = 4;

/// One direction of a picture and of its box, in 64ths of `from`ths of a pixel.
class Axis {
  public:
    Axis(int count, int64_t corner, int64_t origin, const PicturePlace& place)
        : mCount(count),
          mStep(kUnit * place.to),
          mPixel(kUnit * place.from),
          mStart(corner * mStep + origin * place.from) {}

    int64_t pixel() const { return mPixel; }
    int first() const { return static_cast<int>(floorOf(mStart, mPixel)); }
    int last() const { return static_cast<int>(floorOf(mStart + mCount * mStep + mPixel - 1, mPixel)); }

    /// Calls `take(i, length)` for each part of the picture that lies on a pixel of the box.
    template <typename Take>
    void coverOf(int pixel, Take take) const {
        const int64_t begin = pixel * mPixel - mStart;
        const int64_t end = begin + mPixel;
        int64_t i = std::max<int64_t>(0, floorOf(begin, mStep));
        for (; i < mCount && i * mStep < end; ++i) {
            const int64_t length = std::min(end, (i + 1) * mStep) - std::max(begin, i * mStep);
            take(static_cast<size_t>(i), static_cast<uint64_t>(length));
        }
    }

  private:
    int64_t mCount;
    int64_t mStep;   ///< of the picture
    int64_t mPixel;  ///< of the box
    int64_t mStart;  ///< of the picture's first
};

Axis across(const PictureView& picture, const PicturePlace& place) {
    return {picture.width, place.left, place.x, place};
}
Axis down(const PictureView& picture, const PicturePlace& place) {
    return {picture.height, place.top, place.y, place};
}

/// The picture's rows as wide as the box, as sums over the lengths that cover a pixel.
std::vector<uint32_t> sumsOfRows(const PictureView& picture, const Axis& axis) {
    std::vector<uint32_t> sums;
    sums.reserve(static_cast<size_t>(picture.height) * static_cast<size_t>(axis.last() - axis.first()) *
                 kChannels);
    for (int y = 0; y < picture.height; ++y) {
        const uint8_t* row = picture.pixels + y * picture.pitch;
        for (int x = axis.first(); x < axis.last(); ++x) {
            uint64_t sum[kChannels]{};
            axis.coverOf(x, [&](size_t i, uint64_t length) {
                for (size_t channel = 0; channel < kChannels; ++channel)
                    sum[channel] += length * row[i * kChannels + channel];
            });
            for (const uint64_t each : sum)
                sums.push_back(static_cast<uint32_t>(each));
        }
    }
    return sums;
}

}  // namespace

Box boxOf(const PictureView& picture, const PicturePlace& place) {
    const Axis x = across(picture, place);
    const Axis y = down(picture, place);
    return {x.first(), y.first(), x.last(), y.last()};
}

GlyphMask scaledPicture(const PictureView& picture, const PicturePlace& place) {
    const Axis columns = across(picture, place);
    const Axis rows = down(picture, place);
    const std::vector<uint32_t> sums = sumsOfRows(picture, columns);
    GlyphMask mask;
    mask.box = boxOf(picture, place);
    const auto width = static_cast<size_t>(mask.box.width());
    const auto area = static_cast<uint64_t>(columns.pixel() * rows.pixel());
    std::vector<uint64_t> row(width * kChannels);
    for (int y = mask.box.top; y < mask.box.bottom; ++y) {
        std::fill(row.begin(), row.end(), area / 2);
        rows.coverOf(y, [&](size_t i, uint64_t length) {
            const uint32_t* from = sums.data() + i * row.size();
            for (size_t at = 0; at < row.size(); ++at)
                row[at] += length * from[at];
        });
        for (size_t x = 0; x < width; ++x) {
            constexpr size_t kOrder[]{2, 1, 0, 3};  // B, G, R, A become R, G, B, A
            for (const size_t channel : kOrder)
                mask.pixels.push_back(static_cast<uint8_t>(row[x * kChannels + channel] / area));
            mask.coverage.push_back(mask.pixels.back());
        }
    }
    return mask;
}

}  // namespace voreltext
