/// Runs inputs through a fuzz target without a fuzzer: every file named on the command line and every
/// file of a directory named there, each at every level of the instruction set. Whatever stops the
/// fuzzer stops this program.
#include <algorithm>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <vector>

#if defined(VOREL_FUZZ_PAINTS)
#include "level_of_input.h"
#endif

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size);

namespace {

namespace fs = std::filesystem;

/// The files in a fixed order.
std::vector<fs::path> filesOf(const fs::path& path) {
    if (!fs::is_directory(path)) return {path};
    std::vector<fs::path> files;
    for (const auto& entry : fs::directory_iterator(path)) {
        if (entry.is_regular_file()) files.push_back(entry.path());
    }
    std::sort(files.begin(), files.end());
    return files;
}

/// Runs an input, at every level of the instruction set if it paints.
void run(const std::vector<char>& bytes) {
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
double replay(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file) return -1.0;
    const std::vector<char> bytes{std::istreambuf_iterator<char>(file),
                                  std::istreambuf_iterator<char>()};
    std::fprintf(stderr, "%s\n", path.c_str());
    const auto start = std::chrono::steady_clock::now();
    run(bytes);
    const std::chrono::duration<double, std::milli> taken = std::chrono::steady_clock::now() - start;
    return taken.count();
}

}  // namespace

int main(int argc, char** argv) {
    int inputs = 0;
    double longest = 0.0;
    fs::path slowest;
    for (int i = 1; i < argc; ++i) {
        for (const fs::path& path : filesOf(argv[i])) {
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
