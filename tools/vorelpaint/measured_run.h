#pragma once

#include <cstddef>
#include <vector>

#include "compose/vorelcompose.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelpaint {

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
MeasuredRun measuredRun(const vorelstyle::Look& look, const vorelcompose::LookPlan& plan,
                        const voreltext::Frame& frame, const std::vector<voreltext::GlyphMask>& glyphs,
                        voreltext::Image* picture = nullptr);

/// Glyphs that are painted as one run.
struct RunOfGlyphs {
    voreltext::Frame frame;
    std::vector<voreltext::GlyphMask> masks;
};

/// What the runs of a look take together: the time of all, the memory of the one that takes most. There
/// is at least one.
MeasuredRun measuredRuns(const vorelstyle::Look& look, const vorelcompose::LookPlan& plan,
                         const std::vector<RunOfGlyphs>& runs);

/// A run with the median of each time in `runs`, of which there is at least one.
MeasuredRun medianOf(std::vector<MeasuredRun> runs);

}  // namespace vorelpaint
