#pragma once

#include <cstddef>
#include <filesystem>
#include <memory>
#include <optional>
#include <vector>

#include "note.h"
#include "options.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// The file of the style that is asked for; nothing where it stands in a job, or nowhere. Throws
/// ToolError or StyleError.
std::optional<std::filesystem::path> chosenStyleFile(const Options& options);

/// The style that is asked for, as its file has it; an empty one when none is. Throws ToolError or
/// StyleError.
vorelstyle::Style chosenStyle(const Options& options);

/// The looks that are asked for, for text of one size, and the colours of its markup.
class LayerSet {
  public:
    /// Notes what the library cannot paint as the style has it. Throws ToolError or StyleError.
    LayerSet(const Options& options, const vorelstyle::Style& style, int size,
             const std::vector<vorelstyle::ColourRange>& colours, const Note& note);

    const vorelstyle::Style& style() const { return mStyle; }  ///< with lengths in pixels
    const vorelstyle::Stack& stack() const { return *mStack; }
    const std::vector<voreltext::Layer>& layers() const { return mLayers; }
    size_t pictureBytes() const { return mPictureBytes; }  ///< of the pixels of its patterns

  private:
    void addColours(const Options& options, const std::vector<vorelstyle::ColourRange>& colours,
                    const Note& note);

    vorelstyle::Style mStyle;
    size_t mPictureBytes = 0;
    std::unique_ptr<vorelstyle::Stack> mStack;
    std::vector<voreltext::Layer> mLayers;
};

}  // namespace vorelpaint
