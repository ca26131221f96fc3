#include <dlfcn.h>

#include <cstdio>
#include <cstdlib>
#include <vector>

#include "allocation_watch.h"
#include "whole_looks.h"

/// A host that does not link the library loads a plugin that does, paints, and unloads both, over and
/// over: the pictures stay the same, nothing of the two stays in the process, and no memory.
///
///     unloading PLUGIN LIBRARY ROUNDS
namespace {

using namespace vorel_test;

bool expect(bool holds, const char* what, int round) {
    if (!holds) std::printf("FAILED: %s, round %d\n", what, round);
    return holds;
}

constexpr int kWarmRounds = 3;

using Paint = void (*)(unsigned char*);

bool isLoaded(const char* library) {
    void* const loaded = dlopen(library, RTLD_NOW | RTLD_NOLOAD);
    if (loaded != nullptr) dlclose(loaded);
    return loaded != nullptr;
}

/// One round: loads the plugin, and the library with it, paints into `pixels`, unloads.
bool paintOnce(const char* plugin, const char* library, unsigned char* pixels) {
    void* const loaded = dlopen(plugin, RTLD_NOW | RTLD_LOCAL);
    if (loaded == nullptr) {
        std::printf("%s\n", dlerror());
        return false;
    }
    const auto paint = reinterpret_cast<Paint>(dlsym(loaded, "paintWholeLooks"));
    const bool found = paint != nullptr && isLoaded(library);
    if (found) paint(pixels);
    return dlclose(loaded) == 0 && found;
}

}  // namespace

int main(int argc, char** argv) {
    const int rounds = argc == 4 ? std::atoi(argv[3]) : 0;
    if (rounds <= 0) {
        std::fprintf(stderr, "usage: unloading PLUGIN LIBRARY ROUNDS\n");
        return 2;
    }
    std::vector<uint8_t> expected;
    for (const WholeLook look : kWholeLooks) {
        const std::vector<uint8_t>& bytes = expectedPicture(look).bytes;
        expected.insert(expected.end(), bytes.begin(), bytes.end());
    }
    std::vector<uint8_t> painted(expected.size());
    bool same = true;
    long live = 0;
    for (int round = 1; round <= rounds && same; ++round) {
        std::fill(painted.begin(), painted.end(), uint8_t{0});
        same = expect(paintOnce(argv[1], argv[2], painted.data()), "the plugin paints", round) &&
               expect(painted == expected, "its pictures are those of the literal form", round) &&
               expect(!isLoaded(argv[1]) && !isLoaded(argv[2]), "both are unloaded", round);
        // The first rounds leave what the loader keeps for all later ones.
        if (round <= kWarmRounds) live = liveBlocks();
        same = same && expect(liveBlocks() == live, "no block stays", round);
    }
    if (!same) return 1;
    std::printf("%d rounds, %ld live blocks after the third and after the last\n", rounds, live);
    return 0;
}
