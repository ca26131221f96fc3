#include <algorithm>
#include <type_traits>

#include "case.h"
#include "fill_paint.h"
#include "tests/support/literal_engine.h"
#include "voreleffect/VFEffect.h"
#include "workload.h"

/// Whole runs of four looks. A sample clears the destination, makes a set, describes the look, asks for
/// the key, lays the glyphs, paints and composites.
namespace vorel_bench {

using namespace VFontEffect;

namespace {

namespace literal = vorel_test::literal;

constexpr uint32_t kInk = 0x3060A0U;

/// Ramp and tile in the types of either set.
template <class Set>
struct Paint;

template <>
struct Paint<VFEffect> {
    std::vector<VFGradient> ramp = rampStops<VFGradient>();
    std::vector<uint8_t> bytes = tileBytes();
    VFBitmap tile{kTileSide, kTileSide, bytes.data(), 4};
};

template <>
struct Paint<literal::Engine> {
    std::vector<literal::Stop> ramp = rampStops<literal::Stop>();
    literal::Tile tile{kTileSide, kTileSide, tileBytes()};
};

template <class Set>
using Describe = void (*)(Set&, Paint<Set>&);

template <class Set>
int rampLength(const Paint<Set>& paint) {
    return static_cast<int>(paint.ramp.size());
}

/// A: outline, shadow, gradient.
template <class Set>
void lookA(Set& set, Paint<Set>& paint) {
    set.addOuterShadowText(135.0F, 6.0F, 8.0F, 0x000000U, 0.6F);
    set.addStrokeText(4.0F, 0xFFFFFFU, 1.0F, 0, 1);
    set.addLinearGradientText(90.0F, 1.0F, 1.0F, rampLength(paint), paint.ramp.data());
}

/// B: a halo around the plain text.
template <class Set>
void lookB(Set& set, Paint<Set>&) {
    set.addOuterGlowText(16.0F, 0xFFC040U, 1.0F, 0, nullptr);
}

/// C: an outline across the edge, a shadow inside, a pattern; the outline makes it a layered run.
template <class Set>
void lookC(Set& set, Paint<Set>& paint) {
    set.addPatternText(&paint.tile, kTileScale, 1.0F);
    set.addInnerShadowText(135.0F, 4.0F, 5.0F, 0x000000U, 0.6F);
    set.addStrokeText(6.0F, 0x102030U, 1.0F, 0, 0);
}

/// D: every effect at once, at the sizes of the others.
template <class Set>
void lookD(Set& set, Paint<Set>& paint) {
    set.addOuterShadowText(135.0F, 6.0F, 8.0F, 0x000000U, 0.6F);
    set.addInnerShadowText(135.0F, 4.0F, 5.0F, 0x000000U, 0.6F);
    set.addOuterGlowText(16.0F, 0xFFC040U, 1.0F, 0, nullptr);
    set.addInnerGlowText(8.0F, 0xFFFFFFU, 0.5F, 0, nullptr);
    set.addLinearGradientText(90.0F, 1.0F, 0.5F, rampLength(paint), paint.ramp.data());
    set.addRadialGradientText(1.0F, 0.5F, rampLength(paint), paint.ramp.data());
    set.addStrokeText(6.0F, 0x102030U, 1.0F, 0, 0);
    set.addPatternText(&paint.tile, kTileScale, 0.5F);
}

class LookJob : public Job {
  public:
    LookJob(const Workload* workload, Describe<VFEffect> describe)
        : mGlyphs(workload->glyphs),
          mDescribe(describe),
          mLayer(static_cast<unsigned int>(workload->width + 2 * kLookMargin),
                 static_cast<unsigned int>(workload->height + 2 * kLookMargin), 4) {}

    void paint() override {
        std::fill_n(mLayer.mData, painted().size, uint8_t{0});
        VFEffect set;
        mDescribe(set, mPaint);
        delete[] set.getMapKey(kInk);
        set.initEffect(static_cast<int>(mLayer.mWidth), static_cast<int>(mLayer.mHeight));
        set.setDstBitmap(&mLayer);
        for (Glyph& glyph : mGlyphs) {
            VFGlyph record = {glyph.coverage.data(), static_cast<unsigned short>(glyph.width),
                              static_cast<unsigned short>(glyph.height)};
            set.renderEffectLayer(kLookMargin + glyph.x, kLookMargin + glyph.y, &record);
        }
        set.doEffectPostProcessing();
        set.compositeLayers(&mLayer);
    }

    Bytes painted() const override { return {mLayer.mData, size_t{mLayer.mWidth} * mLayer.mHeight * 4}; }

    /// The mask, and the outer layer where a centred stroke asks for it.
    size_t layerBytes() const override {
        const bool layered = mDescribe == lookC<VFEffect> || mDescribe == lookD<VFEffect>;
        return painted().size / 4 * (layered ? 5 : 1);
    }

  private:
    std::vector<Glyph> mGlyphs;
    Describe<VFEffect> mDescribe;
    Paint<VFEffect> mPaint;
    VFBitmap mLayer;
};

class LiteralLookJob : public Job {
  public:
    LiteralLookJob(const Workload* workload, Describe<literal::Engine> describe)
        : mGlyphs(workload->glyphs), mDescribe(describe) {
        mLayer.width = workload->width + 2 * kLookMargin;
        mLayer.height = workload->height + 2 * kLookMargin;
        mLayer.bytes.resize(size_t{4} * static_cast<size_t>(mLayer.width * mLayer.height));
    }

    void paint() override {
        std::fill(mLayer.bytes.begin(), mLayer.bytes.end(), uint8_t{0});
        literal::Engine set;
        mDescribe(set, mPaint);
        set.getMapKey(kInk);
        set.initEffect(mLayer.width, mLayer.height);
        set.setDstBitmap(&mLayer);
        for (const Glyph& glyph : mGlyphs) {
            const literal::Mask mask = {glyph.width, glyph.height, glyph.coverage};
            set.renderEffectLayer(kLookMargin + glyph.x, kLookMargin + glyph.y, &mask);
        }
        set.doEffectPostProcessing();
        set.compositeLayers(mLayer);
    }

    Bytes painted() const override { return {mLayer.bytes.data(), mLayer.bytes.size()}; }

  private:
    std::vector<Glyph> mGlyphs;
    Describe<literal::Engine> mDescribe;
    Paint<literal::Engine> mPaint;
    literal::Picture mLayer;
};

template <class Set>
Describe<Set> describing(char look) {
    switch (look) {
        case 'A':
            return lookA<Set>;
        case 'B':
            return lookB<Set>;
        case 'C':
            return lookC<Set>;
        default:
            return lookD<Set>;
    }
}

/// The look in a picture whose margins count as well.
template <class LookJobType, class Set>
Case lookCaseBy(const char* maker, char look, const Workload& workload) {
    return caseOf<LookJobType>(std::string("look/") + look + "/" + workload.name, maker,
                               workload.grownPixels(kLookMargin), &workload, describing<Set>(look));
}

}  // namespace

Case lookCase(char look, const Workload& workload) {
    return lookCaseBy<LookJob, VFEffect>(kOurs, look, workload);
}

Case literalLookCase(char look, const Workload& workload) {
    return lookCaseBy<LiteralLookJob, literal::Engine>(kLiteral, look, workload);
}

void addLookCases(Cases& cases) {
    for (const char look : kLooks) {
        for (const Workload* workload : {&glyph48(), &line48(), &title160()}) {
            cases.push_back(lookCase(look, *workload));
            cases.push_back(literalLookCase(look, *workload));
            const std::string row = cases.back().row;
            const int64_t pixels = cases.back().pixels;
            cases.push_back(copyCase(row, pixels, 4 * pixels));
        }
    }
}

}  // namespace vorel_bench
