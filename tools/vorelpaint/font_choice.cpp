#include "font_choice.h"

#include <fcntl.h>
#include <unistd.h>

#include <filesystem>

#include "error.h"

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
SystemFonts loadFonts() {
    const SilentErrors silence;
    return SystemFonts();
}

/// Loaded once: the jobs of a batch share them.
const SystemFonts& systemFonts() {
    static const SystemFonts fonts = loadFonts();
    return fonts;
}

}  // namespace

voreltext::FontFile findFont(const std::string& request) {
    std::error_code ignored;
    if (std::filesystem::is_regular_file(request, ignored)) return {request, 0};
    if (request.find('/') != std::string::npos) throw ToolError("no font file '" + request + "'");
    return systemFonts().find(request);
}

std::optional<voreltext::FontFile> findFontFor(const voreltext::Cluster& cluster,
                                               const voreltext::FontFile& main) {
    return systemFonts().findFor(cluster, main);
}

}  // namespace vorelpaint
