#include <algorithm>
#include <array>
#include <cmath>
#include <cstdio>
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
constexpr int kTurns = 4;
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

/// What a pixel takes by side.
struct Row {
    char look;
    Level level;
    std::array<double, std::size(kSides)> taken;
};

void print(const std::vector<Row>& rows) {
    std::printf("| ns/px  | level   |");
    for (const int side : kSides)
        std::printf(" %6d |", side);
    std::printf(" largest/smallest |\n| ------ | ------- |");
    for (size_t i = 0; i < std::size(kSides); ++i)
        std::printf(" -----: |");
    std::printf(" ---------------: |\n");
    for (const Row& row : rows) {
        std::printf("| look/%c | %-7s |", row.look, row.level.label.c_str());
        for (const double taken : row.taken)
            std::printf(" %6.3f |", taken);
        const auto [smallest, largest] = std::minmax_element(row.taken.begin(), row.taken.end());
        std::printf(" %16.2f |\n", *largest / *smallest);
    }
}

}  // namespace

int main(int argc, char** argv) {
    keepLargeBlocks();
    const std::regex wanted(argc > 1 ? argv[1] : ".");
    std::vector<Workload> pictures;
    for (const int side : kSides)
        pictures.push_back(pictureOf(side));
    std::vector<Row> rows;
    for (const char look : kLooks) {
        const std::string name = std::string("look/") + look;
        for (const Level& level : levels()) {
            if (std::regex_search(name, wanted)) rows.push_back({look, level, {}});
        }
    }
    // In turns, so that a slow minute of the machine meets all rows.
    for (int turn = 0; turn < kTurns; ++turn) {
        for (Row& row : rows) {
            row.level.choose();
            for (size_t i = 0; i < pictures.size(); ++i) {
                const double taken = nanosecondsAPixel(lookCase(row.look, pictures[i]));
                row.taken[i] = turn == 0 ? taken : std::min(row.taken[i], taken);
            }
        }
    }
    print(rows);
    return 0;
}
