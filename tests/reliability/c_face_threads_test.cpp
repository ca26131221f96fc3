#include <gtest/gtest.h>
#include <voreleffect/voreleffect_c.h>

#include <array>
#include <string>
#include <thread>
#include <vector>

#include "build_kind.h"
#include "tests/unit/capi/looks_in_c.h"

/// What the header of the C face says of threads. scripts/threads.sh runs these under ThreadSanitizer.
namespace {

using namespace vorel_test;

constexpr size_t kThreads = 2;
constexpr int kSide = 40;

/// A look that all may read.
LookHandle sharedLook() {
    LookHandle look = newLook();
    EXPECT_EQ(vorel_look_outer_glow(look.get(), 5, 0xFFAA00, 0.8F, nullptr, 0), VOREL_OK);
    EXPECT_EQ(vorel_look_stroke(look.get(), 2, 0xFFFFFF, 0.5F, VOREL_CENTRE), VOREL_OK);
    return look;
}

/// What one thread paints with a painter of its own, over and over, and the key that it reads.
std::string paintedBy(vorel_look* look, int rounds) {
    const std::vector<unsigned char> coverage(81, 255);
    const vorel_glyph glyph = {12, 12, coverage.data(), 9, 9, 0};
    const PainterHandle painter = newPainter({look});
    std::string bytes(size_t{4} * kSide * kSide, '\0');
    const vorel_view view = {reinterpret_cast<uint8_t*>(bytes.data()), kSide, kSide, 0, VOREL_RGBA};
    for (int round = 0; round < rounds; ++round) {
        EXPECT_EQ(vorel_painter_paint(painter.get(), &glyph, 1, &view, round % 5, 0, nullptr), VOREL_OK);
        EXPECT_EQ(vorel_paint(&look, 1, &glyph, 1, &view, 0, round % 5, nullptr), VOREL_OK);
    }
    return bytes + keyOf(look);
}

TEST(CFaceThreads, PaintersOfOneLook_PaintWhatOneThreadAlonePaints) {
    const LookHandle look = sharedLook();
    const int rounds = repetitions(200);
    const std::string expected = paintedBy(look.get(), rounds);
    std::array<std::string, kThreads> painted;
    std::vector<std::thread> threads;
    for (std::string& bytes : painted)
        threads.emplace_back([&] { bytes = paintedBy(look.get(), rounds); });
    for (std::thread& thread : threads)
        thread.join();
    for (const std::string& bytes : painted)
        EXPECT_EQ(bytes, expected);
}

}  // namespace
