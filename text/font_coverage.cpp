#include "text/font_coverage.h"

#include <algorithm>

#include "unicode/characters.h"

namespace voreltext {
namespace {

constexpr size_t kMostRankings = 16;
constexpr size_t kMostClusters = 4096;

bool booleanOf(const FcPattern* pattern, const char* object) {
    FcBool value = FcFalse;
    return FcPatternGetBool(pattern, object, 0, &value) == FcResultMatch && value == FcTrue;
}

/// What Font opens: outlines or pictures in colour. A variable font is there once more for each of its
/// named instances, which have one weight.
bool isUsable(const FcPattern* pattern) {
    const bool hasGlyphs = booleanOf(pattern, FC_OUTLINE) || booleanOf(pattern, FC_COLOR);
    return hasGlyphs && !booleanOf(pattern, FC_VARIABLE);
}

bool covers(const FcCharSet* characters, const Cluster& cluster) {
    return std::all_of(cluster.begin(), cluster.end(), [&](uint32_t code) {
        return vorelunicode::isDefaultIgnorable(code) || FcCharSetHasChar(characters, code) == FcTrue;
    });
}

void copy(FcPattern* to, const FcPattern* from, const char* object) {
    FcValue value;
    if (FcPatternGet(from, object, 0, &value) == FcResultMatch) FcPatternAdd(to, object, value, FcTrue);
}

}  // namespace

std::optional<FontFile> FontCoverage::find(const Cluster& cluster, const FontFile& like) {
    if (mConfig == nullptr) return std::nullopt;
    Ranking& ranking = rankingFor(like);
    const auto known = ranking.found.find(cluster);
    if (known != ranking.found.end()) return known->second;

    const bool wantsColour = isPictureByDefault(cluster);
    const Candidate* best = nullptr;
    for (const Candidate& candidate : ranking.candidates) {
        if (!covers(candidate.characters, cluster)) continue;
        if (best == nullptr || candidate.isColour == wantsColour) best = &candidate;
        if (best->isColour == wantsColour) break;
    }
    if (ranking.found.size() == kMostClusters) ranking.found.clear();
    return ranking.found[cluster] = best == nullptr ? std::nullopt : std::optional(best->file);
}

FontCoverage::Ranking& FontCoverage::rankingFor(const FontFile& like) {
    const std::pair key(like.path, like.faceIndex);
    if (mRankings.find(key) == mRankings.end()) {
        if (mRankings.size() == kMostRankings) mRankings.clear();
        rank(mRankings[key], like);
    }
    return mRankings[key];
}

/// Of the family and in the style of a font, installed or not.
FontPattern FontCoverage::wantedLike(const FontFile& like) const {
    FontPattern wanted(FcPatternCreate());
    int count = 0;
    const FontPattern font(
        FcFreeTypeQuery(fcText(like.path), static_cast<unsigned int>(like.faceIndex), nullptr, &count));
    if (!wanted || !font) return wanted;
    for (const char* object : {FC_FAMILY, FC_WEIGHT, FC_SLANT, FC_WIDTH, FC_SPACING})
        copy(wanted.get(), font.get(), object);
    return wanted;
}

void FontCoverage::rank(Ranking& ranking, const FontFile& like) const {
    const FontPattern wanted = wantedLike(like);
    if (!wanted) return;
    complete(mConfig, wanted.get());
    FcResult result = FcResultNoMatch;
    ranking.fonts.reset(FcFontSort(mConfig, wanted.get(), FcFalse, nullptr, &result));
    if (!ranking.fonts) return;
    for (int i = 0; i < ranking.fonts->nfont; ++i) {
        const FcPattern* font = ranking.fonts->fonts[i];
        FcCharSet* characters = nullptr;
        const bool hasCharacters =
            FcPatternGetCharSet(font, FC_CHARSET, 0, &characters) == FcResultMatch;
        if (hasCharacters && isUsable(font)) {
            ranking.candidates.push_back({fileOf(font), characters, booleanOf(font, FC_COLOR)});
        }
    }
}

}  // namespace voreltext
