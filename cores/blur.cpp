#include "cores/blur.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>

namespace VFontEffect::internal {
namespace {

int64_t roundedUp(int64_t value, int64_t multiple) {
    return (value + multiple - 1) / multiple * multiple;
}

/// Bytes of a row that whole vectors are written to.
int64_t strideFor(int64_t width) {
    return roundedUp(width, kWidestVector);
}

int64_t pixelBytes(const PreparedBlur& blur) {
    return blur.isNarrow ? kNarrowMiddleBytes : 1;
}

PixelBuffer<uint8_t> roomForStrip(const PreparedBlur& blur, int64_t rows) {
    const int64_t groups = (rows + 2 * int64_t{blur.radius}) / kQuad + 2 + 2 * kSpareGroups;
    const int64_t groupBytes = kQuad * blurKernels().vectorBytes * pixelBytes(blur);
    return PixelBuffer<uint8_t>::uninitialised(groupBytes + int64_t{sizeof(int32_t)}, groups);
}

/// In multiples of four, so that what follows cells of a byte is aligned.
int64_t cellsOf(int radius) {
    return roundedUp(kCellsBefore + 2 * int64_t{radius} + 1 + kCellsBehind, 4);
}

void fillTotals(const BlurKernel& kernel, int64_t cells, uint32_t* totals) {
    uint32_t total = 0;
    for (int64_t i = 0; i < cells; ++i) {
        totals[i] = total;
        const int64_t distance = std::abs(i - kCellsBefore - kernel.radius);
        if (distance <= kernel.radius) total += kernel.weights.data()[distance];
    }
}

int64_t quadsOf(int64_t rows) {
    return roundedUp(rows, kQuad) / kQuad;
}

}  // namespace

PixelBuffer<uint8_t> roomForWeights(int radius) {
    return PixelBuffer<uint8_t>::uninitialised(cellsOf(radius),
                                               blurKernels().cellBytes + int64_t{sizeof(uint32_t)});
}

/// The cells, and behind them the totals.
PreparedBlur prepareBlur(const BlurKernel& kernel, PixelBuffer<uint8_t>& room) {
    PreparedBlur blur = {};
    if (!kernel || !room) return blur;
    const BlurKernels& loops = blurKernels();
    const int64_t cells = cellsOf(kernel.radius);
    loops.fillCells(kernel.weights.data(), kernel.radius, room.data());
    auto* const totals = reinterpret_cast<uint32_t*>(room.data() + cells * loops.cellBytes);
    fillTotals(kernel, cells, totals);
    blur.radius = kernel.radius;
    blur.total = kernel.total;
    blur.inverse = inverseAbove(kernel.total);
    blur.cells = room.data() + kCellsBefore * loops.cellBytes;
    blur.totals = totals + kCellsBefore;
    blur.isNarrow = kernel.radius <= kLargestNarrowRadius && kernel.total <= 0xFF;
    if (!blur.isNarrow) return blur;
    for (int k = 0; k <= kernel.radius; ++k)
        blur.weights[k] = static_cast<uint16_t>(kernel.weights.data()[k]);
    blur.division = narrowDivision(kernel.total);
    return blur;
}

MiddleBuffer MiddleBuffer::of(const PreparedBlur& blur, int64_t rows, int64_t inkColumn, int64_t columns,
                              const FullColumns& full) {
    const int64_t strideBytes = (strideFor(columns) + 2 * kWidestVector) * pixelBytes(blur);
    const int64_t inkedStride = strideFor(columns) / blurKernels().vectorBytes;
    MiddleBuffer buffer = {PixelBuffer<uint8_t>::uninitialised(strideBytes, roundedUp(rows, kQuad)),
                           PixelBuffer<uint8_t>::uninitialised(inkedStride, quadsOf(rows)),
                           {}};
    if (!buffer) return buffer;
    buffer.plane = {buffer.pixels.data() + kWidestVector * pixelBytes(blur),
                    strideBytes,
                    columns,
                    inkColumn,
                    full.before,
                    full.from,
                    buffer.inked.data(),
                    inkedStride};
    return buffer;
}

ReachedSource ReachedSource::of(const BlurSource& source, int64_t radius, const Window& window) {
    const Window reach = common(grown(window, radius), {0, 0, source.width, source.height});
    ReachedSource reached = {source, 0, 0};
    if (reach.empty()) {
        reached.part.width = reached.part.height = 0;
        return reached;
    }
    reached.part.start += reach.top * source.stride + reach.left;
    reached.part.width = reach.width();
    reached.part.height = reach.height();
    reached.left = reach.left;
    reached.top = reach.top;
    return reached;
}

// --- Down, then across ------------------------------------------------------------------------------

DownThenAcross::DownThenAcross(const BlurKernel& kernel, const BlurSource& source, const Window& window,
                               const FullColumns& full)
    : mWindow(window),
      mWeights(roomForWeights(kernel.radius)),
      mBlur(prepareBlur(kernel, mWeights)),
      mSource(ReachedSource::of(source, kernel.radius, window)),
      mMiddleLeft(mSource.left),
      mStrip(roomForStrip(mBlur, std::min(kBandRows, window.height()))),
      mMiddle(middleFor(full)),
      mOutStride(strideFor(window.width())),
      mOut(PixelBuffer<uint8_t>::uninitialised(mOutStride, kQuad)) {}

/// The middle plane has the source's columns, and when some of the full ones are in reach all that are.
MiddleBuffer DownThenAcross::middleFor(const FullColumns& full) {
    const int64_t rows = std::min(kBandRows, mWindow.height());
    const Window reach = grown(mWindow, mBlur.radius);
    const int64_t width = mSource.part.width;
    if (full.before <= reach.left && full.from >= reach.right)
        return MiddleBuffer::of(mBlur, rows, 0, width, {0, width});
    const int64_t inkColumn = roundedUp(std::max<int64_t>(0, mMiddleLeft - reach.left), kWidestVector);
    mMiddleLeft -= inkColumn;
    return MiddleBuffer::of(mBlur, rows, inkColumn, reach.right - mMiddleLeft,
                            {full.before - mMiddleLeft, full.from - mMiddleLeft});
}

void DownThenAcross::blurBandDown(int64_t top, int64_t rows) {
    blurKernels().down({&mBlur, mSource.part, top - mSource.top, quadsOf(rows), mStrip.data()},
                       mMiddle.plane);
}

void DownThenAcross::blurQuadAcross(int64_t quad, bool inverted) {
    const BlurEnding ending = {inverted, static_cast<uint8_t>(inverted ? 0xFF : 0)};
    blurKernels().across({&mBlur, mMiddle.plane, quad, mWindow.left - mMiddleLeft,
                          mWindow.right - mMiddleLeft, ending, mOut.data(), mOutStride});
}

// --- Across, then down ------------------------------------------------------------------------------

// 255 minus a mean that is rounded down is the mean of the inverse rounded up. So both passes work on
// what is missing from 255, which is 0 around the source, round up, and the second gives 255 minus its
// result.

AcrossThenDown::AcrossThenDown(const BlurKernel& kernel, const BlurSource& source, const Window& window)
    : mWindow(window),
      mWeights(roomForWeights(kernel.radius)),
      mBlur(prepareBlur(kernel, mWeights)),
      mSource(ReachedSource::of(source, kernel.radius, window)),
      mStrip(roomForStrip(mBlur, std::min(kBandRows, window.height()))),
      mMiddle(MiddleBuffer::of(mBlur, kQuad, 0, mSource.part.width, {0, mSource.part.width})),
      mStride(strideFor(window.width())),
      mAcross(PixelBuffer<uint8_t>::uninitialised(mStride, roundedUp(mSource.part.height, kQuad))),
      mOut(PixelBuffer<uint8_t>::uninitialised(mStride, kBandRows)) {}

void AcrossThenDown::blurAcross() {
    constexpr BlurEnding kUp = {true, 0};
    for (int64_t y = 0; y < mSource.part.height; y += kQuad) {
        blurKernels().copyQuad({&mBlur, mSource.part, y, 1, nullptr}, mMiddle.plane);
        blurKernels().across({&mBlur, mMiddle.plane, 0, mWindow.left - mSource.left,
                              mWindow.right - mSource.left, kUp, mAcross.data() + y * mStride, mStride});
    }
}

void AcrossThenDown::blurBandDown(int64_t top, int64_t rows) {
    constexpr BlurEnding kUpInverted = {true, 0xFF};
    const BlurSource across = {mAcross.data(), mStride, mWindow.width(), mSource.part.height, 0};
    blurKernels().downToBytes({&mBlur, across, top - mSource.top, quadsOf(rows), mStrip.data()},
                              kUpInverted, mOut.data(), mStride);
}

}  // namespace VFontEffect::internal
