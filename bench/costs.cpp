#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <vector>

#include "case.h"
#include "fastest_call.h"
#include "level.h"
#include "poster.h"

/// What looks take on a glyph, a line, a title and a poster; see bench/costs.py.
///
///     voreleffect_costs SECONDS      a line a figure: row, maker, seconds of the fastest call
///     voreleffect_costs --pictures   the texts of the pictures and their places, as JSON
///
/// Each maker gets SECONDS for a row.
namespace {

using namespace vorel_bench;

struct Picture {
    const Workload* workload;
    std::vector<PlacedLine> lines;
};

Picture pictureOf(const Workload& line) {
    return {&line, {{&line, 0, 0}}};
}

std::vector<Picture> pictures() {
    return {
        pictureOf(glyph48()), pictureOf(line48()), pictureOf(title160()), {&poster4k(), posterLines()}};
}

void measureCase(const Case& which, const std::string& maker, double seconds) {
    const double fastest = fastestCall(*which.make(), seconds);
    std::printf("%s %s %.9f\n", which.row.c_str(), maker.c_str(), fastest);
    std::fflush(stdout);
}

void measure(double seconds) {
    for (const Picture& picture : pictures()) {
        Cases others;
        for (const char look : kLooks) {
            for (const Level& level : levels()) {
                level.choose();
                measureCase(lookCase(look, *picture.workload), level.label, seconds);
            }
            others.push_back(literalLookCase(look, *picture.workload));
        }
        addLookPeers(others, *picture.workload);
        for (const Case& other : others)
            measureCase(other, other.maker, seconds);
    }
}

/// Of fixed texts, none of which has a character that JSON escapes.
void printPicture(const Picture& picture) {
    const Workload& workload = *picture.workload;
    std::printf(R"({"name": "%s", "width": %d, "height": %d, "margin": %d, "lines": [)",
                workload.name.c_str(), workload.width + 2 * kLookMargin,
                workload.height + 2 * kLookMargin, kLookMargin);
    const char* separator = "";
    for (const PlacedLine& placed : picture.lines) {
        const Workload& line = *placed.line;
        std::printf(
            "%s\n  "
            R"({"text": "%s", "font": "%s", "size": %d, "left": %d, "top": %d})",
            separator, line.text.c_str(), line.font.c_str(), line.sizePx, placed.left + kLookMargin,
            placed.top + kLookMargin);
        separator = ",";
    }
    std::printf("]}");
}

void printPictures() {
    const char* separator = "[";
    for (const Picture& picture : pictures()) {
        std::printf("%s", separator);
        printPicture(picture);
        separator = ",\n";
    }
    std::printf("]\n");
}

}  // namespace

int main(int argc, char** argv) {
    if (argc > 1 && std::strcmp(argv[1], "--pictures") == 0) {
        printPictures();
        return 0;
    }
    measure(argc > 1 ? std::atof(argv[1]) : 0.1);
    return 0;
}
