#include "font_finder.h"

#include <fcntl.h>
#include <fontconfig/fontconfig.h>
#include <unistd.h>

#include <array>
#include <filesystem>
#include <memory>
#include <string_view>

#include "error.h"

namespace vorelpaint {
namespace {

template <auto kDestroy>
struct Destroy {
    template <typename T>
    void operator()(T* object) const {
        kDestroy(object);
    }
};
using Config = std::unique_ptr<FcConfig, Destroy<FcConfigDestroy>>;
using FontPattern = std::unique_ptr<FcPattern, Destroy<FcPatternDestroy>>;

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
Config loadConfig() {
    const SilentErrors silence;
    return Config(FcInitLoadConfigAndFonts());
}

/// Loaded once: the jobs of a batch share it. Null when it cannot be loaded.
FcConfig* sharedConfig() {
    static const Config config = loadConfig();
    return config.get();
}

/// Names that stand for whatever family the system prefers.
constexpr std::array<std::string_view, 4> kGenericFamilies{"sans-serif", "sans", "serif", "monospace"};

bool isGeneric(std::string_view family) {
    for (const std::string_view generic : kGenericFamilies) {
        if (family == generic) return true;
    }
    return false;
}

/// fontconfig answers every request with its nearest font; only one of the family asked for counts.
bool hasFamily(const FcPattern* font, const FcChar8* family) {
    if (isGeneric(reinterpret_cast<const char*>(family))) return true;
    FcChar8* name = nullptr;
    for (int i = 0; FcPatternGetString(font, FC_FAMILY, i, &name) == FcResultMatch; ++i) {
        if (FcStrCmpIgnoreCase(name, family) == 0) return true;
    }
    return false;
}

FontFile findFamily(const std::string& request) {
    const ToolError noSuchFont("no font file or family '" + request + "'");
    FcConfig* const config = sharedConfig();
    const FontPattern wanted(FcNameParse(reinterpret_cast<const FcChar8*>(request.c_str())));
    if (config == nullptr || !wanted) throw noSuchFont;
    FcChar8* found = nullptr;
    if (FcPatternGetString(wanted.get(), FC_FAMILY, 0, &found) != FcResultMatch) throw noSuchFont;
    const std::string family = reinterpret_cast<const char*>(found);

    FcConfigSubstitute(config, wanted.get(), FcMatchPattern);
    FcDefaultSubstitute(wanted.get());
    FcResult result = FcResultNoMatch;
    const FontPattern font(FcFontMatch(config, wanted.get(), &result));
    if (!font || !hasFamily(font.get(), reinterpret_cast<const FcChar8*>(family.c_str()))) {
        throw noSuchFont;
    }
    FcChar8* file = nullptr;
    if (FcPatternGetString(font.get(), FC_FILE, 0, &file) != FcResultMatch) throw noSuchFont;
    int index = 0;
    FcPatternGetInteger(font.get(), FC_INDEX, 0, &index);
    return {reinterpret_cast<const char*>(file), index};
}

}  // namespace

FontFile findFont(const std::string& request) {
    std::error_code ignored;
    if (std::filesystem::is_regular_file(request, ignored)) return {request, 0};
    if (request.find('/') != std::string::npos) throw ToolError("no font file '" + request + "'");
    return findFamily(request);
}

}  // namespace vorelpaint
