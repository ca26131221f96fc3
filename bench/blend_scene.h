#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

#include "case.h"
#include "voreleffect/VFBitmap.h"

namespace vorel_bench {

constexpr uint32_t kBlendInk = 0xC0604018U;  ///< translucent, premultiplied

/// Which scene, before its pixels are made.
struct SceneKind {
    const char* data;  ///< "text": lines of text; "random": noise
    int width;
    int height;

    int64_t pixels() const { return int64_t{width} * height; }
};
constexpr SceneKind kScenes[] = {
    {"text", 512, 128}, {"random", 512, 128}, {"text", 1080, 1920}, {"random", 1080, 1920}};

/// What a blend is given, all of one size.
struct BlendScene {
    int width = 0;
    int height = 0;
    std::vector<uint8_t> mask;
    std::vector<uint32_t> source;  ///< premultiplied words 0xAARRGGBB
    std::vector<uint8_t> before;   ///< the destination: premultiplied R, G, B, A
};

/// Made at the first call, kept to the end.
const BlendScene& sceneOf(const SceneKind& kind);

/// The row of an operation on a scene.
std::string blendRow(const std::string& operation, const SceneKind& kind);

/// Changes a destination that is refilled before each call.
class BlendJob : public Job {
  public:
    using Paint = std::function<void(const BlendScene&, VFontEffect::VFBitmap&)>;

    BlendJob(const SceneKind& kind, Paint paint);
    void reset() override;
    void paint() override { mPaint(mScene, mDestination); }
    Bytes painted() const override { return {mDestination.mData, mScene.before.size()}; }

  private:
    const BlendScene& mScene;
    VFontEffect::VFBitmap mDestination;
    Paint mPaint;
};

}  // namespace vorel_bench
