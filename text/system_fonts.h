#pragma once

#include <memory>
#include <string>

#include "text/font.h"

namespace voreltext {

/// The fonts that are installed, as fontconfig knows them; the one part of this library that needs it.
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
    FontFile find(const std::string& request) const;

  private:
    struct Config;
    std::unique_ptr<Config> mConfig;
};

}  // namespace voreltext
