#pragma once

#include <voreleffect/VFEffect.h>

#include <cstddef>
#include <optional>
#include <vector>

#include "compose/plan.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// A run that paints each effect on its own, in the order of the plan, into one picture: the picture of
/// the run in one. The calls come in the order in which they stand here, the middle two once for each
/// effect from the first on.
class SteppedRun {
  public:
    /// The plan must outlive it. Throws TextError when the picture would be too large.
    SteppedRun(const vorelstyle::Look& look, const LookPlan& plan, const voreltext::Frame& frame);

    SteppedRun(const SteppedRun&) = delete;
    SteppedRun& operator=(const SteppedRun&) = delete;

    /// Plans the layers and merges the glyphs' coverage.
    void draw(const std::vector<voreltext::GlyphMask>& glyphs);

    void choose(size_t effect);  ///< by its position in the plan; nothing is painted
    void paintChosen();

    void merge();  ///< merges the layers into the picture

    voreltext::Image picture() const;  ///< premultiplied, of the size of the frame

  private:
    void removeAll();

    const LookPlan& mPlan;
    VFontEffect::VFEffect mSource;   ///< has every effect
    VFontEffect::VFEffect mEffects;  ///< that of the run, which has the chosen one once there is one
    voreltext::Run mRun;
    std::optional<int> mChosenId;
};

}  // namespace vorelcompose
