#pragma once

#include <memory>
#include <optional>
#include <string>

#include "text/clusters.h"
#include "text/font.h"

namespace voreltext {

/// The fonts that are installed, as fontconfig knows them; the one part of this library that needs it.
/// They are chosen alike whatever the language of the environment.
/// For one thread at a time.
class SystemFonts {
  public:
    /// Reads the configuration, which takes a while. fontconfig itself may complain about it on standard
    /// error; without any, no family is found.
    SystemFonts();
    ~SystemFonts();
    SystemFonts(const SystemFonts&) = delete;
    SystemFonts& operator=(const SystemFonts&) = delete;

    /// The font of a family as fontconfig writes it ("DejaVu Serif", "DejaVu Sans:bold"). Throws
    /// TextError when there is no such family, when it has no face as asked for, and where fontconfig
    /// would read past a word that it does not know. Italic and oblique stand for each other.
    /// A misspelt name or style is told the nearest that there is.
    FontFile find(const std::string& request) const;

    /// The font that has a cluster of a text which is set in the font `like`: the one most like it in
    /// family and style, but one with colours for emoji unless they ask for none. Nothing when there is
    /// none. What was found is kept: to be asked for every cluster of a text is quick. Good for
    /// Fonts::setFallback.
    std::optional<FontFile> findFor(const Cluster& cluster, const FontFile& like) const;

  private:
    struct Config;
    std::unique_ptr<Config> mConfig;
};

}  // namespace voreltext
