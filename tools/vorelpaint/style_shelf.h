#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "file_mark.h"
#include "layer_set.h"
#include "note.h"
#include "options.h"
#include "shelf.h"
#include "style/vorelstyle.h"

namespace vorelpaint {

/// Styles that were read from files, and their looks, kept from one text to the next: kMostStyles and
/// kMostLooks, these with at most kMostPictureBytes of patterns. A file that has changed is read anew.
/// For one thread.
class StyleShelf {
  public:
    static constexpr size_t kMostStyles = 32;
    static constexpr size_t kMostLooks = 32;
    static constexpr size_t kMostPictureBytes = size_t{64} << 20;  ///< one of the largest there may be

    /// The style that is asked for, as LayerSet makes it for text of one size; it notes the same when it
    /// is kept. Throws ToolError or StyleError.
    std::shared_ptr<const LayerSet> looks(const Options& options, int size,
                                          const std::vector<vorelstyle::ColourRange>& colours,
                                          const Note& note);

  private:
    /// What a file had in it.
    struct StyleKey {
        std::string path;
        FileMark mark;

        bool operator==(const StyleKey& other) const;
    };
    struct LooksKey {
        std::shared_ptr<const vorelstyle::Style> style;  ///< one that was read once is one
        std::vector<FileMark> pictures;                  ///< of its patterns
        int size;
        float effectScale;
        std::optional<uint32_t> color;
        std::optional<float> opacity;
        std::vector<vorelstyle::ColourRange> colours;

        bool operator==(const LooksKey& other) const;
    };
    struct NotedLooks {
        HeldNotes notes;
        std::optional<LayerSet> looks;
    };

    struct ChosenStyle {
        std::shared_ptr<const vorelstyle::Style> style;
        bool isKept;  ///< and may come again
    };

    ChosenStyle style(const Options& options);

    Shelf<StyleKey, const vorelstyle::Style> mStyles{kMostStyles};
    Shelf<LooksKey, const NotedLooks> mLooks{kMostLooks, kMostPictureBytes};
};

}  // namespace vorelpaint
