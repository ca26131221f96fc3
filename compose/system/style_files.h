#pragma once

#include <cstddef>
#include <filesystem>
#include <string>

#include "compose/file_mark.h"
#include "compose/layer_set.h"
#include "compose/shelf.h"
#include "style/vorelstyle.h"

namespace vorelcompose {

/// Reads a style file. Throws ComposeError when it cannot be read, StyleError, naming the file, when it
/// is wrong.
vorelstyle::Style loadStyle(const std::filesystem::path& path);

/// Loads the pictures of a style from PNG files, whose paths start beside the style's own file.
vorelstyle::LoadImage imagesOf(const vorelstyle::Style& style);

/// A style that was not read by a StyleShelf, with the pictures of its patterns.
FoundStyle foundStyle(vorelstyle::Style style);

/// Styles that were read from files, kept from one text to the next: kMostStyles. A file that has
/// changed is read anew. For one thread.
class StyleShelf {
  public:
    static constexpr size_t kMostStyles = 32;

    /// Throws ComposeError or StyleError, as loadStyle.
    FoundStyle style(const std::filesystem::path& path);

  private:
    /// What a file had in it.
    struct Key {
        std::string path;
        FileMark mark;

        bool operator==(const Key& other) const;
    };

    Shelf<Key, const vorelstyle::Style> mStyles{kMostStyles};
};

}  // namespace vorelcompose
