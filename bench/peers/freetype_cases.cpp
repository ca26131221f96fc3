#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_GLYPH_H
#include FT_STROKER_H

#include "font_face.h"
#include "peers.h"
#include "workload.h"

/// FreeType's stroker: from the loaded outlines of a line to one bitmap per glyph, its outer border
/// filled. The bitmaps are not merged, coloured or blended.
namespace vorel_bench {
namespace {

class StrokerJob : public Job {
  public:
    StrokerJob(const Workload* workload, int radius) : mFont(workload->font, workload->sizePx) {
        FT_Stroker_New(mFont.library(), &mStroker);
        FT_Stroker_Set(mStroker, FT_Fixed{radius} * 64, FT_STROKER_LINECAP_ROUND,
                       FT_STROKER_LINEJOIN_ROUND, 0);
        for (const char character : workload->text) {
            const auto code = static_cast<FT_ULong>(static_cast<unsigned char>(character));
            FT_Glyph glyph = nullptr;
            if (FT_Load_Char(mFont.face(), code, kLoadFlags) != 0) continue;
            if (FT_Get_Glyph(mFont.face()->glyph, &glyph) == 0) mGlyphs.push_back(glyph);
        }
    }

    ~StrokerJob() override {
        for (FT_Glyph glyph : mGlyphs)
            FT_Done_Glyph(glyph);
        FT_Stroker_Done(mStroker);
    }

    void paint() override {
        for (FT_Glyph glyph : mGlyphs) {
            FT_Glyph outline = glyph;
            if (FT_Glyph_StrokeBorder(&outline, mStroker, 0, 0) != 0) continue;
            FT_Glyph_To_Bitmap(&outline, FT_RENDER_MODE_NORMAL, nullptr, 1);
            FT_Done_Glyph(outline);
        }
    }

  private:
    FontFace mFont;
    FT_Stroker mStroker = nullptr;
    std::vector<FT_Glyph> mGlyphs;
};

}  // namespace

void addFreetypeCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160(), &glyph48()}) {
        for (const int radius : kRadii) {
            cases.push_back(
                caseOf<StrokerJob>("stroke/outside/" + workload->name + "/R:" + std::to_string(radius),
                                   "FreeType", workload->grownPixels(radius), workload, radius));
        }
    }
}

}  // namespace vorel_bench
