#include <pixman.h>

#include <cstring>

#include "blend_scene.h"
#include "peers.h"

/// pixman's operators on the same scenes, all images in the one byte order that its fast paths know.
namespace vorel_bench {
namespace {

constexpr char kPixman[] = "pixman";

struct Unref {
    void operator()(pixman_image_t* image) const { pixman_image_unref(image); }
};
using Image = std::unique_ptr<pixman_image_t, Unref>;

/// An image over `words`; mask rows are padded to whole words.
Image imageOver(pixman_format_code_t format, int width, int height, std::vector<uint32_t>& words) {
    const int stride = static_cast<int>(words.size() * 4) / height;
    return Image(pixman_image_create_bits(format, width, height, words.data(), stride));
}

Image solid(uint32_t premultiplied) {
    const auto channel = [&](int shift) {
        return static_cast<uint16_t>((premultiplied >> shift & 0xFF) * 257);
    };
    const pixman_color_t color = {channel(16), channel(8), channel(0), channel(24)};
    return Image(pixman_image_create_solid_fill(&color));
}

class PixmanJob : public Job {
  public:
    /// The source image, or the one colour through the mask.
    PixmanJob(const SceneKind& kind, pixman_op_t operation, bool throughMask)
        : mScene(sceneOf(kind)),
          mOperation(operation),
          mDestinationWords(mScene.source.size()),
          mSourceWords(mScene.source),
          mMaskWords(mScene.mask.size() / 4),
          mDestination(imageOver(PIXMAN_a8r8g8b8, kind.width, kind.height, mDestinationWords)),
          mSource(throughMask ? solid(kBlendInk)
                              : imageOver(PIXMAN_a8r8g8b8, kind.width, kind.height, mSourceWords)) {
        std::memcpy(mMaskWords.data(), mScene.mask.data(), mScene.mask.size());
        if (throughMask) mMask = imageOver(PIXMAN_a8, kind.width, kind.height, mMaskWords);
    }

    void reset() override {
        std::memcpy(mDestinationWords.data(), mScene.before.data(), mScene.before.size());
    }

    void paint() override {
        pixman_image_composite32(mOperation, mSource.get(), mMask.get(), mDestination.get(), 0, 0, 0, 0,
                                 0, 0, mScene.width, mScene.height);
    }

  private:
    const BlendScene& mScene;
    pixman_op_t mOperation;
    std::vector<uint32_t> mDestinationWords;
    std::vector<uint32_t> mSourceWords;
    std::vector<uint32_t> mMaskWords;
    Image mDestination;
    Image mSource;
    Image mMask;
};

struct Operation {
    const char* name;
    pixman_op_t operation;
    bool throughMask;
};
constexpr Operation kOperations[] = {{"src-over", PIXMAN_OP_OVER, false},
                                     {"dst-over", PIXMAN_OP_OVER_REVERSE, false},
                                     {"mask-mode1", PIXMAN_OP_OVER, true},
                                     {"mask-mode2", PIXMAN_OP_OVER_REVERSE, true}};

}  // namespace

void addPixmanCases(Cases& cases) {
    for (const SceneKind& kind : kScenes) {
        for (const Operation& operation : kOperations) {
            cases.push_back(caseOf<PixmanJob>(blendRow(operation.name, kind), kPixman, kind.pixels(),
                                              kind, operation.operation, operation.throughMask));
        }
    }
}

}  // namespace vorel_bench
