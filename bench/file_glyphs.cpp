#include <cstdio>
#include <cstdlib>
#include <utility>

#include "glyphs.h"
#include "tests/support/file_bytes.h"

namespace vorel_bench {
namespace {

/// The next number of the file.
int taken(const std::string& bytes, size_t& at) {
    uint32_t value = 0;
    for (int i = 0; i < 4 && at < bytes.size(); ++i)
        value |= uint32_t{static_cast<uint8_t>(bytes[at++])} << (8 * i);
    return static_cast<int>(value);
}

}  // namespace

/// In the folder that VOREL_BENCH_GLYPHS names.
std::vector<Glyph> glyphsOf(const Workload& workload) {
    const char* const folder = std::getenv("VOREL_BENCH_GLYPHS");
    const std::string path = (folder == nullptr ? "." : folder) + ("/" + workload.name + ".glyphs");
    const auto bytes = vorel_test::bytesOfFile(path);
    if (!bytes) {
        std::fprintf(stderr, "cannot read the glyphs in %s\n", path.c_str());
        std::exit(1);
    }
    std::vector<Glyph> glyphs;
    for (size_t at = 0; at < bytes->size();) {
        Glyph glyph = {};
        for (int* const number : {&glyph.x, &glyph.y, &glyph.width, &glyph.height})
            *number = taken(*bytes, at);
        const auto pixels = static_cast<size_t>(glyph.width) * static_cast<size_t>(glyph.height);
        const auto first = bytes->begin() + static_cast<std::ptrdiff_t>(at);
        glyph.coverage.assign(first, first + static_cast<std::ptrdiff_t>(pixels));
        at += pixels;
        glyphs.push_back(std::move(glyph));
    }
    return glyphs;
}

}  // namespace vorel_bench
