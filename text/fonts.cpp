#include "text/fonts.h"

#include <algorithm>
#include <utility>

#include "text/error.h"
#include "unicode/characters.h"

namespace voreltext {

Fonts::Fonts(Font main) {
    add(std::move(main));
}

void Fonts::add(Font font) {
    mAdded.push_back(mFonts.size());
    mFonts.push_back(std::make_unique<const Font>(std::move(font)));
}

std::optional<size_t> Fonts::fallbackFor(const Cluster& cluster) {
    const std::optional<FontFile> file = mFallback ? mFallback(cluster) : std::nullopt;
    const std::optional<size_t> font = file ? opened(*file) : std::nullopt;
    return font && hasCluster(*mFonts[*font], cluster) ? font : std::nullopt;
}

std::optional<size_t> Fonts::opened(const FontFile& file) {
    for (const Opened& each : mOpened) {
        if (each.file.path == file.path && each.file.faceIndex == file.faceIndex) return each.font;
    }
    if (mOpened.size() == kMostFallbacks) return std::nullopt;
    mOpened.push_back({file, std::nullopt});
    try {
        mFonts.push_back(std::make_unique<const Font>(file, main().sizePx()));
        mOpened.back().font = mFonts.size() - 1;
    } catch (const TextError&) {  // the text goes on without it
    }
    return mOpened.back().font;
}

bool hasCluster(const Font& font, const Cluster& cluster) {
    return std::all_of(cluster.begin(), cluster.end(), [&](uint32_t code) {
        return vorelunicode::isDefaultIgnorable(code) || font.has(code);
    });
}

}  // namespace voreltext
