#include "text/font_chooser.h"

#include <algorithm>

#include "unicode/characters.h"

namespace voreltext {
namespace {

using vorelunicode::isDefaultIgnorable;
using vorelunicode::isRegionalIndicator;
using vorelunicode::isSkinTone;
using vorelunicode::isSymbol;

bool contains(const Fonts::Cluster& cluster, uint32_t code) {
    return std::find(cluster.begin(), cluster.end(), code) != cluster.end();
}

/// Whether a cluster is to be shown in colours: it says so, or it is a flag or made of several
/// pictographs.
bool wantsPicture(const Fonts::Cluster& cluster) {
    if (contains(cluster, vorelunicode::kPicturePresentation)) return true;
    if (cluster.size() < 2) return false;
    if (isRegionalIndicator(cluster[0]) && isRegionalIndicator(cluster[1])) return true;
    return isSymbol(cluster[0]) && (contains(cluster, vorelunicode::kZeroWidthJoiner) ||
                                    std::any_of(cluster.begin() + 1, cluster.end(), isSkinTone));
}

}  // namespace

struct FontChooser::Line {
    explicit Line(const Paragraph& from)
        : paragraph(from), isRtl(isRightToLeft(from)), tried(from.codes.size()) {
        result.fonts.resize(from.codes.size());
    }

    const Paragraph& paragraph;
    bool isRtl;
    std::vector<size_t> tried;  ///< for the first character of each cluster how many fonts had it
    FontedParagraph result;
};

FontedParagraph FontChooser::choose(const Paragraph& paragraph) {
    Line line(paragraph);
    shape(line);
    if (preferPictures(line)) shape(line);
    // Another font beside it may take a cluster's glyph from it: the passes are counted as well.
    for (size_t pass = 0; pass < mFonts.added().size() + 2 && replaceMissing(line); ++pass)
        shape(line);
    noteMissing(line);
    return std::move(line.result);
}

void FontChooser::shape(Line& line) const {
    line.result.glyphs = mShaper.shape({line.paragraph.codes.data(), line.result.fonts.data(),
                                        line.paragraph.codes.size(), line.isRtl});
}

/// In the order of the text.
std::vector<FontChooser::Span> FontChooser::spansOf(const Line& line) {
    std::vector<Span> spans;
    for (const ShapedGlyph& glyph : line.result.glyphs)
        spans.push_back({glyph.cluster, 0, glyph.index == 0});
    std::stable_sort(spans.begin(), spans.end(),
                     [](const Span& one, const Span& other) { return one.begin < other.begin; });
    std::vector<Span> merged;
    for (const Span& span : spans) {
        if (!merged.empty() && merged.back().begin == span.begin) {
            merged.back().isMissing |= span.isMissing;
            continue;
        }
        if (!merged.empty()) merged.back().end = span.begin;
        merged.push_back(span);
    }
    if (!merged.empty()) merged.back().end = line.paragraph.codes.size();
    return merged;
}

Fonts::Cluster FontChooser::clusterOf(const Line& line, const Span& span) {
    const auto codes = line.paragraph.codes.begin();
    return {codes + static_cast<ptrdiff_t>(span.begin), codes + static_cast<ptrdiff_t>(span.end)};
}

/// Gives clusters that want to be pictures to fonts with colours; whether there were any.
bool FontChooser::preferPictures(Line& line) {
    bool hasChanged = false;
    for (const Span& span : spansOf(line)) {
        const Fonts::Cluster cluster = clusterOf(line, span);
        if (!wantsPicture(cluster)) continue;
        const auto isFit = [&](size_t font) {
            return mFonts[font].isColour() && hasCluster(mFonts[font], cluster);
        };
        const std::vector<size_t>& added = mFonts.added();
        const auto found = std::find_if(added.begin(), added.end(), isFit);
        std::optional<size_t> font;
        if (found != added.end()) {
            font = *found;
        } else {
            font = fallbackFor(cluster);
            if (!font || !isFit(*font)) continue;
        }
        if (*font == 0) continue;
        std::fill(line.result.fonts.begin() + static_cast<ptrdiff_t>(span.begin),
                  line.result.fonts.begin() + static_cast<ptrdiff_t>(span.end), *font);
        hasChanged = true;
    }
    return hasChanged;
}

/// Gives clusters that lack a glyph to the next font; whether there were any.
bool FontChooser::replaceMissing(Line& line) {
    bool hasChanged = false;
    for (const Span& span : spansOf(line)) {
        if (!span.isMissing) continue;
        size_t& current = line.result.fonts[span.begin];
        const size_t font = nextFont(clusterOf(line, span), line.tried[span.begin]);
        if (font == current) continue;
        std::fill(line.result.fonts.begin() + static_cast<ptrdiff_t>(span.begin),
                  line.result.fonts.begin() + static_cast<ptrdiff_t>(span.end), font);
        hasChanged = true;
    }
    return hasChanged;
}

/// The first font behind those that were tried which has the cluster; in the end the main one, which
/// shows its sign for what is missing.
size_t FontChooser::nextFont(const Fonts::Cluster& cluster, size_t& tried) {
    const std::vector<size_t>& added = mFonts.added();
    while (tried < added.size()) {
        const size_t font = added[tried++];
        if (hasCluster(mFonts[font], cluster) && font != 0) return font;
    }
    if (tried++ == added.size()) return fallbackFor(cluster).value_or(0);
    return 0;
}

std::optional<size_t> FontChooser::fallbackFor(const Fonts::Cluster& cluster) {
    const auto known = mFallbacks.find(cluster);
    if (known != mFallbacks.end()) return known->second;
    return mFallbacks[cluster] = mFonts.fallbackFor(cluster);
}

void FontChooser::noteMissing(const Line& line) {
    for (const Span& span : spansOf(line)) {
        if (!span.isMissing) continue;
        for (size_t i = span.begin; i < span.end; ++i) {
            const uint32_t code = line.paragraph.codes[i];
            if (!isDefaultIgnorable(code) && !mFonts.main().has(code))
                noteMissing(code, line.paragraph.begin + i);
        }
    }
}

void FontChooser::noteMissing(uint32_t code, size_t place) {
    const auto known = std::find_if(mMissing.begin(), mMissing.end(),
                                    [&](const MissingCharacter& each) { return each.code == code; });
    if (known == mMissing.end()) {
        mMissing.push_back({code, 1, place});
    } else {
        ++known->count;
    }
}

}  // namespace voreltext
