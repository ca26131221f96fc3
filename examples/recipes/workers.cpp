// Many lines on all cores: a painter for each worker, and the bytes of a single one.
#include <algorithm>
#include <atomic>
#include <cstring>
#include <optional>
#include <string>
#include <thread>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

using Pictures = std::vector<std::optional<Picture>>;

/// The picture of each line. Workers share nothing but the number of the next line: each has a painter,
/// which keeps its memory from line to line. There is one at least: hardware_concurrency() may tell 0.
Pictures paintAll(const Look& look, const std::vector<Line>& lines, unsigned int workers) {
    Pictures pictures(lines.size());
    std::atomic<std::size_t> next{0};
    const auto work = [&] {
        Painter painter(look);
        for (std::size_t i = next++; i < lines.size(); i = next++)
            pictures[i] = painter.paint(lines[i].glyphs);
    };
    std::vector<std::thread> threads;
    for (unsigned int i = 0; i < std::max(1U, workers); ++i)
        threads.emplace_back(work);
    for (std::thread& thread : threads)
        thread.join();
    return pictures;
}

bool areSame(const Picture& a, const Picture& b) {
    return a.width() == b.width() && a.height() == b.height() && a.left() == b.left() &&
           a.top() == b.top() &&
           std::memcmp(a.data(), b.data(),
                       static_cast<std::size_t>(a.stride()) * static_cast<std::size_t>(a.height())) == 0;
}

}  // namespace

int main() {
    Look look;
    look.fill(rgb(0xFFFFFF))
        .add(OuterGlow(10, rgb(0x00B8A9)).opacity(0.9F))
        .add(InnerGlow(5, rgb(0x00877C)));

    const Font font(kFont, 36);
    std::vector<Line> lines;
    for (int i = 1; i <= 24; ++i)
        lines.push_back(font.line("Line " + std::to_string(i)));
    const Pictures serial = paintAll(look, lines, 0);
    const Pictures parallel = paintAll(look, lines, 4);

    Page page(720, 100, 0x10303A);
    for (std::size_t i = 0; i < serial.size(); ++i) {
        check(serial[i] && parallel[i], "all are painted");
        check(areSame(*serial[i], *parallel[i]), "the same bytes on four threads");
        const auto place = static_cast<int>(i);
        parallel[i]->layOver(page.view(), 15 + place % 4 * 178, 42 + place / 4 * 48);
    }
    check(page.writePng("workers.png"), "a PNG");
    return 0;
}
