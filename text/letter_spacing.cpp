#include "text/letter_spacing.h"

#include <hb.h>

#include <algorithm>
#include <array>
#include <cstddef>

#include "unicode/characters.h"

namespace voreltext {
namespace {

/// Whether a character is of a script whose letters are joined in writing.
bool isJoined(uint32_t code) {
    constexpr uint32_t kTatweel = 0x640;  // lengthens the join of several scripts and is of none
    constexpr std::array kScripts{
        HB_SCRIPT_ADLAM,      HB_SCRIPT_ARABIC,     HB_SCRIPT_CHORASMIAN,      HB_SCRIPT_HANIFI_ROHINGYA,
        HB_SCRIPT_MANDAIC,    HB_SCRIPT_MANICHAEAN, HB_SCRIPT_MONGOLIAN,       HB_SCRIPT_NKO,
        HB_SCRIPT_OLD_UYGHUR, HB_SCRIPT_PHAGS_PA,   HB_SCRIPT_PSALTER_PAHLAVI, HB_SCRIPT_SOGDIAN,
        HB_SCRIPT_SYRIAC};
    const hb_script_t script = hb_unicode_script(hb_unicode_funcs_get_default(), code);
    return code == kTatweel || std::find(kScripts.begin(), kScripts.end(), script) != kScripts.end();
}

}  // namespace

void addLetterSpacing(std::vector<ShapedGlyph>& glyphs, const std::vector<uint32_t>& codes,
                      int64_t spacing) {
    ShapedGlyph* before = nullptr;  // the last glyph of the visible cluster at the left
    for (ShapedGlyph& glyph : glyphs) {
        const uint32_t code = codes[glyph.cluster];
        if (vorelunicode::isDefaultIgnorable(code)) continue;
        const bool isNew = before != nullptr && before->cluster != glyph.cluster;
        if (isNew && !(isJoined(code) && isJoined(codes[before->cluster]))) before->advance += spacing;
        before = &glyph;
    }
}

}  // namespace voreltext
