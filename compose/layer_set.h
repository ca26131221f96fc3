#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "compose/file_mark.h"
#include "compose/note.h"
#include "compose/request.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// A style and the pictures of its patterns.
struct FoundStyle {
    std::shared_ptr<const vorelstyle::Style> style;
    vorelstyle::LoadImage load;
    std::vector<FileMark> pictures = {};  ///< of its patterns
    bool isKept = false;  ///< the same object may come again, as long as it is what its source has
};

/// The looks that are asked for, for text of one size, and the colours of its markup.
class LayerSet {
  public:
    /// Notes what the library cannot paint as the style has it. Throws StyleError.
    LayerSet(const Request& request, const vorelstyle::Style& style, const vorelstyle::LoadImage& load,
             int size, const std::vector<vorelstyle::ColourRange>& colours, const Note& note);

    const vorelstyle::Style& style() const { return mStyle; }  ///< with lengths in pixels
    const vorelstyle::Stack& stack() const { return *mStack; }
    const std::vector<voreltext::Layer>& layers() const { return mLayers; }
    size_t pictureBytes() const { return mPictureBytes; }  ///< of the pixels of its patterns

  private:
    void addColours(const Request& request, const std::vector<vorelstyle::ColourRange>& colours,
                    const Note& note);

    vorelstyle::Style mStyle;
    size_t mPictureBytes = 0;
    std::unique_ptr<vorelstyle::Stack> mStack;
    std::vector<voreltext::Layer> mLayers;
};

}  // namespace vorelcompose
