#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

#include "text/paragraphs.h"
#include "text/shaper.h"

namespace voreltext {

/// Where a source line may be broken and about how wide its parts are.
///
/// The widths are those of the clusters of the whole line. Its parts, shaped by themselves, may differ:
/// letters at the new ends have another form, pairs are kerned no more, hyphens appear.
class Wrapping {
  public:
    /// `glyphs` are those of the whole line.
    Wrapping(const Paragraph& paragraph, const std::vector<ShapedGlyph>& glyphs);

    /// Where lines may end: between words, or, in words that are too wide, between all clusters.
    enum class Ends { ofWords, ofClusters };

    /// The last end behind `begin` up to which a part is no wider than `atMost`, else the first end.
    size_t lastFitting(Ends ends, size_t begin, int64_t atMost) const;

    /// The end after or before `end`; `end` itself at the end of the line, `begin` where there is none.
    size_t endAfter(Ends ends, size_t end) const;
    size_t endBefore(Ends ends, size_t end, size_t begin) const;

    /// The end after or before that changes what is seen of the part from `begin`: past characters that
    /// show nothing, of which a text may have any number.
    size_t longer(Ends ends, size_t begin, size_t end) const;
    size_t shorter(Ends ends, size_t begin, size_t end) const;

    /// Whether a part that ends here ends with a hyphen, at a soft one.
    bool isHyphenated(size_t end) const { return mHyphens[end]; }

    /// About how wide a part is without the blanks behind it, in 64ths of a pixel.
    int64_t width(size_t begin, size_t end) const {
        return mReach[withoutBlanks(begin, end)] - mReach[begin];
    }

    /// The end of a part without the blanks behind it, which are not seen.
    size_t withoutBlanks(size_t begin, size_t end) const { return std::max(begin, mInkEnds[end]); }

  private:
    bool isEnd(Ends ends, size_t at) const { return ends == Ends::ofWords ? mWords[at] : mClusters[at]; }
    bool isAsWide(size_t begin, size_t end, size_t longer) const;
    void measure(const std::vector<ShapedGlyph>& glyphs);

    // For each place between characters, from before the first to behind the last:
    std::vector<bool> mWords;      ///< a line may end here
    std::vector<bool> mClusters;   ///< no cluster is cut here
    std::vector<bool> mHyphens;    ///< a soft hyphen is before, and more of the text behind
    std::vector<int64_t> mReach;   ///< the advance up to here, in 64ths of a pixel
    std::vector<size_t> mInkEnds;  ///< the last place before blanks that lead up to here
};

}  // namespace voreltext
