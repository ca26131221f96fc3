#include "compose/stepped_run.h"

namespace vorelcompose {

using vorelstyle::Look;
using voreltext::Frame;
using voreltext::GlyphMask;
using voreltext::Image;

SteppedRun::SteppedRun(const Look& look, const LookPlan& plan, const Frame& frame)
    : mPlan(plan), mSource(look.effects()), mEffects(look.effects()), mRun(mEffects, frame) {}

void SteppedRun::draw(const std::vector<GlyphMask>& glyphs) {
    mRun.begin();
    for (const GlyphMask& glyph : glyphs)
        mRun.draw(glyph);
}

/// Whether the run is layered is settled when it begins; it stays so without the effects that asked for
/// it.
void SteppedRun::choose(size_t effect) {
    if (mChosenId) {
        mEffects.removeEffect(*mChosenId);
    } else {
        removeAll();
    }
    const int type = mPlan.effects[effect].type;
    mChosenId = mEffects.addEffect(type, mSource.getEffect(type)->getProperty());
}

void SteppedRun::paintChosen() {
    mEffects.doEffectPostProcessing();
}

void SteppedRun::merge() {
    mRun.merge();
}

Image SteppedRun::picture() const {
    return mRun.picture();
}

void SteppedRun::removeAll() {
    for (const PlannedEffect& planned : mPlan.effects)
        mEffects.removeEffect(mEffects.getEffect(planned.type)->getId());
}

}  // namespace vorelcompose
