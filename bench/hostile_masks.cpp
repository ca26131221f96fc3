#include "hostile_masks.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <functional>
#include <string>

#include "tests/support/random.h"

namespace vorel_bench {
namespace {

using vorel_test::Random;
using CoverageAt = std::function<int(int x, int y)>;

Workload maskOf(const std::string& name, int side, const CoverageAt& coverageAt) {
    Workload workload;
    workload.name = name;
    workload.width = side;
    workload.height = side;
    workload.mask.reserve(static_cast<size_t>(side) * static_cast<size_t>(side));
    for (int y = 0; y < side; ++y) {
        for (int x = 0; x < side; ++x)
            workload.mask.push_back(static_cast<uint8_t>(std::clamp(coverageAt(x, y), 0, 255)));
    }
    return workload;
}

int rounded(double value) {
    return static_cast<int>(std::lround(value));
}

/// So many of a thousand pixels have some grey, the others are clear.
Workload greyNoise(const std::string& name, int side, int perThousand) {
    Random random(1);
    return maskOf(name, side, [&](int, int) {
        const bool covered = random.between(1, 1000) <= perThousand;
        return covered ? random.between(1, 255) : 0;
    });
}

void addNoise(std::vector<Workload>& masks, int side) {
    masks.push_back(greyNoise("noise 100 %", side, 1000));
    masks.push_back(greyNoise("noise 30 %", side, 300));
    masks.push_back(greyNoise("noise 5 %", side, 50));
    masks.push_back(greyNoise("noise 1 %", side, 10));
    masks.push_back(greyNoise("noise 0.1 %", side, 1));
}

/// Where no disc is full of the largest coverage.
void addPlateaus(std::vector<Workload>& masks, int side) {
    const int middle = side / 2;
    masks.push_back(maskOf("plane of 254, one 255", side,
                           [=](int x, int y) { return x == middle && y == middle ? 255 : 254; }));
    Random random(2);
    masks.push_back(
        maskOf("plane of 200, grain", side, [&](int, int) { return 200 - random.between(0, 9); }));
    masks.push_back(maskOf("steps of 40 pixels", side, [=](int x, int y) {
        return (x / 40 * 37 + y / 40 * 91) % 200 + (x == middle && y == middle ? 55 : 0);
    }));
    masks.push_back(maskOf("lattice of 255 on noise", side, [&](int x, int y) {
        return x % 151 == 75 && y % 151 == 75 ? 255 : random.between(0, 200);
    }));
    masks.push_back(maskOf("lattice of 255, clear", side,
                           [&](int x, int y) { return x % 230 == 75 && y % 230 == 75 ? 255 : 0; }));
}

void addGradients(std::vector<Workload>& masks, int side) {
    masks.push_back(maskOf("ramp across", side, [=](int x, int) { return x * 256 / side; }));
    masks.push_back(
        maskOf("ramp of 256 pixels, aslant", side, [](int x, int y) { return (x + y) % 256; }));
    masks.push_back(
        maskOf("ramp of 64 pixels, aslant", side, [](int x, int y) { return (2 * x + y) % 64 * 4; }));
    masks.push_back(maskOf("cone", side, [=](int x, int y) {
        return 255 - rounded(std::hypot(x - side / 2, y - side / 2) * 360 / side);
    }));
    masks.push_back(maskOf("bowl", side, [=](int x, int y) {
        return rounded(std::hypot(x - side / 2, y - side / 2) * 360 / side);
    }));
}

void addRepeated(std::vector<Workload>& masks, int side) {
    masks.push_back(maskOf("comb of 2 pixels", side, [](int x, int) { return x % 2 * 255; }));
    masks.push_back(maskOf("comb of 90 pixels", side, [](int x, int) { return x % 90 == 0 ? 255 : 0; }));
    masks.push_back(maskOf("comb of 16 pixels, lying, grey", side,
                           [](int x, int y) { return y % 16 == 0 ? x % 200 + 55 : 0; }));
    masks.push_back(maskOf("checkerboard of 1", side, [](int x, int y) { return (x + y) % 2 * 255; }));
    masks.push_back(
        maskOf("checkerboard of 24", side, [](int x, int y) { return (x / 24 + y / 24) % 2 * 255; }));
    // Dots that grow from left to right, with soft edges.
    const auto halftone = [=](int pitch) {
        return [=](int x, int y) {
            const double radius = 0.7 * pitch * x / side;
            const double distance = std::hypot(x % pitch - pitch / 2, y % pitch - pitch / 2);
            return rounded(255 * (radius - distance + 0.5));
        };
    };
    masks.push_back(maskOf("halftone of 6 pixels", side, halftone(6)));
    masks.push_back(maskOf("halftone of 40 pixels", side, halftone(40)));
}

void addPictures(std::vector<Workload>& masks, int side) {
    Random random(3);
    masks.push_back(maskOf("like a photograph", side, [&](int x, int y) {
        const double waves = std::sin(x * 0.013 + y * 0.007) + std::sin(x * 0.05 - y * 0.031) +
                             std::sin(y * 0.09 + 2 * std::sin(x * 0.02));
        return rounded(128 + 40 * waves) + random.between(-3, 3);
    }));
    const Workload page = textPage(side);
    masks.push_back(maskOf("text in chalk", side, [&](int x, int y) {
        const int coverage =
            page.mask[static_cast<size_t>(y) * static_cast<size_t>(side) + static_cast<size_t>(x)];
        return coverage * random.between(0, 255) / 255;
    }));
}

}  // namespace

Workload textPage(int side) {
    constexpr int kLineHeight = 56;
    const Workload& line = line48();
    return maskOf("text", side, [&](int x, int y) {
        const int row = y % kLineHeight;
        if (row >= line.height) return 0;
        // Each line begins elsewhere in the sentence.
        const int column = (x + y / kLineHeight * 97) % line.width;
        return int{line.mask[static_cast<size_t>(row) * static_cast<size_t>(line.width) +
                             static_cast<size_t>(column)]};
    });
}

std::vector<Workload> hostileMasks(int side) {
    std::vector<Workload> masks;
    addNoise(masks, side);
    addPlateaus(masks, side);
    addGradients(masks, side);
    addRepeated(masks, side);
    addPictures(masks, side);
    return masks;
}

}  // namespace vorel_bench
