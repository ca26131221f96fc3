#include <algorithm>
#include <cmath>
#include <cstdio>
#include <limits>
#include <memory>
#include <regex>
#include <string>
#include <utility>
#include <vector>

#include "case.h"
#include "fastest_call.h"
#include "hostile_masks.h"
#include "level.h"

/// What a pixel takes in pictures of any size: each look on square pictures, by their side in pixels.
/// Text covers a third of each one, its middle, so that larger ones hold more of the same.
///
///     voreleffect_growing [LOOKS]
///
///     LOOKS   a regular expression for the rows to measure: look/A ...
namespace {

using namespace vorel_bench;

constexpr int kSides[] = {180, 500, 1000, 2000, 4000, 8000};
constexpr double kTextShare = 1.0 / 3.0;

/// What lies within the margin of a look; one glyph holds all of the text.
Workload pictureOf(int side) {
    const auto textSide = static_cast<int>(std::sqrt(kTextShare) * side);
    Workload picture = textPage(textSide);
    const int margin = (side - textSide) / 2 - kLookMargin;
    picture.glyphs.push_back({margin, margin, textSide, textSide, std::move(picture.mask)});
    picture.width = picture.height = side - 2 * kLookMargin;
    return picture;
}

/// Nanoseconds a pixel of the fastest call.
double nanosecondsAPixel(const Case& which) {
    const std::unique_ptr<Job> job = which.make();
    return fastestCall(*job, 0.1) * 1e9 / static_cast<double>(which.pixels);
}

}  // namespace

int main(int argc, char** argv) {
    keepLargeBlocks();
    const std::regex wanted(argc > 1 ? argv[1] : ".");
    std::printf("| ns/px  | level   |");
    for (const int side : kSides)
        std::printf(" %6d |", side);
    std::printf(" largest/smallest |\n| ------ | ------- |");
    for (size_t i = 0; i < std::size(kSides); ++i)
        std::printf(" -----: |");
    std::printf(" ---------------: |\n");
    std::vector<Workload> pictures;
    for (const int side : kSides)
        pictures.push_back(pictureOf(side));
    for (const char look : kLooks) {
        if (!std::regex_search(std::string("look/") + look, wanted)) continue;
        for (const Level& level : levels()) {
            level.choose();
            std::printf("| look/%c | %-7s |", look, level.label.c_str());
            double smallest = std::numeric_limits<double>::infinity();
            double largest = 0;
            for (const Workload& picture : pictures) {
                const double taken = nanosecondsAPixel(lookCase(look, picture));
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
