#pragma once

#include <voreleffect/VFEffect.h>

#include <cstddef>
#include <vector>

#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

/// How a set of effects paints a run.
struct Plan {
    bool layered;             ///< the effects outside the glyphs have a layer of their own
    std::vector<int> order;   ///< effect types in the order of painting, the topmost first
    std::vector<bool> under;  ///< for each of them, whether it lies beneath the text
};

/// The plan of a look. Nothing is painted.
Plan planOf(const vorelstyle::Look& look);

/// What one step of a run takes.
struct Cost {
    double milliseconds = 0;
    size_t bytes = 0;  ///< most working memory at one time; 0 where MemoryMeter does not work
};

struct MeasuredRun {
    Cost glyphs;                ///< planning the layers and merging the glyphs' coverage
    std::vector<Cost> effects;  ///< in the order of the plan; memory beyond that of the layers
    Cost merge;                 ///< merging the layers into the picture
    Cost whole;                 ///< the steps together, with all their memory but the picture's
};

/// Paints a run with each effect on its own, in the order of the plan, into one picture, which goes to
/// `picture` unless that is null.
MeasuredRun measuredRun(const vorelstyle::Look& look, const Plan& plan, const voreltext::Frame& frame,
                        const std::vector<voreltext::GlyphMask>& glyphs,
                        voreltext::Image* picture = nullptr);

/// Glyphs that are painted as one run.
struct RunOfGlyphs {
    voreltext::Frame frame;
    std::vector<voreltext::GlyphMask> masks;
};

/// What the runs of a look take together: the time of all, the memory of the one that takes most. There
/// is at least one.
MeasuredRun measuredRuns(const vorelstyle::Look& look, const Plan& plan,
                         const std::vector<RunOfGlyphs>& runs);

/// A run with the median of each time in `runs`, of which there is at least one.
MeasuredRun medianOf(std::vector<MeasuredRun> runs);

}  // namespace vorelpaint
