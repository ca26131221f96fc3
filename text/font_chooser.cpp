#include "text/font_chooser.h"

#include <algorithm>

#include "unicode/characters.h"

namespace voreltext {
namespace {

void assign(std::vector<size_t>& fonts, size_t begin, size_t end, size_t font) {
    std::fill(fonts.begin() + static_cast<ptrdiff_t>(begin), fonts.begin() + static_cast<ptrdiff_t>(end),
              font);
}

}  // namespace

struct FontChooser::Line {
    explicit Line(const Paragraph& from) : paragraph(from), tried(from.codes.size()) {
        result.fonts.resize(from.codes.size());
    }

    const Paragraph& paragraph;
    std::vector<size_t> tried;  ///< for the first character of each cluster how many fonts had it
    FontedParagraph result;
};

FontedParagraph FontChooser::choose(const Paragraph& paragraph) {
    Line line(paragraph);
    shape(line);
    if (preferPresentations(line)) shape(line);
    // Another font beside it may take a cluster's glyph from it: the passes are counted as well.
    for (size_t pass = 0; pass < mFonts.added().size() + 2 && replaceMissing(line); ++pass)
        shape(line);
    noteMissing(line);
    return std::move(line.result);
}

void FontChooser::shape(Line& line) {
    const Paragraph& paragraph = line.paragraph;
    line.result.glyphs =
        mShaper.shape({paragraph.codes.data(), line.result.fonts.data(), paragraph.scripts.data(),
                       paragraph.levels.data(), paragraph.codes.size(), paragraph.isRightToLeft});
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

Cluster FontChooser::clusterOf(const Line& line, const Span& span) {
    const auto codes = line.paragraph.codes.begin();
    return {codes + static_cast<ptrdiff_t>(span.begin), codes + static_cast<ptrdiff_t>(span.end)};
}

/// Gives clusters that ask for colours, or for none, to fonts that have them so; whether there were any.
bool FontChooser::preferPresentations(Line& line) {
    bool hasChanged = false;
    for (const Span& span : spansOf(line)) {
        const Cluster cluster = clusterOf(line, span);
        const Presentation presentation = presentationOf(cluster);
        if (presentation == Presentation::any) continue;
        const auto font = fontFor(cluster, presentation == Presentation::picture);
        if (!font || *font == 0) continue;
        assign(line.result.fonts, span.begin, span.end, *font);
        hasChanged = true;
    }
    return hasChanged;
}

/// The first font with colours, or the first without, that has the cluster.
std::optional<size_t> FontChooser::fontFor(const Cluster& cluster, bool isColour) {
    const auto isFit = [&](size_t font) {
        return mFonts[font].isColour() == isColour && hasCluster(mFonts[font], cluster);
    };
    const std::vector<size_t>& added = mFonts.added();
    const auto found = std::find_if(added.begin(), added.end(), isFit);
    if (found != added.end()) return *found;
    const auto fallback = fallbackFor(cluster);
    return fallback && isFit(*fallback) ? fallback : std::nullopt;
}

/// Gives clusters that lack a glyph to the next font; whether there were any.
bool FontChooser::replaceMissing(Line& line) {
    bool hasChanged = false;
    for (const Span& span : spansOf(line)) {
        if (!span.isMissing) continue;
        const size_t current = line.result.fonts[span.begin];
        const size_t font = nextFont(clusterOf(line, span), line.tried[span.begin]);
        if (font == current) continue;
        assign(line.result.fonts, span.begin, span.end, font);
        hasChanged = true;
    }
    return hasChanged;
}

/// The first font behind those that were tried which has the cluster; in the end the main one, which
/// shows its sign for what is missing.
size_t FontChooser::nextFont(const Cluster& cluster, size_t& tried) {
    const std::vector<size_t>& added = mFonts.added();
    while (tried < added.size()) {
        const size_t font = added[tried++];
        if (hasCluster(mFonts[font], cluster) && font != 0) return font;
    }
    if (tried++ == added.size()) return fallbackFor(cluster).value_or(0);
    return 0;
}

std::optional<size_t> FontChooser::fallbackFor(const Cluster& cluster) {
    const auto known = mFallbacks.find(cluster);
    if (known != mFallbacks.end()) return known->second;
    return mFallbacks[cluster] = mFonts.fallbackFor(cluster);
}

void FontChooser::noteMissing(const Line& line) {
    for (const Span& span : spansOf(line)) {
        if (!span.isMissing) continue;
        for (size_t i = span.begin; i < span.end; ++i) {
            const uint32_t code = line.paragraph.codes[i];
            if (!vorelunicode::isDefaultIgnorable(code) && !mFonts.main().has(code))
                noteMissing(code, line.paragraph.begin + i);
        }
    }
}

void FontChooser::noteMissing(uint32_t code, size_t place) {
    const auto [known, isNew] = mPlaces.emplace(code, mMissing.size());
    if (isNew) mMissing.push_back({code, 0, place});
    ++mMissing[known->second].count;
}

}  // namespace voreltext
