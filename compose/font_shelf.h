#pragma once

#include <cstddef>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "compose/font_source.h"
#include "compose/request.h"
#include "compose/shelf.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// What the fonts of a text are made of, but for their size.
struct FontsKey {
    std::vector<FontSource::Found> files;  ///< in the order in which they are asked; never empty
    std::vector<voreltext::FontVariation> variations;

    bool operator==(const FontsKey& other) const;
};

/// The fonts of texts in one size, open.
class OpenFonts {
  public:
    /// Throws TextError.
    OpenFonts(FontSource& source, const FontsKey& key, int size);
    OpenFonts(const OpenFonts&) = delete;
    OpenFonts& operator=(const OpenFonts&) = delete;

    voreltext::Fonts& fonts() { return mFonts; }

    /// How many files were named as fonts of clusters that no other has. Fonts opens the first
    /// kMostFallbacks; beyond, what a text gets would depend on the texts before it.
    size_t fallbacks() const { return mFallbacks.size(); }

  private:
    voreltext::Fonts mFonts;
    std::set<std::pair<std::string, long>> mFallbacks;
};

/// Fonts, kept open from one text to the next: kMostSets sets of them, each of one size, of kMostFiles
/// files that were asked for. For one thread.
class FontShelf {
  public:
    static constexpr size_t kMostSets = 32;
    static constexpr size_t kMostFiles = 64;

    /// The source must outlive the shelf and what it gave.
    explicit FontShelf(FontSource& source) : mSource(source) {}

    /// What the fonts that are asked for are made of. Throws ComposeError or TextError where one is not
    /// there.
    FontsKey keyOf(const Request& request);

    /// The kept ones, or else `fresh` ones, which are kept then.
    std::shared_ptr<OpenFonts> open(const FontsKey& key, int size);
    std::shared_ptr<OpenFonts> fresh(const FontsKey& key, int size);

  private:
    FontSource& mSource;
    Shelf<std::pair<FontsKey, int>, OpenFonts> mOpen{kMostSets, kMostFiles};
};

}  // namespace vorelcompose
