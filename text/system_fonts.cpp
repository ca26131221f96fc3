#include "text/system_fonts.h"

#include <fontconfig/fontconfig.h>

#include <array>
#include <memory>
#include <string_view>

#include "text/error.h"

namespace voreltext {
namespace {

template <auto kDestroy>
struct Destroy {
    template <typename T>
    void operator()(T* object) const {
        kDestroy(object);
    }
};
using FontPattern = std::unique_ptr<FcPattern, Destroy<FcPatternDestroy>>;

/// Names that stand for whatever family the system prefers.
constexpr std::array<std::string_view, 4> kGenericFamilies{"sans-serif", "sans", "serif", "monospace"};

bool isGeneric(std::string_view family) {
    for (const std::string_view generic : kGenericFamilies) {
        if (family == generic) return true;
    }
    return false;
}

/// fontconfig answers every request with its nearest font; only one of the family asked for counts.
bool hasFamily(const FcPattern* font, const FcChar8* family) {
    if (isGeneric(reinterpret_cast<const char*>(family))) return true;
    FcChar8* name = nullptr;
    for (int i = 0; FcPatternGetString(font, FC_FAMILY, i, &name) == FcResultMatch; ++i) {
        if (FcStrCmpIgnoreCase(name, family) == 0) return true;
    }
    return false;
}

}  // namespace

struct SystemFonts::Config {
    std::unique_ptr<FcConfig, Destroy<FcConfigDestroy>> fonts{FcInitLoadConfigAndFonts()};
};

SystemFonts::SystemFonts() : mConfig(new Config) {}

SystemFonts::~SystemFonts() = default;

FontFile SystemFonts::find(const std::string& request) const {
    const TextError noSuchFont("no font file or family '" + request + "'");
    FcConfig* const config = mConfig->fonts.get();
    const FontPattern wanted(FcNameParse(reinterpret_cast<const FcChar8*>(request.c_str())));
    if (config == nullptr || !wanted) throw noSuchFont;
    FcChar8* found = nullptr;
    if (FcPatternGetString(wanted.get(), FC_FAMILY, 0, &found) != FcResultMatch) throw noSuchFont;
    const std::string family = reinterpret_cast<const char*>(found);

    FcConfigSubstitute(config, wanted.get(), FcMatchPattern);
    FcDefaultSubstitute(wanted.get());
    FcResult result = FcResultNoMatch;
    const FontPattern font(FcFontMatch(config, wanted.get(), &result));
    if (!font || !hasFamily(font.get(), reinterpret_cast<const FcChar8*>(family.c_str()))) {
        throw noSuchFont;
    }
    FcChar8* file = nullptr;
    if (FcPatternGetString(font.get(), FC_FILE, 0, &file) != FcResultMatch) throw noSuchFont;
    int index = 0;
    FcPatternGetInteger(font.get(), FC_INDEX, 0, &index);
    return {reinterpret_cast<const char*>(file), index};
}

}  // namespace voreltext
