#include "font_choice.h"

#include <fcntl.h>
#include <unistd.h>

#include <filesystem>
#include <mutex>

#include "error.h"

namespace vorelpaint {
namespace {

using voreltext::FontFile;
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

/// The jobs of a batch share them, one thread at a time.
class InstalledFonts {
  public:
    FontFile find(const std::string& request) const {
        const std::lock_guard<std::mutex> alone(mMutex);
        return mFonts.find(request);
    }
    std::optional<FontFile> findFor(const voreltext::Cluster& cluster, const FontFile& main) const {
        const std::lock_guard<std::mutex> alone(mMutex);
        return mFonts.findFor(cluster, main);
    }

  private:
    SystemFonts mFonts = loadFonts();
    mutable std::mutex mMutex;
};

/// Loaded once.
const InstalledFonts& installedFonts() {
    static const InstalledFonts fonts;
    return fonts;
}

}  // namespace

void loadInstalledFonts() {
    installedFonts();
}

bool namesFontFile(const std::string& request) {
    std::error_code ignored;
    return request.find('/') != std::string::npos || std::filesystem::is_regular_file(request, ignored);
}

FontFile findFont(const std::string& request) {
    std::error_code ignored;
    if (std::filesystem::is_regular_file(request, ignored)) return {request, 0};
    if (namesFontFile(request)) throw ToolError("no font file '" + request + "'");
    return installedFonts().find(request);
}

std::optional<FontFile> findFontFor(const voreltext::Cluster& cluster, const FontFile& main) {
    return installedFonts().findFor(cluster, main);
}

}  // namespace vorelpaint
