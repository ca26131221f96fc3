#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cstdint>
#include <cstring>
#include <functional>
#include <iterator>
#include <string>
#include <thread>
#include <vector>

#include "build_kind.h"
#include "random_caller.h"
#include "tests/support/mask_gallery.h"
#include "voreleffect/look.h"
#include "voreleffect/voreleffect.h"
#include "whole_looks.h"

/// Separate effect sets on separate threads. scripts/threads.sh runs these under ThreadSanitizer.
namespace {

using namespace vorel_test;
using VFontEffect::VFBitmap;
using VFontEffect::VFBlender;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
using VFontEffect::VFGradient;

constexpr size_t kThreads = 2;

/// Runs `work(thread)` on every thread at once. None starts before all are there: threads that follow
/// each other show no race.
void onAllThreads(const std::function<void(size_t)>& work, size_t count = kThreads) {
    std::atomic<size_t> arrived{0};
    std::vector<std::thread> threads;
    for (size_t i = 0; i < count; ++i) {
        threads.emplace_back([&work, &arrived, count, i] {
            ++arrived;
            while (arrived < count)
                std::this_thread::yield();
            work(i);
        });
    }
    for (std::thread& thread : threads)
        thread.join();
}

std::vector<uint64_t> resultsOf(uint64_t seed, int runs) {
    RandomCaller caller(seed);
    std::vector<uint64_t> results;
    for (int run = 0; run < runs; ++run)
        results.push_back(caller.run());
    return results;
}

TEST(Threads, SeparateEffectSets_PaintWhatOneThreadAlonePaints) {
    const int callers = repetitions(40);
    constexpr int kRuns = 25;
    const auto seedOf = [](size_t thread, int caller) {
        return static_cast<uint64_t>(caller) * kThreads + thread;
    };
    std::array<std::vector<std::vector<uint64_t>>, kThreads> results;
    onAllThreads([&](size_t thread) {
        for (int caller = 0; caller < callers; ++caller)
            results[thread].push_back(resultsOf(seedOf(thread, caller), kRuns));
    });
    for (size_t thread = 0; thread < kThreads; ++thread) {
        for (int caller = 0; caller < callers; ++caller) {
            const uint64_t seed = seedOf(thread, caller);
            EXPECT_EQ(resultsOf(seed, kRuns), results[thread][static_cast<size_t>(caller)])
                << "thread " << thread << ", seed " << seed;
        }
    }
}

TEST(Threads, ManyMoreThanCores_PaintWhatTheLiteralFormPaints) {
    const size_t threads = std::max(size_t{32}, size_t{4} * std::thread::hardware_concurrency());
    for (const WholeLook look : kWholeLooks)
        expectedPicture(look);
    const int rounds = repetitions(10);
    std::atomic<size_t> same{0};
    onAllThreads(
        [&](size_t thread) {
            for (int round = 0; round < rounds; ++round) {
                const auto turn = (thread + static_cast<size_t>(round)) % std::size(kWholeLooks);
                if (paintsAsExpected(kWholeLooks[turn])) ++same;
            }
        },
        threads);
    EXPECT_EQ(threads * static_cast<size_t>(rounds), same) << "runs on " << threads << " threads";
}

constexpr int kGlyphWidth = 9;
constexpr int kGlyphHeight = 8;

/// What several callers may hand to their own effect sets at the same time: nothing writes to it. It is
/// small, because a race shows only while both accesses are among a thread's latest.
struct SharedInput {
    literal::Mask mask = discMask(kGlyphWidth, kGlyphHeight, 4.0F, 3.5F, 3.0F, true);
    VFGlyph glyph{mask.bytes.data(), kGlyphWidth, kGlyphHeight};
    std::array<VFGradient, 3> stops{
        {{0xFF0000, 1.0F, 0.0F}, {0x00FF00, 0.5F, 0.4F}, {0x0000FF, 1.0F, 1.0F}}};
    VFBitmap pattern{5, 4, 4};

    SharedInput() {
        for (unsigned char i = 0; i < 80; ++i)
            pattern.mData[i] = static_cast<unsigned char>(i * 3);
    }
};

/// Every effect, at a text opacity of 1 or, in layered mode, of a half.
std::vector<uint8_t> paintedFrom(SharedInput& input, float size, bool layered) {
    constexpr int kWidth = 17;
    constexpr int kHeight = 16;
    VFEffect look;
    look.addOuterShadowText(120, 3, size, 0x203040, 0.7F);
    look.addInnerShadowText(300, 2, size, 0x102000, 0.6F);
    look.addOuterGlowText(size, 0xFFAA00, 0.8F, 3, input.stops.data());
    look.addStrokeText(2, 0x112233, 0.9F, 0, 1);
    look.addInnerGlowText(size, 0xFFFFFF, 0.5F, 3, input.stops.data());
    look.addLinearGradientText(30, 1, 0.6F, 3, input.stops.data());
    look.addRadialGradientText(1, 0.4F, 3, input.stops.data());
    look.addPatternText(&input.pattern, 1.5F, 0.5F);
    look.setTextOpacity(layered ? 0.5F : 1.0F);
    delete[] look.getMapKey(0x808080);
    VFBitmap picture(kWidth, kHeight, 4);
    look.initEffect(kWidth, kHeight);
    look.setDstBitmap(&picture);
    look.renderEffectLayer(4, 4, &input.glyph);
    look.doEffectPostProcessing();
    look.compositeLayers(&picture);
    return {picture.mData, picture.mData + kWidth * kHeight * 4};
}

TEST(Threads, SharedGlyphsStopsAndPatterns_AreOnlyRead) {
    SharedInput input;
    const int rounds = repetitions(400);
    const auto paint = [&input](int round) {
        return paintedFrom(input, static_cast<float>(round % 3), round % 2 == 1);
    };
    std::array<std::vector<std::vector<uint8_t>>, kThreads> pictures;
    onAllThreads([&](size_t thread) {
        for (int round = 0; round < rounds; ++round)
            pictures[thread].push_back(paint(round));
    });
    for (int round = 0; round < rounds; ++round) {
        const std::vector<uint8_t> alone = paint(round);
        for (size_t thread = 0; thread < kThreads; ++thread)
            EXPECT_EQ(alone, pictures[thread][static_cast<size_t>(round)]) << thread << ", " << round;
    }
}

TEST(Threads, KernelsOnSeparateDestinations_ShareTheirSources) {
    SharedInput input;
    const auto blend = [&input] {
        VFBitmap picture(16, 16, 4);
        for (int step = 0; step < 64; ++step) {
            const int mode = std::array<int, 4>{1, 2, 3, 7}[static_cast<size_t>(step % 4)];
            VFBlender().drawBitmapBlend8(step % 9 - 4, step % 7 - 3, &picture, input.glyph.mBuffer,
                                         kGlyphWidth, kGlyphHeight, kGlyphWidth, 0x40302010, mode);
            VFBlender().drawBitmapBlend32(step % 5, step % 11, &picture, input.pattern.mData, 5, 4, 20,
                                          step % 2);
        }
        return std::vector<uint8_t>(picture.mData, picture.mData + 16 * 16 * 4);
    };
    const int rounds = repetitions(50);
    std::array<std::vector<std::vector<uint8_t>>, kThreads> pictures;
    onAllThreads([&](size_t thread) {
        for (int round = 0; round < rounds; ++round)
            pictures[thread].push_back(blend());
    });
    const std::vector<uint8_t> alone = blend();
    for (const auto& ofThread : pictures) {
        for (const std::vector<uint8_t>& picture : ofThread)
            EXPECT_EQ(alone, picture);
    }
}

TEST(Threads, OneLookAndOnePicture_AreReadByAllOfThem) {
    using namespace VFontEffect;
    const std::vector<unsigned char> tile(4 * 4 * 4, 120);
    const Look look = Look().add(Pattern({tile.data(), 4, 4})).add(OuterGlow(4, rgb(0xFFAA00)));
    const unsigned char covered[] = {255, 255, 255, 255};
    const Glyph glyph = {9, 9, covered, 2, 2};
    const auto picture = paint(look, glyph);
    const std::string key = look.key();
    std::vector<unsigned char> expected(4 * 20 * 20);
    paint(look, glyph, {expected.data(), 20, 20});
    std::atomic<int> differences{0};
    onAllThreads([&](size_t) {
        for (int i = repetitions(200); i > 0; --i) {
            std::vector<unsigned char> painted(expected.size());
            std::vector<unsigned char> laid(expected.size());
            const Look copy = look;
            Painter(copy).paint(glyph, {painted.data(), 20, 20});
            picture->layOver({laid.data(), 20, 20}, 0, 0);
            const Picture own = *picture;
            if (painted != expected || laid != expected || look.key() != key || own.isEmpty())
                ++differences;
        }
    });
    EXPECT_EQ(differences, 0);
}

}  // namespace
