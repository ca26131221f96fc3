#include "font_choice.h"

#include <fcntl.h>
#include <unistd.h>

#include <memory>

namespace vorelpaint {
namespace {

using voreltext::SystemFonts;

/// While it lives, what is written to standard error is lost.
class SilentErrors {
  public:
    SilentErrors() : mSaved(::dup(STDERR_FILENO)) {
        const int nowhere = ::open("/dev/null", O_WRONLY);
        if (mSaved >= 0 && nowhere >= 0) ::dup2(nowhere, STDERR_FILENO);
        if (nowhere >= 0) ::close(nowhere);
    }
    ~SilentErrors() {
        if (mSaved < 0) return;
        ::dup2(mSaved, STDERR_FILENO);
        ::close(mSaved);
    }
    SilentErrors(const SilentErrors&) = delete;
    SilentErrors& operator=(const SilentErrors&) = delete;

  private:
    int mSaved;
};

/// Without fontconfig's own complaints: what fails for want of fonts says so in the program's one line.
std::unique_ptr<SystemFonts> loadFonts() {
    const SilentErrors silence;
    return std::make_unique<SystemFonts>();
}

}  // namespace

vorelcompose::SystemFontSource& fontSource() {
    static vorelcompose::SystemFontSource fonts(loadFonts);
    return fonts;
}

void loadInstalledFonts() {
    fontSource().load();
}

voreltext::FontFile findFont(const std::string& request) {
    return fontSource().find(request).file;
}

}  // namespace vorelpaint
