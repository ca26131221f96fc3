#include "spread_colours.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace vorelpaint {
namespace {

/// How many steps away the pixel is that each one has its colour from, in two sweeps: what comes from
/// the left and from above is known in the first, what comes from the other sides in the second.
class ColourSpread {
  public:
    ColourSpread(voreltext::Image& image, int reach)
        : mPixels(image.pixels.data()),
          mWidth(static_cast<size_t>(image.width)),
          mHeight(static_cast<size_t>(image.height)),
          mSteps(mWidth * mHeight),
          mFar(static_cast<uint8_t>(reach + 1)) {
        for (size_t i = 0; i < mSteps.size(); ++i)
            mSteps[i] = mPixels[4 * i + 3] == 0 ? mFar : 0;
    }

    void sweepDown() {
        for (size_t y = 0; y < mHeight; ++y) {
            for (size_t x = 0; x < mWidth; ++x) {
                const size_t at = y * mWidth + x;
                if (mSteps[at] == 0) continue;
                if (x > 0) take(at, at - 1);
                if (y > 0) take(at, at - mWidth);
            }
        }
    }

    void sweepUp() {
        for (size_t y = mHeight; y-- > 0;) {
            for (size_t x = mWidth; x-- > 0;) {
                const size_t at = y * mWidth + x;
                if (mSteps[at] == 0) continue;
                if (x + 1 < mWidth) take(at, at + 1);
                if (y + 1 < mHeight) take(at, at + mWidth);
            }
        }
    }

  private:
    void take(size_t to, size_t from) {
        if (mSteps[from] + 1 >= mSteps[to]) return;
        mSteps[to] = static_cast<uint8_t>(mSteps[from] + 1);
        std::copy_n(mPixels + 4 * from, 3, mPixels + 4 * to);
    }

    uint8_t* mPixels;
    size_t mWidth;
    size_t mHeight;
    std::vector<uint8_t> mSteps;
    uint8_t mFar;
};

}  // namespace

void spreadColours(voreltext::Image& image, int reach) {
    ColourSpread spread(image, reach);
    spread.sweepDown();
    spread.sweepUp();
}

}  // namespace vorelpaint
