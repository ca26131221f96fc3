#include "core_jobs.h"

#include <algorithm>
#include <cstring>
#include <utility>

namespace vorel_bench {

using namespace VFontEffect;

namespace {

constexpr int kSpare = 2;

VFBitmap emptyLayer(const Workload& workload, int margin, unsigned int bytesPerPixel) {
    return {static_cast<unsigned int>(workload.width + 2 * margin),
            static_cast<unsigned int>(workload.height + 2 * margin), bytesPerPixel};
}

}  // namespace

literal::Box boxOf(const Workload& workload, int margin) {
    return {margin, margin, margin + workload.width, margin + workload.height};
}

literal::Mask layerMask(const Workload& workload, int margin) {
    literal::Mask mask = {workload.width + 2 * margin, workload.height + 2 * margin, {}};
    mask.bytes.resize(static_cast<size_t>(mask.width) * static_cast<size_t>(mask.height));
    for (int y = 0; y < workload.height; ++y) {
        std::copy_n(workload.mask.begin() + std::ptrdiff_t{y} * workload.width, workload.width,
                    mask.bytes.begin() + std::ptrdiff_t{margin + y} * mask.width + margin);
    }
    return mask;
}

CoreJob::CoreJob(const Workload* workload, int margin, const MakeCore& makeCore)
    : mMask(emptyLayer(*workload, margin, 1)),
      mLayer(emptyLayer(*workload, margin, 4)),
      mText(margin, margin, margin + workload->width, margin + workload->height),
      mParams{&mLayer, &mMask, &mText, 0, nullptr},
      mCore(makeCore()) {
    const literal::Mask mask = layerMask(*workload, margin);
    std::memcpy(mMask.mData, mask.bytes.data(), mask.bytes.size());
}

void CoreJob::reset() {
    std::memset(mLayer.mData, 0, painted().size);
}

Bytes CoreJob::painted() const {
    return {mLayer.mData, size_t{mLayer.mWidth} * mLayer.mHeight * 4};
}

LiteralCoreJob::LiteralCoreJob(const Workload* workload, int margin, Paint paint)
    : mMask(layerMask(*workload, margin)),
      mLayer{mMask.width, mMask.height, std::vector<uint8_t>(mMask.bytes.size() * 4)},
      mText(boxOf(*workload, margin)),
      mPaint(std::move(paint)) {}

void LiteralCoreJob::reset() {
    std::fill(mLayer.bytes.begin(), mLayer.bytes.end(), uint8_t{0});
}

void addCoreCases(Cases& cases, const std::string& row, const Workload& workload, int reach,
                  const CoreJob::MakeCore& makeCore, const LiteralCoreJob::Paint& paintLiterally) {
    const int margin = reach + kSpare;
    const int64_t pixels = workload.grownPixels(reach);
    cases.push_back(caseOf<CoreJob>(row, kOurs, pixels, &workload, margin, makeCore));
    cases.push_back(caseOf<LiteralCoreJob>(row, kLiteral, pixels, &workload, margin, paintLiterally));
    cases.push_back(copyCase(row, pixels, 4 * pixels));
}

}  // namespace vorel_bench
