#include <cstring>

#include "core_jobs.h"
#include "tests/support/literal_cores.h"

/// The growth of a glow alone, and whole outer glows.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

constexpr uint32_t kLight = 0xFFFFC040U;

/// The largest glow grows in 47 passes, in a plane with a margin of twice its size.
constexpr int kPasses = 47;
constexpr int kGrowthMargin = 200;

class GrowthJob : public Job {
  public:
    GrowthJob(const Workload* workload, int margin)
        : mBefore(layerMask(*workload, margin)), mPlane(mBefore) {}
    void reset() override { mPlane.bytes = mBefore.bytes; }
    void paint() override {
        mGlow.increaseByBoxFilter(mPlane.bytes.data(), kPasses, mPlane.width, mPlane.height);
    }
    Bytes painted() const override { return {mPlane.bytes.data(), mPlane.bytes.size()}; }

  protected:
    const literal::Mask mBefore;
    literal::Mask mPlane;

  private:
    VFOuterGlow mGlow;
};

class LiteralGrowthJob : public GrowthJob {
  public:
    using GrowthJob::GrowthJob;
    void paint() override { literal::boxFilter(mPlane.bytes, kPasses, mPlane.width, mPlane.height); }
};

void addGrowth(Cases& cases, const Workload& workload) {
    const std::string row = "growth/47-passes/" + workload.name;
    const int64_t pixels = workload.grownPixels(kGrowthMargin) * kPasses;
    cases.push_back(caseOf<GrowthJob>(row, kOurs, pixels, &workload, kGrowthMargin));
    cases.push_back(caseOf<LiteralGrowthJob>(row, kLiteral, pixels, &workload, kGrowthMargin));
    const int64_t plane = workload.grownPixels(kGrowthMargin);
    cases.push_back(copyCase(row, plane, plane));
}

void addGlow(Cases& cases, const Workload& workload, int radius) {
    const auto size = static_cast<float>(radius);
    addCoreCases(cases, "glow/outer/" + workload.name + "/R:" + std::to_string(radius), workload, radius,
                 coreWith<VFOuterGlow>(VFOuterGlowProperty(size, kLight, 1.0F, 0, nullptr)),
                 [size](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintOuterGlow(layer, mask, text, size, kLight, {});
                 });
}

}  // namespace

void addGlowCases(Cases& cases) {
    addGrowth(cases, line48());
    addGrowth(cases, title160());
    for (const Workload* workload : {&line48(), &title160(), &glyph48()}) {
        for (const int radius : kRadii)
            addGlow(cases, *workload, radius);
    }
}

}  // namespace vorel_bench
