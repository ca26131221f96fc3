#pragma once

#include <cstddef>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "file_mark.h"
#include "options.h"
#include "shelf.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// What the fonts of a text are made of, but for their size.
struct FontsKey {
    struct File {
        std::string path;
        long faceIndex;
        FileMark mark;
    };
    std::vector<File> files;  ///< in the order in which they are asked; never empty
    std::vector<voreltext::FontVariation> variations;

    bool operator==(const FontsKey& other) const;
};

/// The fonts of texts in one size, open.
class OpenFonts {
  public:
    /// Throws TextError.
    OpenFonts(const FontsKey& key, int size);
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

    /// What the fonts that are asked for are made of. Throws ToolError or TextError where one is not
    /// there.
    FontsKey keyOf(const Options& options);

    /// The kept ones, or else `fresh` ones, which are kept then.
    std::shared_ptr<OpenFonts> open(const FontsKey& key, int size);
    std::shared_ptr<OpenFonts> fresh(const FontsKey& key, int size);

  private:
    static constexpr size_t kMostNames = 64;

    voreltext::FontFile fileOf(const std::string& request);

    Shelf<std::string, voreltext::FontFile> mInstalled{kMostNames};
    Shelf<std::pair<FontsKey, int>, OpenFonts> mOpen{kMostSets, kMostFiles};
};

}  // namespace vorelpaint
