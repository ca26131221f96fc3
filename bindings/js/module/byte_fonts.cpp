#include "byte_fonts.h"

#include <utility>

#include "style/vorelstyle.h"

namespace vorelscript {
namespace {

/// Any that the metrics of a font are good for.
constexpr int kTriedSize = 64;

std::string quoted(const std::string& name) {
    return "'" + vorelstyle::printable(name) + "'";
}

voreltext::Font opened(const std::string& name, const voreltext::FontBytes& bytes, int size,
                       const std::vector<voreltext::FontVariation>& variations) {
    try {
        return voreltext::Font(bytes, size, variations);
    } catch (const voreltext::TextError& error) {
        throw FontError("font " + quoted(name) + ": " + error.what());
    }
}

}  // namespace

ByteFonts::Names ByteFonts::add(const std::string& name, std::vector<uint8_t> bytes, long faceIndex) {
    if (mFiles.count(name) != 0) throw FontError("a font " + quoted(name) + " is there already");
    const voreltext::Font font = opened(name, {bytes.data(), bytes.size(), faceIndex}, kTriedSize, {});
    mFiles[name] = {std::make_shared<const std::vector<uint8_t>>(std::move(bytes)), faceIndex};
    return {font.name(), font.family()};
}

ByteFonts::Held ByteFonts::held() const {
    Held held;
    for (const auto& [name, file] : mFiles)
        held.push_back(file.bytes);
    return held;
}

vorelcompose::FontSource::Found ByteFonts::find(const std::string& request) {
    const auto file = mFiles.find(request);
    if (file == mFiles.end()) throw FontError("there is no font " + quoted(request));
    return {{request, file->second.faceIndex}, {}};
}

voreltext::Font ByteFonts::open(const voreltext::FontFile& file, int size,
                                const std::vector<voreltext::FontVariation>& variations) {
    const File& found = mFiles.at(file.path);
    return opened(file.path, {found.bytes->data(), found.bytes->size(), found.faceIndex}, size,
                  variations);
}

std::optional<voreltext::FontFile> ByteFonts::fallback(const voreltext::Cluster& /*cluster*/,
                                                       const voreltext::FontFile& /*main*/) {
    return std::nullopt;
}

}  // namespace vorelscript
