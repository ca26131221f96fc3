#pragma once

#include <optional>
#include <string>
#include <vector>

#include "compose/file_mark.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// Where the fonts of requests come from. Several threads may ask one at a time.
class FontSource {
  public:
    /// A font as it was found; the same again means the same bytes.
    struct Found {
        voreltext::FontFile file;  ///< under a name that its source knows, be it a file's or not
        FileMark mark;
    };

    FontSource() = default;
    virtual ~FontSource() = default;
    FontSource(const FontSource&) = delete;
    FontSource& operator=(const FontSource&) = delete;

    /// The font that a request names. Throws ComposeError or TextError when there is none.
    virtual Found find(const std::string& request) = 0;

    /// One of those that were found, or that fallback named. Throws TextError.
    virtual voreltext::Font open(const voreltext::FontFile& file, int size,
                                 const std::vector<voreltext::FontVariation>& variations) = 0;

    /// A file with all characters of a cluster, in a style like that of the main font; nothing when
    /// there is none.
    virtual std::optional<voreltext::FontFile> fallback(const voreltext::Cluster& cluster,
                                                        const voreltext::FontFile& main) = 0;
};

}  // namespace vorelcompose
