#include "poster.h"

#include "case.h"

namespace vorel_bench {
namespace {

constexpr int kWidth = 3840 - 2 * kLookMargin;
constexpr int kHeight = 2160 - 2 * kLookMargin;

/// As many times as the row holds whole. Returns where the next row begins.
int addRow(std::vector<PlacedLine>& lines, const Workload& line, int left, int top) {
    constexpr int kGap = 16;
    for (; left + line.width <= kWidth; left += line.width + kGap)
        lines.push_back({&line, left, top});
    return top + line.height + kGap;
}

Workload pageOf(const std::vector<PlacedLine>& lines) {
    Workload page;
    page.name = "POSTER4K";
    page.width = kWidth;
    page.height = kHeight;
    for (const PlacedLine& placed : lines) {
        for (Glyph glyph : placed.line->glyphs) {
            glyph.x += placed.left;
            glyph.y += placed.top;
            page.glyphs.push_back(glyph);
        }
    }
    mergeGlyphs(page);
    return page;
}

}  // namespace

std::vector<PlacedLine> posterLines() {
    constexpr int kShift = 7;  // so that rows do not repeat at the same place of a vector
    std::vector<PlacedLine> lines;
    int left = 0;
    for (int top = 0; top + title160().height <= kHeight;) {
        top = addRow(lines, title160(), left, top);
        for (int row = 0; row < 4 && top + line48().height <= kHeight; ++row)
            top = addRow(lines, line48(), left += kShift, top);
    }
    return lines;
}

const Workload& poster4k() {
    static const Workload workload = pageOf(posterLines());
    return workload;
}

}  // namespace vorel_bench
