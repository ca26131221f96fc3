#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

#include "compose/vorelcompose.h"
#include "text/voreltext.h"

namespace vorelscript {

/// A font that cannot be read, or is not there.
class FontError : public std::runtime_error {
  public:
    using std::runtime_error::runtime_error;
};

/// Fonts of bytes, by the names that they were given.
class ByteFonts : public vorelcompose::FontSource {
  public:
    /// The name of a font and its family.
    struct Names {
        std::string name;
        std::string family;
    };

    /// Throws FontError for what is no font and for a name that is taken.
    Names add(const std::string& name, std::vector<uint8_t> bytes, long faceIndex);

    /// What keeps the bytes of all fonts of now.
    using Held = std::vector<std::shared_ptr<const std::vector<uint8_t>>>;
    Held held() const;

    /// A font of these bytes that is still open needs somebody who holds them.
    void remove(const std::string& name) { mFiles.erase(name); }

    /// Throws FontError.
    Found find(const std::string& request) override;
    /// Throws FontError for variations that it has not.
    voreltext::Font open(const voreltext::FontFile& file, int size,
                         const std::vector<voreltext::FontVariation>& variations) override;
    /// None: what no font of a text has is missing.
    std::optional<voreltext::FontFile> fallback(const voreltext::Cluster& cluster,
                                                const voreltext::FontFile& main) override;

  private:
    struct File {
        std::shared_ptr<const std::vector<uint8_t>> bytes;
        long faceIndex;
    };

    std::map<std::string, File> mFiles;
};

}  // namespace vorelscript
