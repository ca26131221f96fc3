#include "text/shaper.h"

#include <hb-ft.h>
#include <hb.h>

#include <new>
#include <utility>

#include "text/destroy.h"
#include "text/error.h"
#include "text/rasteriser.h"

namespace voreltext {
namespace {

/// A feature for the whole text: a range would be one of the characters of every line anew.
hb_feature_t parsed(const std::string& feature) {
    hb_feature_t result;
    const bool isFeature =
        hb_feature_from_string(feature.data(), static_cast<int>(feature.size()), &result) != 0 &&
        result.start == HB_FEATURE_GLOBAL_START && result.end == HB_FEATURE_GLOBAL_END;
    if (isFeature) return result;
    throw TextError("'" + feature + "' is no feature of a font for a whole text, as 'liga=0' is");
}

}  // namespace

/// HarfBuzz's own.
struct Shaper::HarfBuzz {
    std::vector<hb_feature_t> features;
    std::vector<std::unique_ptr<hb_font_t, Destroy<hb_font_destroy>>>
        fonts;  ///< null until they are used
    std::unique_ptr<hb_buffer_t, Destroy<hb_buffer_destroy>> buffer{hb_buffer_create()};
};

Shaper::Shaper(const Fonts& fonts, const std::vector<std::string>& features)
    : mFonts(fonts), mHarfBuzz(new HarfBuzz) {
    for (const std::string& feature : features)
        mHarfBuzz->features.push_back(parsed(feature));
}

Shaper::~Shaper() = default;

hb_font_t* Shaper::fontFor(size_t index) {
    auto& fonts = mHarfBuzz->fonts;
    if (fonts.size() <= index) fonts.resize(index + 1);
    if (!fonts[index]) {
        fonts[index].reset(hb_ft_font_create_referenced(mFonts[index].face()));
        hb_ft_font_set_load_flags(fonts[index].get(), kOutlineFlags);
    }
    return fonts[index].get();
}

/// Leaves the glyphs in the buffer.
void Shaper::shapeItem(const ShapingRun& run, const ShapingItem& item) {
    hb_buffer_t* const buffer = mHarfBuzz->buffer.get();
    hb_buffer_reset(buffer);
    hb_buffer_add_utf32(buffer, run.codes, static_cast<int>(run.length),
                        static_cast<unsigned int>(item.begin), static_cast<int>(item.end - item.begin));
    // Of the line: what is around the item is its context.
    hb_buffer_set_flags(buffer, static_cast<hb_buffer_flags_t>(HB_BUFFER_FLAG_BOT | HB_BUFFER_FLAG_EOT));
    hb_buffer_set_script(buffer, static_cast<hb_script_t>(item.script));
    hb_buffer_set_direction(buffer, item.isRightToLeft ? HB_DIRECTION_RTL : HB_DIRECTION_LTR);
    hb_shape(fontFor(item.font), buffer, mHarfBuzz->features.data(),
             static_cast<unsigned int>(mHarfBuzz->features.size()));
    if (!hb_buffer_allocation_successful(buffer)) throw std::bad_alloc();
}

std::vector<ShapedGlyph> Shaper::shape(const ShapingRun& run) {
    std::vector<ShapedGlyph> shaped;
    for (const ShapingItem& item : itemsOf(run)) {
        shapeItem(run, item);
        unsigned int count = 0;
        const hb_glyph_info_t* glyphs = hb_buffer_get_glyph_infos(mHarfBuzz->buffer.get(), &count);
        const hb_glyph_position_t* places =
            hb_buffer_get_glyph_positions(mHarfBuzz->buffer.get(), &count);
        const Font& font = mFonts[item.font];
        for (unsigned int i = 0; i < count; ++i) {
            shaped.push_back({glyphs[i].codepoint, item.font, glyphs[i].cluster,
                              font.scaled(places[i].x_advance), font.scaled(places[i].x_offset),
                              font.scaled(places[i].y_offset)});
        }
    }
    return shaped;
}

}  // namespace voreltext
