#include "compose/font_shelf.h"

#include <algorithm>
#include <optional>

namespace vorelcompose {
namespace {

using voreltext::Cluster;
using voreltext::FontFile;
using voreltext::FontVariation;

bool areSame(const FontSource::Found& one, const FontSource::Found& other) {
    return one.file.path == other.file.path && one.file.faceIndex == other.file.faceIndex &&
           one.mark == other.mark;
}

bool areSame(const FontVariation& one, const FontVariation& other) {
    return one.axis == other.axis && one.value == other.value;
}

template <typename Each>
bool areAllSame(const std::vector<Each>& ones, const std::vector<Each>& others) {
    return std::equal(ones.begin(), ones.end(), others.begin(), others.end(),
                      [](const Each& one, const Each& other) { return areSame(one, other); });
}

}  // namespace

bool FontsKey::operator==(const FontsKey& other) const {
    return areAllSame(files, other.files) && areAllSame(variations, other.variations);
}

OpenFonts::OpenFonts(FontSource& source, const FontsKey& key, int size)
    : mFonts(source.open(key.files.front().file, size, key.variations)) {
    for (size_t i = 1; i < key.files.size(); ++i)
        mFonts.add(source.open(key.files[i].file, size, {}));
    mFonts.setFallback([this, &source, main = key.files.front().file](const Cluster& cluster) {
        std::optional<FontFile> file = source.fallback(cluster, main);
        if (file) mFallbacks.emplace(file->path, file->faceIndex);
        return file;
    });
}

FontsKey FontShelf::keyOf(const Request& request) {
    FontsKey key{{}, request.variations};
    for (const std::string& font : request.fonts)
        key.files.push_back(mSource.find(font));
    return key;
}

std::shared_ptr<OpenFonts> FontShelf::open(const FontsKey& key, int size) {
    std::shared_ptr<OpenFonts> kept = mOpen.find({key, size});
    return kept ? kept : fresh(key, size);
}

std::shared_ptr<OpenFonts> FontShelf::fresh(const FontsKey& key, int size) {
    auto opened = std::make_shared<OpenFonts>(mSource, key, size);
    mOpen.keep({key, size}, opened, key.files.size());
    return opened;
}

}  // namespace vorelcompose
