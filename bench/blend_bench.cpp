#include <benchmark/benchmark.h>

#include <cstdint>
#include <cstring>
#include <vector>

#include "voreleffect/VFBlender.h"

/// Pixels per second of the blending kernels on random data, beside a plain copy of as many bytes.
namespace {

using VFontEffect::VFBitmap;
using VFontEffect::VFBlender;

constexpr int kWidth = 512;
constexpr int kHeight = 128;
constexpr int64_t kPixels = int64_t{kWidth} * kHeight;

/// Bytes of a linear congruential generator.
std::vector<unsigned char> noise(int64_t bytes, uint32_t seed) {
    std::vector<unsigned char> data(static_cast<size_t>(bytes));
    for (unsigned char& value : data) {
        seed = seed * 1664525U + 1013904223U;
        value = static_cast<unsigned char>(seed >> 24);
    }
    return data;
}

struct Scene {
    std::vector<unsigned char> mask = noise(kPixels, 1);
    std::vector<unsigned char> source = noise(kPixels * 4, 2);
    std::vector<unsigned char> before = noise(kPixels * 4, 3);
    VFBitmap destination{kWidth, kHeight, 4};

    void reset() { std::memcpy(destination.mData, before.data(), before.size()); }
};

/// Times `paint` with a fresh destination each time; the refill is part of every figure.
template <class Paint>
void run(benchmark::State& state, Paint paint) {
    Scene scene;
    for (auto _ : state) {
        scene.reset();
        paint(scene);
        benchmark::ClobberMemory();
    }
    state.SetItemsProcessed(state.iterations() * kPixels);
}

void copyOnly(benchmark::State& state) {
    run(state, [](Scene&) {});
}
BENCHMARK(copyOnly);

void maskBlend(benchmark::State& state) {
    const auto mode = static_cast<int>(state.range(0));
    run(state, [mode](Scene& s) {
        VFBlender().drawBitmapBlend8(0, 0, &s.destination, s.mask.data(), kWidth, kHeight, kWidth,
                                     0xC0804020U, mode);
    });
}
BENCHMARK(maskBlend)->ArgName("mode")->Arg(1)->Arg(2)->Arg(3)->Arg(7);

void colourBlend(benchmark::State& state) {
    const auto mode = static_cast<int>(state.range(0));
    run(state, [mode](Scene& s) {
        VFBlender().drawBitmapBlend32(0, 0, &s.destination,
                                      reinterpret_cast<unsigned int*>(s.source.data()), kWidth, kHeight,
                                      kWidth, mode);
    });
}
BENCHMARK(colourBlend)->ArgName("mode")->Arg(1)->Arg(2);

}  // namespace
