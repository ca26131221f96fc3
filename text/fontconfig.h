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

}  // namespace voreltext
