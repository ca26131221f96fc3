#include <algorithm>

#include "core_jobs.h"
#include "tests/support/literal_cores.h"
#include "voreleffect/VFBlender.h"

/// Blurs through the outer shadow core, which is not moved: padding, blur and blend together. A row of
/// its own shows how much of that the blend of the finished plane is.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

constexpr uint32_t kShade = 0x99000000U;
constexpr float kAngle = 135.0F;
constexpr float kDistance = 0.0F;
constexpr int kModeDstOver = 2;

CoreJob::MakeCore shadowCore(int radius, uint32_t color) {
    return coreWith<VFOuterShadow>(
        VFOuterShadowProperty(kAngle, kDistance, static_cast<float>(radius), color, 1.0F));
}

/// Blends a blurred plane into a clear layer, as the last step of the shadow does.
class ShadowBlendJob : public Job {
  public:
    ShadowBlendJob(const Workload* workload, int radius)
        : mPlane(layerMask(*workload, radius)),
          mLayer(static_cast<unsigned int>(mPlane.width), static_cast<unsigned int>(mPlane.height), 4) {
        // The alpha of an opaque shadow is the blurred plane itself.
        CoreJob shadow(workload, radius, shadowCore(radius, 0xFF000000U));
        shadow.paint();
        for (size_t i = 0; i < mPlane.bytes.size(); ++i)
            mPlane.bytes[i] = shadow.painted().data[4 * i + 3];
    }

    void reset() override { std::fill_n(mLayer.mData, mPlane.bytes.size() * 4, uint8_t{0}); }

    void paint() override {
        VFBlender().drawBitmapBlend8(0, 0, &mLayer, mPlane.bytes.data(), mPlane.width, mPlane.height,
                                     mPlane.width, kShade, kModeDstOver);
    }

  private:
    literal::Mask mPlane;
    VFBitmap mLayer;
};

void addShadow(Cases& cases, const Workload& workload, int radius) {
    const std::string place = workload.name + "/R:" + std::to_string(radius);
    const auto size = static_cast<float>(radius);
    addCoreCases(cases, "shadow/outer/" + place, workload, radius, shadowCore(radius, kShade),
                 [size](literal::Picture& layer, const literal::Mask& mask, literal::Box text) {
                     literal::paintOuterShadow(layer, mask, text, kAngle, kDistance, size, kShade);
                 });
    cases.push_back(caseOf<ShadowBlendJob>("shadow/blend-alone/" + place, kOurs,
                                           workload.grownPixels(radius), &workload, radius));
}

}  // namespace

void addShadowCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160(), &glyph48(), &noise()}) {
        for (const int radius : kRadii)
            addShadow(cases, *workload, radius);
    }
}

}  // namespace vorel_bench
