#include <malloc.h>

#include <algorithm>
#include <cstdio>
#include <limits>
#include <memory>
#include <string>
#include <vector>

#include "case.h"
#include "fastest_call.h"
#include "hostile_masks.h"
#include "level.h"

/// What a pixel takes in pictures of any size: each look on square pages of text, by the side in pixels.
///
///     voreleffect_growing
namespace {

using namespace vorel_bench;

constexpr int kSides[] = {100, 300, 1000, 3000, 8000};

/// A page whose glyph is all of its text.
Workload pageOf(int side) {
    Workload page = textPage(side);
    page.glyphs.push_back({0, 0, side, side, page.mask});
    return page;
}

/// Nanoseconds a pixel of the fastest call.
double nanosecondsAPixel(const Case& which) {
    const std::unique_ptr<Job> job = which.make();
    return fastestCall(*job, 0.1) * 1e9 / static_cast<double>(which.pixels);
}

}  // namespace

int main() {
    // The layers of a large picture come from the system anew for each call, which takes longer than
    // many an effect, and is its caller's choice of an allocator: kept ones are measured.
    mallopt(M_MMAP_THRESHOLD, 1 << 30);
    mallopt(M_TRIM_THRESHOLD, 1 << 30);
    std::printf("| ns/px  | level   |");
    for (const int side : kSides)
        std::printf(" %6d |", side);
    std::printf(" largest/smallest |\n| ------ | ------- |");
    for (size_t i = 0; i < std::size(kSides); ++i)
        std::printf(" -----: |");
    std::printf(" ---------------: |\n");
    std::vector<Workload> pages;
    for (const int side : kSides)
        pages.push_back(pageOf(side));
    for (const char look : kLooks) {
        for (const Level& level : levels()) {
            level.choose();
            std::printf("| look/%c | %-7s |", look, level.label.c_str());
            double smallest = std::numeric_limits<double>::infinity();
            double largest = 0;
            for (const Workload& page : pages) {
                const double taken = nanosecondsAPixel(lookCase(look, page));
                smallest = std::min(smallest, taken);
                largest = std::max(largest, taken);
                std::printf(" %6.3f |", taken);
                std::fflush(stdout);
            }
            std::printf(" %16.2f |\n", largest / smallest);
        }
    }
    return 0;
}
