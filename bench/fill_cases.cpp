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

void addFills(Cases& cases, const Workload& workload) {
    std::vector<VFGradient> ramp = rampStops<VFGradient>();
    const auto count = static_cast<int>(ramp.size());
    addCoreCases(
        cases, "fill/linear/" + workload.name, workload, 0,
        [ramp, count]() mutable {
            return coreWith<VFLinearGradient>(
                VFLinearGradientProperty(kAngle, kRampScale, 1.0F, count, ramp.data()))();
        },
        [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
            literal::paintLinearGradient(layer, mask, text, kAngle, kRampScale,
                                         rampStops<literal::Stop>());
        });
    addCoreCases(
        cases, "fill/radial/" + workload.name, workload, 0,
        [ramp, count]() mutable {
            return coreWith<VFRadialGradient>(
                VFRadialGradientProperty(0.0F, kRampScale, 1.0F, count, ramp.data()))();
        },
        [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
            literal::paintRadialGradient(layer, mask, text, kRampScale, rampStops<literal::Stop>());
        });
    addCoreCases(
        cases, "fill/pattern/" + workload.name, workload, 0,
        [] {
            std::vector<uint8_t> bytes = tileBytes();
            VFBitmap tile(kTileSide, kTileSide, bytes.data(), 4);
            return coreWith<VFPattern>(VFPatternProperty(&tile, kTileScale, 1.0F))();
        },
        [](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
            literal::paintPattern(layer, mask, text, 1.0F, kTileScale, kTileSide, kTileSide,
                                  tileBytes());
        });
}

}  // namespace

void addFillCases(Cases& cases) {
    addFills(cases, line48());
    addFills(cases, title160());
}

}  // namespace vorel_bench
