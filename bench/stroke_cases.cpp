#include "core_jobs.h"
#include "tests/support/literal_cores.h"

/// Outlines through the stroke core: disc, dilation and blend together.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

constexpr uint32_t kInk = 0xFF3060A0U;

struct Position {
    const char* name;
    int number;
    int sizePerRadius;  ///< a centred stroke reaches half its size
};
constexpr Position kOutside = {"outside", 1, 1};
constexpr Position kInside = {"inside", 2, 1};
constexpr Position kCentre = {"centre", 0, 2};

void addStroke(Cases& cases, const Workload& workload, const Position& position, int radius) {
    const std::string row =
        std::string("stroke/") + position.name + "/" + workload.name + "/R:" + std::to_string(radius);
    const auto size = static_cast<float>(radius * position.sizePerRadius);
    const int number = position.number;
    addCoreCases(cases, row, workload, radius,
                 coreWith<VFStroke>(VFStrokeProperty(size, kInk, 1.0F, 0, number)),
                 [size, number](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintStroke(layer, nullptr, mask, text, false, size, kInk, number);
                 });
}

}  // namespace

void addStrokeCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160()}) {
        for (const Position& position : {kOutside, kInside, kCentre}) {
            for (const int radius : kRadii)
                addStroke(cases, *workload, position, radius);
        }
    }
    for (const Workload* workload : {&glyph48(), &noise()}) {
        for (const int radius : kRadii)
            addStroke(cases, *workload, kOutside, radius);
    }
}

}  // namespace vorel_bench
