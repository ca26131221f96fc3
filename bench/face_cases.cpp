#include <voreleffect/look.h>

#include <algorithm>
#include <string>

#include "case.h"
#include "workload.h"

/// The glyphs of a line one by one, with an outline and a shadow: by the classes, described and planned
/// once, and by a Painter. Each into a picture of its own, as for a cache, and onto a page. The rule by
/// which both are laid over the page is the same.
namespace vorel_bench {
namespace {

using namespace VFontEffect;

constexpr int kPageMargin = 40;

class GlyphsJob : public Job {
  public:
    explicit GlyphsJob(const Workload* workload)
        : mWidth(workload->width + 2 * kPageMargin),
          mHeight(workload->height + 2 * kPageMargin),
          mGlyphs(workload->glyphs),
          mPage(static_cast<size_t>(mWidth) * static_cast<size_t>(mHeight) * 4) {}

    void reset() override { std::fill(mPage.begin(), mPage.end(), uint8_t{200}); }
    Bytes painted() const override { return {mPage.data(), mPage.size()}; }

  protected:
    PictureView page() { return {mPage.data(), mWidth, mHeight}; }
    std::vector<vorel_bench::Glyph>& glyphs() { return mGlyphs; }

  private:
    int mWidth;
    int mHeight;
    std::vector<vorel_bench::Glyph> mGlyphs;
    std::vector<uint8_t> mPage;
};

class ClassesJob : public GlyphsJob {
  public:
    ClassesJob(const Workload* workload, bool ontoPage) : GlyphsJob(workload), mOntoPage(ontoPage) {
        mSet.addOuterShadowText(135, 6, 8, 0x000000, 0.6F);
        mSet.addStrokeText(4, 0xFFFFFF, 1, 0, 1);
        mSet.addText(0x3366CC, 1);
    }

    void paint() override {
        for (vorel_bench::Glyph& glyph : glyphs())
            paintOne(glyph);
    }

  private:
    void paintOne(vorel_bench::Glyph& glyph) {
        const int left = mSet.getLeftOffset();
        const int top = mSet.getTopOffset();
        const int width = left + glyph.width + mSet.getRightOffset();
        const int height = top + glyph.height + mSet.getBottomOffset();
        VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
        mSet.initEffect(width, height);
        mSet.setDstBitmap(&picture);
        VFGlyph record = {glyph.coverage.data(), static_cast<unsigned short>(glyph.width),
                          static_cast<unsigned short>(glyph.height)};
        mSet.renderEffectLayer(left, top, &record);
        mSet.doEffectPostProcessing();
        mSet.compositeLayers(&picture);
        if (mOntoPage) layOver(picture, kPageMargin + glyph.x - left, kPageMargin + glyph.y - top);
    }

    void layOver(const VFBitmap& picture, int x, int y) {
        const PictureView view = page();
        for (unsigned row = 0; row < picture.mHeight; ++row) {
            const int64_t line = int64_t{y} + static_cast<int64_t>(row);
            look_internal::layRowOver<PixelOrder::rgba>(view.data + (line * view.width + x) * 4,
                                                        picture.mData + size_t{row} * picture.mWidth * 4,
                                                        static_cast<int>(picture.mWidth));
        }
    }

    VFEffect mSet;
    bool mOntoPage;
};

class PainterJob : public GlyphsJob {
  public:
    PainterJob(const Workload* workload, bool ontoPage)
        : GlyphsJob(workload),
          mOntoPage(ontoPage),
          mPainter(Look()
                       .fill(rgb(0x3366CC))
                       .add(OuterShadow(rgb(0)).angle(135).distance(6).size(8).opacity(0.6F))
                       .add(Stroke(4, rgb(0xFFFFFF)))) {}

    void paint() override {
        for (const vorel_bench::Glyph& glyph : glyphs()) {
            const VFontEffect::Glyph placed = {glyph.x, glyph.y, glyph.coverage.data(), glyph.width,
                                               glyph.height};
            if (mOntoPage) {
                mPainter.paint(placed, page(), kPageMargin, kPageMargin);
            } else {
                mPainter.paint(placed);
            }
        }
    }

  private:
    bool mOntoPage;
    Painter mPainter;
};

}  // namespace

void addFaceCases(Cases& cases) {
    const Workload* const line = &line48();
    int64_t pixels = 0;
    for (const vorel_bench::Glyph& glyph : line->glyphs)
        pixels += int64_t{glyph.width} * glyph.height;
    for (const bool ontoPage : {false, true}) {
        const std::string row = std::string("look/glyphs/") + (ontoPage ? "page/" : "picture/");
        cases.push_back(caseOf<ClassesJob>(row + "classes", kOurs, pixels, line, ontoPage));
        cases.push_back(caseOf<PainterJob>(row + "painter", kOurs, pixels, line, ontoPage));
    }
}

}  // namespace vorel_bench
