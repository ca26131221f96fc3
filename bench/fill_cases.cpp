#include <cstring>

#include "core_jobs.h"
#include "fill_paint.h"
#include "tests/support/literal_cores.h"

/// Gradients and patterns through their cores, per pixel of the text box.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

constexpr float kAngle = 90.0F;
constexpr float kRampScale = 1.0F;

template <class Core, class Record>
CoreJob::MakeCore gradientFill(float angle) {
    return [angle] {
        std::vector<VFGradient> ramp = rampStops<VFGradient>();
        const auto count = static_cast<int>(ramp.size());
        return coreWith<Core>(Record(angle, kRampScale, 1.0F, count, ramp.data()))();
    };
}

void addFills(Cases& cases, const Workload& workload) {
    addCoreCases(cases, "fill/linear/" + workload.name, workload, 0, linearFill(),
                 [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintLinearGradient(layer, mask, text, kAngle, kRampScale,
                                                  rampStops<literal::Stop>());
                 });
    addCoreCases(cases, "fill/radial/" + workload.name, workload, 0, radialFill(),
                 [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintRadialGradient(layer, mask, text, kRampScale,
                                                  rampStops<literal::Stop>());
                 });
    addCoreCases(cases, "fill/pattern/" + workload.name, workload, 0, patternFill(),
                 [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintPattern(layer, mask, text, 1.0F, kTileScale, kTileSide, kTileSide,
                                           tileBytes());
                 });
}

}  // namespace

CoreJob::MakeCore linearFill() {
    return gradientFill<VFLinearGradient, VFLinearGradientProperty>(kAngle);
}

CoreJob::MakeCore radialFill() {
    return gradientFill<VFRadialGradient, VFRadialGradientProperty>(0.0F);
}

CoreJob::MakeCore patternFill() {
    return [] {
        std::vector<uint8_t> bytes = tileBytes();
        VFBitmap tile(kTileSide, kTileSide, bytes.data(), 4);
        return coreWith<VFPattern>(VFPatternProperty(&tile, kTileScale, 1.0F))();
    };
}

void addFillCases(Cases& cases) {
    addFills(cases, line48());
    addFills(cases, title160());
}

}  // namespace vorel_bench
