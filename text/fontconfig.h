#pragma once

#include <fontconfig/fontconfig.h>

#include <memory>
#include <string>

#include "text/destroy.h"
#include "text/font.h"

/// Owners of what fontconfig hands out.
namespace voreltext {

using FontConfig = std::unique_ptr<FcConfig, Destroy<FcConfigDestroy>>;
using FontPattern = std::unique_ptr<FcPattern, Destroy<FcPatternDestroy>>;
using FontList = std::unique_ptr<FcFontSet, Destroy<FcFontSetDestroy>>;
using Objects = std::unique_ptr<FcObjectSet, Destroy<FcObjectSetDestroy>>;

inline const FcChar8* fcText(const std::string& text) {
    return reinterpret_cast<const FcChar8*>(text.c_str());
}

/// A text of a pattern, the first of several; empty without.
inline std::string textOf(const FcPattern* pattern, const char* object) {
    FcChar8* text = nullptr;
    const bool isThere = FcPatternGetString(pattern, object, 0, &text) == FcResultMatch;
    return isThere ? reinterpret_cast<const char*>(text) : "";
}

/// Where a font of fontconfig's lies; without a path where it has no file.
inline FontFile fileOf(const FcPattern* pattern) {
    int index = 0;
    FcPatternGetInteger(pattern, FC_INDEX, 0, &index);
    return {textOf(pattern, FC_FILE), index};
}

/// Completes a request as the configuration has it. fontconfig would add the language of the
/// environment, by which it prefers fonts, and does so unless it finds an undetermined one; every
/// environment has English instead, as the one without a language has.
inline void complete(FcConfig* config, FcPattern* wanted) {
    for (const char* language : {"en", "und"})
        FcPatternAddWeak(wanted, FC_LANG, {FcTypeString, {fcText(language)}}, FcTrue);
    FcConfigSubstitute(config, wanted, FcMatchPattern);
    FcDefaultSubstitute(wanted);
}

}  // namespace voreltext
