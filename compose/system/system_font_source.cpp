#include "compose/system/system_font_source.h"

#include <filesystem>
#include <utility>

#include "compose/error.h"
#include "compose/system/mark_of.h"

namespace vorelcompose {

using voreltext::FontFile;
using voreltext::SystemFonts;

SystemFontSource::SystemFontSource(Load load) : mLoad(std::move(load)) {}

void SystemFontSource::load() {
    const std::lock_guard<std::mutex> alone(mMutex);
    installed();
}

FontSource::Found SystemFontSource::find(const std::string& request) {
    std::error_code ignored;
    const bool isFile = std::filesystem::is_regular_file(request, ignored);
    if (!isFile && request.find('/') != std::string::npos) {
        throw ComposeError("no font file '" + request + "'");
    }
    const FontFile file = isFile ? FontFile{request, 0} : findInstalled(request);
    return {file, markOf(file.path)};
}

voreltext::Font SystemFontSource::open(const FontFile& file, int size,
                                       const std::vector<voreltext::FontVariation>& variations) {
    return {file, size, variations};
}

std::optional<FontFile> SystemFontSource::fallback(const voreltext::Cluster& cluster,
                                                   const FontFile& main) {
    const std::lock_guard<std::mutex> alone(mMutex);
    return installed().findFor(cluster, main);
}

FontFile SystemFontSource::findInstalled(const std::string& request) {
    const std::lock_guard<std::mutex> alone(mMutex);
    if (const std::shared_ptr<FontFile> kept = mNamed.find(request)) return *kept;
    const auto found = std::make_shared<FontFile>(installed().find(request));
    mNamed.keep(request, found);
    return *found;
}

SystemFonts& SystemFontSource::installed() {
    if (!mInstalled) mInstalled = mLoad();
    return *mInstalled;
}

}  // namespace vorelcompose
