#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <utility>
#include <vector>

#include "text/clusters.h"
#include "text/font.h"

namespace voreltext {

/// The fonts of a text in the order in which they are asked for a character. The first is the main one:
/// the metrics of lines are its alone.
class Fonts {
  public:
    /// Names a font for a cluster; nothing when there is none.
    using Fallback = std::function<std::optional<FontFile>(const Cluster& cluster)>;

    explicit Fonts(Font main);

    /// Behind those that were added before.
    void add(Font font);

    /// Asked for a cluster that no font has which was added. What it names is opened at the size of the
    /// main font, once, and kept: at most kMostFallbacks fonts. What cannot be opened counts as none.
    void setFallback(Fallback fallback) { mFallback = std::move(fallback); }
    static constexpr size_t kMostFallbacks = 64;

    const Font& main() const { return *mFonts.front(); }
    size_t count() const { return mFonts.size(); }  ///< with those that the fallback named
    const Font& operator[](size_t index) const { return *mFonts[index]; }

    /// The indices of those that were added, the main one first.
    const std::vector<size_t>& added() const { return mAdded; }

    /// The index of the font that the fallback names, if it has the cluster's characters.
    std::optional<size_t> fallbackFor(const Cluster& cluster);

  private:
    struct Opened {
        FontFile file;
        std::optional<size_t> font;  ///< none when it cannot be opened
    };

    std::optional<size_t> opened(const FontFile& file);

    std::vector<std::unique_ptr<const Font>> mFonts;
    std::vector<size_t> mAdded;
    std::vector<Opened> mOpened;
    Fallback mFallback;
};

/// Whether the font has the cluster; marks that show nothing by themselves do not count.
bool hasCluster(const Font& font, const Cluster& cluster);

}  // namespace voreltext
