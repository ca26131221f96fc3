#pragma once

#include <algorithm>
#include <cstdint>

#include "core/arena.h"
#include "core/assert.h"
#include "core/line_buffer.h"
#include "ops/blur/blur_input.h"
#include "ops/blur/dot_loops.h"

namespace VFontEffect::internal {

/// Groups of four rows.
struct GroupRange {
    int64_t first;
    int64_t end;
};

/// The rows in reach of the pass down, which come in groups of four while the results go by.
struct TapGroups {
    TapColumns columns;
    GroupRange missing;  ///< of those that the window's results need
    int64_t steps;
    int64_t capacity;
    int64_t strips;
    int64_t groupBytes;

    /// No group has been stored yet.
    void clear() const;

    /// Calls feed(group) for each group that is still missing for a quad of results.
    template <class Feed>
    void complete(int64_t quad, Feed feed) {
        const int64_t end = std::min(quad + steps, missing.end);
        for (; missing.first < end; ++missing.first) {
            if (missing.first == columns.firstGroup + capacity) forgetBefore(quad);
            VOREL_ASSERT(missing.first - columns.firstGroup < capacity);
            feed(missing.first);
        }
    }

  private:
    void forgetBefore(int64_t group);
};

/// A blur by dot products, of any radius, four rows at a time: the two orders of the passes differ in
/// which one feeds the groups of taps.
class DotBlur {
  public:
    /// What a blur takes for an input beside its weights.
    static int64_t memoryBytes(const DotLoops& loops, const BlurInput& input);

    /// For inputs that take no more than this one, which is `memoryBytes`.
    DotBlur(const DotLoops& loops, const BlurInput& largest, int64_t memoryBytes);

    /// Whether there is memory for it.
    explicit operator bool() const { return static_cast<bool>(mMemory); }

    void begin(const BlurInput& input);

    /// Rows that are asked for at once.
    int64_t bandRows() const { return kQuad; }

    /// A band of rows from row y on, in order.
    BlurredRows rows(int64_t y);

  private:
    /// A window, and its places in the working memory.
    struct Layout {
        Box window;
        ReachedSource source;
        int64_t firstRow;  // of the source, the first of group 0
        int64_t stride;    // of results
        uint8_t* across;   // results of the pass across, when it is the first
        TapGroups taps;
        PlacedIntermediate intermediate;
        uint8_t* out;

        static Layout of(const DotLoops& loops, const BlurInput& input, Arena& arena);
    };

    void feed(int64_t group);
    void blurAcross(const PassEnding& ending, uint8_t* out);

    const DotLoops& mLoops;
    PassEnding mFirst;
    PassEnding mSecond;
    int64_t mMemoryBytes;
    LineBuffer mMemory;  // of the layout, and behind it of the weights
    PackedBlur mBlur = {};
    Layout mLayout = {};
};

}  // namespace VFontEffect::internal
