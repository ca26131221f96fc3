#include "workload.h"

#include <algorithm>
#include <climits>

#include "glyphs.h"
#include "tests/support/random.h"

namespace vorel_bench {
namespace {

constexpr char kSans[] = VOREL_BENCH_FONTS "/DejaVuSans.ttf";
constexpr char kSansBold[] = VOREL_BENCH_FONTS "/DejaVuSans-Bold.ttf";

/// Moves the glyphs so that their extents start at (0, 0), and sets the size of the workload.
void cropToExtents(Workload& workload) {
    int left = INT_MAX, top = INT_MAX, right = INT_MIN, bottom = INT_MIN;
    for (const Glyph& glyph : workload.glyphs) {
        left = std::min(left, glyph.x);
        top = std::min(top, glyph.y);
        right = std::max(right, glyph.x + glyph.width);
        bottom = std::max(bottom, glyph.y + glyph.height);
    }
    for (Glyph& glyph : workload.glyphs) {
        glyph.x -= left;
        glyph.y -= top;
    }
    workload.width = right - left;
    workload.height = bottom - top;
}

Workload textLine(const char* name, const char* text, const char* font, int sizePx) {
    Workload workload;
    workload.name = name;
    workload.text = text;
    workload.font = font;
    workload.sizePx = sizePx;
    workload.glyphs = glyphsOf(workload);
    cropToExtents(workload);
    mergeGlyphs(workload);
    return workload;
}

Workload uniformNoise() {
    Workload workload;
    workload.name = "NOISE";
    workload.width = 512;
    workload.height = 128;
    vorel_test::Random random(1);
    workload.mask.resize(static_cast<size_t>(workload.width) * static_cast<size_t>(workload.height));
    std::generate(workload.mask.begin(), workload.mask.end(), [&] { return random.byte(); });
    workload.glyphs.push_back({0, 0, workload.width, workload.height, workload.mask});
    return workload;
}

}  // namespace

void mergeGlyphs(Workload& workload) {
    workload.mask.assign(static_cast<size_t>(workload.width) * static_cast<size_t>(workload.height), 0);
    for (const Glyph& glyph : workload.glyphs) {
        for (int y = 0; y < glyph.height; ++y) {
            for (int x = 0; x < glyph.width; ++x) {
                uint8_t& target =
                    workload.mask[static_cast<size_t>((glyph.y + y) * workload.width + glyph.x + x)];
                target = std::max(target, glyph.coverage[static_cast<size_t>(y * glyph.width + x)]);
            }
        }
    }
}

const Workload& line48() {
    static const Workload workload = textLine("LINE48", "Summer Sale: 50% Off Everything!", kSans, 48);
    return workload;
}

const Workload& title160() {
    static const Workload workload = textLine("TITLE160", "Typefaces", kSansBold, 160);
    return workload;
}

const Workload& glyph48() {
    static const Workload workload = textLine("GLYPH48", "R", kSans, 48);
    return workload;
}

const Workload& noise() {
    static const Workload workload = uniformNoise();
    return workload;
}

}  // namespace vorel_bench
