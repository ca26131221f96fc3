#include "text/wrapping.h"

#include "text/line_breaks.h"
#include "unicode/characters.h"

namespace voreltext {

Wrapping::Wrapping(const Paragraph& paragraph, const std::vector<ShapedGlyph>& glyphs) {
    const std::vector<uint32_t>& codes = paragraph.codes;
    const size_t places = codes.size() + 1;
    mClusters.resize(places);
    mReach.resize(places);
    measure(glyphs);
    const std::vector<bool> breaks = lineBreaks(codes);
    mWords.resize(places);
    mHyphens.resize(places);
    mInkEnds.resize(places);
    for (size_t at = 1; at < places; ++at) {
        const bool isHyphen = codes[at - 1] == vorelunicode::kSoftHyphen;
        // A ligature may bridge a soft hyphen, which is asked to part it.
        mWords[at] = breaks[at - 1] && (mClusters[at] || isHyphen);
        mHyphens[at] = isHyphen && at + 1 < places;
        mInkEnds[at] = vorelunicode::isBlank(codes[at - 1]) ? mInkEnds[at - 1] : at;
    }
}

/// Of a cluster of several characters each has its share of the advance.
void Wrapping::measure(const std::vector<ShapedGlyph>& glyphs) {
    const size_t end = mReach.size() - 1;
    std::vector<int64_t> advances(end);
    for (const ShapedGlyph& glyph : glyphs) {
        mClusters[glyph.cluster] = true;
        advances[glyph.cluster] += glyph.advance;
    }
    mClusters[end] = true;
    for (size_t begin = 0; begin < end;) {
        size_t next = begin + 1;
        while (!mClusters[next])
            ++next;
        for (size_t at = begin + 1; at <= next; ++at) {
            const auto share = static_cast<int64_t>(at - begin);
            mReach[at] = mReach[begin] + advances[begin] * share / static_cast<int64_t>(next - begin);
        }
        begin = next;
    }
}

size_t Wrapping::lastFitting(Ends ends, size_t begin, int64_t atMost) const {
    size_t fitting = endAfter(ends, begin);
    for (size_t at = fitting; at > begin; at = endAfter(ends, at)) {
        if (this->width(begin, at) > atMost) break;
        fitting = at;
        if (at + 1 == mReach.size()) break;
    }
    return fitting;
}

size_t Wrapping::endAfter(Ends ends, size_t end) const {
    if (end + 1 == mReach.size()) return end;
    ++end;
    while (!isEnd(ends, end))
        ++end;
    return end;
}

size_t Wrapping::endBefore(Ends ends, size_t end, size_t begin) const {
    --end;
    while (end > begin && !isEnd(ends, end))
        --end;
    return end;
}

/// Whether the longer part shows nothing that the shorter one does not.
bool Wrapping::isAsWide(size_t begin, size_t end, size_t longer) const {
    return width(begin, end) == width(begin, longer) && mHyphens[end] >= mHyphens[longer];
}

size_t Wrapping::longer(Ends ends, size_t begin, size_t end) const {
    size_t at = endAfter(ends, end);
    size_t next = endAfter(ends, at);
    while (next > at && isAsWide(begin, at, next)) {
        at = next;
        next = endAfter(ends, at);
    }
    return at;
}

size_t Wrapping::shorter(Ends ends, size_t begin, size_t end) const {
    size_t at = endBefore(ends, end, begin);
    while (at > begin && isAsWide(begin, at, end))
        at = endBefore(ends, at, begin);
    return at;
}

}  // namespace voreltext
