#include "blend_scene.h"

#include <cstring>
#include <map>
#include <utility>

#include "tests/support/random.h"
#include "workload.h"

namespace vorel_bench {
namespace {

uint8_t scaled(uint32_t value, uint32_t alpha) {
    return static_cast<uint8_t>(value * alpha / 255);
}

/// A straight colour at the alpha `coverage`, premultiplied.
uint32_t covered(uint32_t rgb, uint32_t coverage) {
    return coverage << 24 | uint32_t{scaled(rgb >> 16 & 0xFF, coverage)} << 16 |
           uint32_t{scaled(rgb >> 8 & 0xFF, coverage)} << 8 | scaled(rgb & 0xFF, coverage);
}

void appendPixel(std::vector<uint8_t>& bytes, uint32_t word) {
    for (const int shift : {16, 8, 0, 24})
        bytes.push_back(static_cast<uint8_t>(word >> shift));
}

/// Coverage of a page that repeats the line 48 from (`shift`, `shift`) on, a quarter of it blank.
uint8_t pageCoverage(int x, int y, int shift) {
    const Workload& line = line48();
    const int column = (x + line.width - shift) % line.width;
    const int row = (y + line.height - shift) % (line.height + line.height / 3);
    return row < line.height ? line.mask[static_cast<size_t>(row * line.width + column)] : 0;
}

/// Text in a ramp of colours above the same text moved and dark.
BlendScene textScene(const SceneKind& kind) {
    BlendScene scene;
    for (int y = 0; y < kind.height; ++y) {
        const auto red = static_cast<uint32_t>(255 * y / kind.height);
        for (int x = 0; x < kind.width; ++x) {
            const uint8_t coverage = pageCoverage(x, y, 0);
            scene.mask.push_back(coverage);
            scene.source.push_back(covered(red << 16 | 0x4080U, coverage));
            appendPixel(scene.before, covered(0x202830U, pageCoverage(x, y, 4)));
        }
    }
    return scene;
}

BlendScene randomScene(const SceneKind& kind) {
    BlendScene scene;
    vorel_test::Random random(2);
    for (int64_t i = 0; i < kind.pixels(); ++i) {
        scene.mask.push_back(random.byte());
        scene.source.push_back(covered(random.next(), random.byte()));
        appendPixel(scene.before, covered(random.next(), random.byte()));
    }
    return scene;
}

}  // namespace

const BlendScene& sceneOf(const SceneKind& kind) {
    static std::map<std::string, BlendScene> scenes;
    BlendScene& scene = scenes[blendRow("", kind)];
    if (scene.mask.empty()) {
        scene = kind.data == std::string("text") ? textScene(kind) : randomScene(kind);
        scene.width = kind.width;
        scene.height = kind.height;
    }
    return scene;
}

std::string blendRow(const std::string& operation, const SceneKind& kind) {
    return "blend/" + operation + "/" + kind.data + "/" + std::to_string(kind.width) + "x" +
           std::to_string(kind.height);
}

BlendJob::BlendJob(const SceneKind& kind, Paint paint)
    : mScene(sceneOf(kind)),
      mDestination(static_cast<unsigned int>(kind.width), static_cast<unsigned int>(kind.height), 4),
      mPaint(std::move(paint)) {}

void BlendJob::reset() {
    std::memcpy(mDestination.mData, mScene.before.data(), mScene.before.size());
}

}  // namespace vorel_bench
