#include <algorithm>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <memory>
#include <regex>
#include <string>
#include <vector>

#include "core_jobs.h"
#include "fastest_call.h"
#include "hostile_masks.h"
#include "level.h"

/// How much longer than text the slowest mask of the gallery takes, a pixel, for each effect, size and
/// level:
///
///     voreleffect_hostile [--side PIXELS] [--mask REGEX] [EFFECTS]
///
///     --side PIXELS   of the masks, 512 without it
///     --mask REGEX    only these masks, a row for each one
///     EFFECTS         a regular expression for the effects to measure: stroke/outside/8 ...
namespace {

using namespace vorel_bench;
using namespace VFontEffect;

struct Effect {
    std::string name;
    int reach;  ///< pixels beside the mask that a figure counts, too
    CoreJob::MakeCore makeCore;
};

constexpr uint32_t kColour = 0xFF3060A0U;
constexpr float kDistance = 4.0F;
constexpr float kAngle = 135.0F;

void addStrokes(std::vector<Effect>& effects) {
    const char* const positions[] = {"centre", "outside", "inside"};
    for (int position = 0; position < 3; ++position) {
        for (const int size : kRadii) {
            const int reach = position == 0 ? (size + 1) / 2 : position == 1 ? size : 0;
            effects.push_back({std::string("stroke/") + positions[position] + "/" + std::to_string(size),
                               reach,
                               coreWith<VFStroke>(VFStrokeProperty(static_cast<float>(size), kColour,
                                                                   1.0F, 0, position))});
        }
    }
}

void addBlurs(std::vector<Effect>& effects) {
    for (const int size : {2, 8, 32, 100}) {
        const auto px = static_cast<float>(size);
        const std::string at = "/" + std::to_string(size);
        effects.push_back(
            {"shadow/outer" + at, size,
             coreWith<VFOuterShadow>(VFOuterShadowProperty(kAngle, kDistance, px, kColour, 1.0F))});
        effects.push_back(
            {"shadow/inner" + at, 0,
             coreWith<VFInnerShadow>(VFInnerShadowProperty(kAngle, kDistance, px, kColour, 1.0F))});
        effects.push_back({"glow/outer" + at, size,
                           coreWith<VFOuterGlow>(VFOuterGlowProperty(px, kColour, 1.0F, 0, nullptr))});
        effects.push_back({"glow/inner" + at, 0,
                           coreWith<VFInnerGlow>(VFInnerGlowProperty(px, kColour, 1.0F, 0, nullptr))});
    }
}

std::vector<Effect> allEffects() {
    std::vector<Effect> effects;
    addStrokes(effects);
    addBlurs(effects);
    effects.push_back({"fill/linear", 0, linearFill()});
    effects.push_back({"fill/radial", 0, radialFill()});
    effects.push_back({"fill/pattern", 0, patternFill()});
    return effects;
}

/// Nanoseconds a pixel of the fastest call.
double nanosecondsAPixel(const Effect& effect, const Workload& mask) {
    CoreJob job(&mask, effect.reach, effect.makeCore);
    return fastestCall(job, 0.01) * 1e9 / static_cast<double>(mask.grownPixels(effect.reach));
}

void printRow(const std::string& effect, const Level& level, double text, double slowest,
              const std::string& mask) {
    std::printf("| %-18s | %-7s | %8.3f | %8.3f | %6.1f | %-30s |\n", effect.c_str(),
                level.label.c_str(), text, slowest, slowest / text, mask.c_str());
    std::fflush(stdout);
}

void measure(const Effect& effect, const Level& level, const Workload& page,
             const std::vector<Workload>& masks, const std::string& each) {
    level.choose();
    const double text = nanosecondsAPixel(effect, page);
    double slowest = 0;
    const Workload* which = nullptr;
    for (const Workload& mask : masks) {
        if (!std::regex_search(mask.name, std::regex(each))) continue;
        const double taken = nanosecondsAPixel(effect, mask);
        if (!each.empty()) printRow(effect.name, level, text, taken, mask.name);
        if (taken <= slowest) continue;
        slowest = taken;
        which = &mask;
    }
    if (each.empty()) printRow(effect.name, level, text, slowest, which->name);
}

}  // namespace

int main(int argc, char** argv) {
    keepLargeBlocks();
    int side = 512;
    std::string each;
    std::string wanted = ".";
    for (int i = 1; i < argc; ++i) {
        const std::string argument = argv[i];
        if (argument == "--side" && i + 1 < argc) {
            side = std::atoi(argv[++i]);
        } else if (argument == "--mask" && i + 1 < argc) {
            each = argv[++i];
        } else {
            wanted = argument;
        }
    }
    const std::vector<Workload> masks = hostileMasks(side);
    const Workload page = textPage(side);
    std::printf(
        "| effect             | level   |     text |  slowest |  times | mask                           "
        "|\n");
    std::printf(
        "| ------------------ | ------- | -------: | -------: | -----: | ------------------------------ "
        "|\n");
    for (const Effect& effect : allEffects()) {
        if (!std::regex_search(effect.name, std::regex(wanted))) continue;
        for (const Level& level : levels())
            measure(effect, level, page, masks, each);
    }
    return 0;
}
