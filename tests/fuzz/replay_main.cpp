/// Runs inputs through a fuzz target without a fuzzer: every file named on the command line and every
/// file of a directory named there, each at every level of the instruction set. Whatever stops the
/// fuzzer stops this program.
#include <dirent.h>

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <string>
#include <vector>

#include "tests/support/file_bytes.h"
#if defined(VOREL_FUZZ_PAINTS)
#include "level_of_input.h"
#endif

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

namespace {

/// A file itself, or the files of a directory in a fixed order.
std::vector<std::string> filesOf(const std::string& path) {
    DIR* const directory = opendir(path.c_str());
    if (directory == nullptr) return {path};
    std::vector<std::string> files;
    while (const dirent* const entry = readdir(directory)) {
        if (entry->d_type != DT_DIR) files.push_back(path + "/" + entry->d_name);
    }
    closedir(directory);
    std::sort(files.begin(), files.end());
    return files;
}

/// Runs an input, at every level of the instruction set if it paints.
void run(const std::string& bytes) {
    const auto* const data = reinterpret_cast<const uint8_t*>(bytes.data());
#if defined(VOREL_FUZZ_PAINTS)
    for (size_t i = 0; i < vorel_test::levelsHere().size(); ++i) {
        vorel_fuzz::levelOffset = i;
        LLVMFuzzerTestOneInput(data, bytes.size());
    }
#else
    LLVMFuzzerTestOneInput(data, bytes.size());
#endif
}

/// Milliseconds that the input took; negative when it cannot be read. The name is printed first, for
/// the input may end the program.
double replay(const std::string& path) {
    const auto bytes = vorel_test::bytesOfFile(path);
    if (!bytes) return -1.0;
    std::fprintf(stderr, "%s\n", path.c_str());
    const auto start = std::chrono::steady_clock::now();
    run(*bytes);
    const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - start;
    return taken.count();
}

}  // namespace

int main(int argc, char** argv) {
    int inputs = 0;
    double longest = 0.0;
    std::string slowest;
    for (int i = 1; i < argc; ++i) {
        for (const std::string& path : filesOf(argv[i])) {
            const double taken = replay(path);
            if (taken < 0.0) {
                std::fprintf(stderr, "cannot read %s\n", path.c_str());
                return 1;
            }
            ++inputs;
            if (taken < longest) continue;
            longest = taken;
            slowest = path;
        }
    }
    if (inputs == 0) {
        std::fprintf(stderr, "usage: %s FILE_OR_DIRECTORY...; no input was found\n", argv[0]);
        return 1;
    }
    std::printf("%d inputs, the slowest %.1f ms: %s\n", inputs, longest, slowest.c_str());
    return 0;
}
