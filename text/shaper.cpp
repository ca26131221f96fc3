#include "text/shaper.h"

#include <hb.h>
#include <raqm.h>

#include <memory>
#include <utility>

#include "text/error.h"
#include "text/rasteriser.h"

namespace voreltext {
namespace {

struct DestroyRaqm {
    void operator()(raqm_t* shaper) const { raqm_destroy(shaper); }
};
using Raqm = std::unique_ptr<raqm_t, DestroyRaqm>;

/// A range would be one of the characters of every line anew.
bool isFeatureOfAll(const std::string& feature) {
    hb_feature_t parsed;
    return hb_feature_from_string(feature.data(), static_cast<int>(feature.size()), &parsed) != 0 &&
           parsed.start == HB_FEATURE_GLOBAL_START && parsed.end == HB_FEATURE_GLOBAL_END;
}

bool setFonts(raqm_t* shaper, const Fonts& fonts, const ShapingRun& run) {
    for (size_t begin = 0; begin < run.length;) {
        size_t end = begin;
        while (end < run.length && run.fonts[end] == run.fonts[begin])
            ++end;
        const bool isSet =
            raqm_set_freetype_face_range(shaper, fonts[run.fonts[begin]].face(), begin, end - begin);
        if (!isSet) return false;
        begin = end;
    }
    return true;
}

bool addFeatures(raqm_t* shaper, const std::vector<std::string>& features) {
    for (const std::string& feature : features) {
        if (!raqm_add_font_feature(shaper, feature.data(), static_cast<int>(feature.size())))
            return false;
    }
    return true;
}

}  // namespace

Shaper::Shaper(const Fonts& fonts, std::vector<std::string> features)
    : mFonts(fonts), mFeatures(std::move(features)) {
    for (const std::string& feature : mFeatures) {
        if (!isFeatureOfAll(feature)) {
            throw TextError("'" + feature +
                            "' is no feature of a font for a whole text, as 'liga=0' is");
        }
    }
}

/// The index of a face's font, which probably is `likely`.
size_t Shaper::fontOf(const FT_FaceRec_* face, size_t likely) const {
    size_t font = mFonts[likely].face() == face ? likely : 0;
    while (font + 1 < mFonts.count() && mFonts[font].face() != face)
        ++font;
    return font;
}

std::vector<ShapedGlyph> Shaper::shape(const ShapingRun& run) const {
    std::vector<ShapedGlyph> shaped;
    if (run.length == 0) return shaped;
    const Raqm shaper(raqm_create());
    const bool isShaped = shaper != nullptr && raqm_set_text(shaper.get(), run.codes, run.length) &&
                          setFonts(shaper.get(), mFonts, run) && addFeatures(shaper.get(), mFeatures) &&
                          raqm_set_freetype_load_flags(shaper.get(), kOutlineFlags) &&
                          raqm_set_par_direction(shaper.get(), run.isRightToLeft ? RAQM_DIRECTION_RTL
                                                                                 : RAQM_DIRECTION_LTR) &&
                          raqm_layout(shaper.get());
    if (!isShaped) throw TextError("the text cannot be shaped");

    size_t count = 0;
    const raqm_glyph_t* glyphs = raqm_get_glyphs(shaper.get(), &count);
    shaped.reserve(count);
    for (size_t i = 0; i < count; ++i) {
        const raqm_glyph_t& glyph = glyphs[i];
        const size_t font = fontOf(glyph.ftface, shaped.empty() ? 0 : shaped.back().font);
        shaped.push_back({glyph.index, font, glyph.cluster, mFonts[font].scaled(glyph.x_advance),
                          mFonts[font].scaled(glyph.x_offset), mFonts[font].scaled(glyph.y_offset)});
    }
    return shaped;
}

}  // namespace voreltext
