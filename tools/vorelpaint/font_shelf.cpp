#include "font_shelf.h"

#include <algorithm>
#include <optional>

#include "font_choice.h"

namespace vorelpaint {
namespace {

using voreltext::Cluster;
using voreltext::Font;
using voreltext::FontFile;
using voreltext::FontVariation;

FontFile fontFileOf(const FontsKey::File& file) {
    return {file.path, file.faceIndex};
}

bool areSame(const FontsKey::File& one, const FontsKey::File& other) {
    return one.path == other.path && one.faceIndex == other.faceIndex && one.mark == other.mark;
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

OpenFonts::OpenFonts(const FontsKey& key, int size)
    : mFonts(Font(fontFileOf(key.files.front()), size, key.variations)) {
    for (size_t i = 1; i < key.files.size(); ++i)
        mFonts.add(Font(fontFileOf(key.files[i]), size));
    const FontFile main = fontFileOf(key.files.front());
    mFonts.setFallback([this, main](const Cluster& cluster) {
        std::optional<FontFile> file = findFontFor(cluster, main);
        if (file) mFallbacks.emplace(file->path, file->faceIndex);
        return file;
    });
}

FontsKey FontShelf::keyOf(const Options& options) {
    FontsKey key{{}, options.variations};
    for (const std::string& request : options.fonts) {
        const FontFile file = fileOf(request);
        key.files.push_back({file.path, file.faceIndex, markOf(file.path)});
    }
    return key;
}

/// fontconfig takes a while to find one.
FontFile FontShelf::fileOf(const std::string& request) {
    if (namesFontFile(request)) return findFont(request);
    if (const std::shared_ptr<FontFile> kept = mInstalled.find(request)) return *kept;
    mInstalled.keep(request, std::make_shared<FontFile>(findFont(request)));
    return *mInstalled.find(request);
}

std::shared_ptr<OpenFonts> FontShelf::open(const FontsKey& key, int size) {
    std::shared_ptr<OpenFonts> kept = mOpen.find({key, size});
    return kept ? kept : fresh(key, size);
}

std::shared_ptr<OpenFonts> FontShelf::fresh(const FontsKey& key, int size) {
    auto opened = std::make_shared<OpenFonts>(key, size);
    mOpen.keep({key, size}, opened, key.files.size());
    return opened;
}

}  // namespace vorelpaint
