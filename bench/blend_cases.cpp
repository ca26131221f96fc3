#include <cstring>

#include "blend_scene.h"
#include "tests/support/literal_blend.h"
#include "voreleffect/VFBlender.h"
#include "voreleffect/VFEffect.h"

/// The blending operations on whole images, and the composite of a layered run. The destination is
/// refilled before each call; the refill is not part of the figures.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

namespace literal = vorel_test::literal;

// The operations take unconst pointers, but only read through them.
unsigned char* maskOf(const BlendScene& scene) {
    return const_cast<unsigned char*>(scene.mask.data());
}
unsigned int* sourceOf(const BlendScene& scene) {
    return const_cast<unsigned int*>(scene.source.data());
}

void addMaskBlend(Cases& cases, const SceneKind& kind, int mode) {
    const std::string row = blendRow("mask-mode" + std::to_string(mode), kind);
    const BlendJob::Paint ours = [mode](const BlendScene& s, VFBitmap& destination) {
        VFBlender().drawBitmapBlend8(0, 0, &destination, maskOf(s), s.width, s.height, s.width,
                                     kBlendInk, mode);
    };
    const BlendJob::Paint literally = [mode](const BlendScene& s, VFBitmap& destination) {
        literal::drawBitmapBlend8(0, 0, destination.mData, s.width, s.height, s.mask.data(), s.width,
                                  s.height, s.width, kBlendInk, mode);
    };
    cases.push_back(caseOf<BlendJob>(row, kOurs, kind.pixels(), kind, ours));
    cases.push_back(caseOf<BlendJob>(row, kLiteral, kind.pixels(), kind, literally));
    cases.push_back(copyCase(row, kind.pixels(), 4 * kind.pixels()));
}

void addColourBlend(Cases& cases, const SceneKind& kind, const char* name, int mode) {
    const std::string row = blendRow(name, kind);
    const BlendJob::Paint ours = [mode](const BlendScene& s, VFBitmap& destination) {
        VFBlender().drawBitmapBlend32(0, 0, &destination, sourceOf(s), s.width, s.height, s.width, mode);
    };
    const BlendJob::Paint literally = [mode](const BlendScene& s, VFBitmap& destination) {
        literal::drawBitmapBlend32(0, 0, destination.mData, s.width, s.height, s.source.data(), s.width,
                                   s.height, s.width, mode);
    };
    cases.push_back(caseOf<BlendJob>(row, kOurs, kind.pixels(), kind, ours));
    cases.push_back(caseOf<BlendJob>(row, kLiteral, kind.pixels(), kind, literally));
    cases.push_back(copyCase(row, kind.pixels(), 4 * kind.pixels()));
}

constexpr uint32_t kOuterInk = 0xFF102030U;

/// compositeLayers of a run whose outer layer holds the glyphs themselves: a stroke of no width.
class CompositeJob : public Job {
  public:
    explicit CompositeJob(const SceneKind& kind)
        : mScene(sceneOf(kind)),
          mGlyph{maskOf(mScene), static_cast<unsigned short>(kind.width),
                 static_cast<unsigned short>(kind.height)},
          mDestination(static_cast<unsigned int>(kind.width), static_cast<unsigned int>(kind.height),
                       4) {
        mSet.setTextOpacity(0.5F);
        mSet.addStrokeText(0.0F, kOuterInk, 1.0F, 0, 1);
    }

    void reset() override {
        mSet.initEffect(mScene.width, mScene.height);
        mSet.setDstBitmap(&mDestination);
        mSet.renderEffectLayer(0, 0, &mGlyph);
        mSet.doEffectPostProcessing();
        std::memcpy(mDestination.mData, mScene.before.data(), mScene.before.size());
    }
    void paint() override { mSet.compositeLayers(&mDestination); }
    Bytes painted() const override { return {mDestination.mData, mScene.before.size()}; }

  private:
    const BlendScene& mScene;
    VFGlyph mGlyph;
    VFBitmap mDestination;
    VFEffect mSet;
};

/// The same outer layer, made by a blend.
std::vector<uint8_t> outerLayer(const BlendScene& scene) {
    std::vector<uint8_t> layer(scene.before.size());
    literal::blendDstOver8To32(0, 0, layer.data(), scene.width, scene.height, scene.mask.data(),
                               scene.width, scene.height, scene.width, kOuterInk);
    return layer;
}

void addComposite(Cases& cases, const SceneKind& kind) {
    const std::string row = blendRow("composite", kind);
    cases.push_back(caseOf<CompositeJob>(row, kOurs, kind.pixels(), kind));
    cases.push_back({row, kLiteral, kind.pixels(), [kind] {
                         const std::vector<uint8_t> outer = outerLayer(sceneOf(kind));
                         return std::make_unique<BlendJob>(
                             kind, [outer](const BlendScene& s, VFBitmap& destination) {
                                 literal::composite(destination.mData, outer.data(), s.mask.data(),
                                                    s.width * s.height);
                             });
                     }});
    cases.push_back(copyCase(row, kind.pixels(), 4 * kind.pixels()));
}

}  // namespace

void addBlendCases(Cases& cases) {
    for (const SceneKind& kind : kScenes) {
        for (const int mode : {1, 2, 3, 7})
            addMaskBlend(cases, kind, mode);
        addColourBlend(cases, kind, "src-over", 1);
        addColourBlend(cases, kind, "dst-over", 2);
        addComposite(cases, kind);
    }
}

}  // namespace vorel_bench
