#include <cstdio>
#include <string>

#include "workload.h"

/// Writes the glyphs of the workloads for programs that have no FreeType (bench/file_glyphs.cpp):
///
///     voreleffect_write_glyphs FOLDER
///
/// Of each glyph its place, width and height as 32-bit numbers, least significant byte first, then its
/// coverage.
namespace {

using vorel_bench::Glyph;
using vorel_bench::Workload;

void append(std::string& bytes, int number) {
    for (int shift = 0; shift < 32; shift += 8)
        bytes += static_cast<char>(static_cast<unsigned int>(number) >> shift & 0xFFU);
}

bool write(const std::string& folder, const Workload& workload) {
    std::string bytes;
    for (const Glyph& glyph : workload.glyphs) {
        for (const int number : {glyph.x, glyph.y, glyph.width, glyph.height})
            append(bytes, number);
        bytes.append(glyph.coverage.begin(), glyph.coverage.end());
    }
    std::FILE* const file = std::fopen((folder + "/" + workload.name + ".glyphs").c_str(), "wb");
    if (file == nullptr) return false;
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
    return std::fclose(file) == 0 && written;
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: voreleffect_write_glyphs FOLDER\n");
        return 2;
    }
    for (const Workload* workload :
         {&vorel_bench::glyph48(), &vorel_bench::line48(), &vorel_bench::title160()}) {
        if (write(argv[1], *workload)) continue;
        std::fprintf(stderr, "cannot write into %s\n", argv[1]);
        return 1;
    }
    return 0;
}
