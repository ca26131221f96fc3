#pragma once

#include <cstddef>
#include <optional>
#include <vector>

#include "compose/composition.h"
#include "compose/plan.h"
#include "compose/stepped_run.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// A step of painting a composition.
struct PaintingStep {
    enum class Kind {
        glyphs,  ///< planning the layers and merging the coverage of the glyphs
        effect,  ///< painting one effect
        merge,   ///< merging the layers, and laying the result on the canvas
    };

    size_t look;  ///< its position in the stack, 0 the lowest
    size_t span;  ///< its position in reading order; what is painted as one block has one
    Kind kind;
    size_t effect;  ///< of an effect: its position in the plan of the look; else 0
};

/// A composition painted step by step, so that its caller may put a clock around each of them:
///
///     PaintingSteps steps(composition);
///     while (steps.prepare()) {
///         // start the clock
///         steps.paint();
///         // stop it: that is what steps.step() takes
///     }
///     steps.picture();  // the bytes of composition.paint()
///
/// Look by look, the lowest first, and in each span by span. The glyphs of a span come first, then the
/// effects in the order of the plan, then the merge. Throws TextError as Composition::paint.
class PaintingSteps {
  public:
    /// The composition must outlive it.
    explicit PaintingSteps(const Composition& composition);

    PaintingSteps(const PaintingSteps&) = delete;
    PaintingSteps& operator=(const PaintingSteps&) = delete;

    const std::vector<StackedPlan>& plans() const { return mPlans; }  ///< of the looks, the lowest first

    /// Makes the next step ready to be painted; false when there is none. To be called after each paint.
    bool prepare();
    const PaintingStep& step() const { return mStep; }  ///< that was prepared last
    void paint();

    /// What is painted so far on the canvas; premultiplied.
    const voreltext::Image& picture() const { return mPicture; }

  private:
    void addSteps(size_t look);
    void beginSpan();
    void layMerged();

    const Composition& mComposition;
    std::vector<StackedPlan> mPlans;
    std::vector<std::vector<std::vector<size_t>>> mSpans;  ///< of each look, the glyphs of each
    std::vector<PaintingStep> mSteps;
    size_t mNext = 0;
    PaintingStep mStep{};
    voreltext::Image mPicture;
    std::optional<voreltext::LayerPainter> mPainter;  ///< of the present look
    std::optional<voreltext::LayerPart> mPart;        ///< the present span
    std::optional<SteppedRun> mRun;
};

}  // namespace vorelcompose
