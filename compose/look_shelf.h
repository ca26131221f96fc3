#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <vector>

#include "compose/file_mark.h"
#include "compose/layer_set.h"
#include "compose/note.h"
#include "compose/request.h"
#include "compose/shelf.h"
#include "style/vorelstyle.h"

namespace vorelcompose {

/// The looks of styles, kept from one text to the next: kMostLooks, with at most kMostPictureBytes of
/// patterns. For one thread.
class LookShelf {
  public:
    static constexpr size_t kMostLooks = 32;
    static constexpr size_t kMostPictureBytes = size_t{64} << 20;  ///< one of the largest there may be

    /// The style as LayerSet makes it for text of one size; it notes the same when it is kept. Throws
    /// StyleError.
    std::shared_ptr<const LayerSet> looks(const Request& request, const FoundStyle& found, int size,
                                          const std::vector<vorelstyle::ColourRange>& colours,
                                          const Note& note);

  private:
    /// What a look is made of.
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

    Shelf<LooksKey, const NotedLooks> mLooks{kMostLooks, kMostPictureBytes};
};

}  // namespace vorelcompose
