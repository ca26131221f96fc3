#include "compose/painting_steps.h"

namespace vorelcompose {

using voreltext::Image;
using Kind = PaintingStep::Kind;

PaintingSteps::PaintingSteps(const Composition& composition)
    : mComposition(composition),
      mPlans(plansOf(composition.looks().stack())),
      mPicture(voreltext::transparentImage(composition.canvas().width, composition.canvas().height)) {
    for (const voreltext::Layer& layer : composition.looks().layers())
        mSpans.push_back(spansOf(composition.text().layout(), layer.span));
    for (size_t look = 0; look < mPlans.size(); ++look)
        addSteps(look);
}

void PaintingSteps::addSteps(size_t look) {
    for (size_t span = 0; span < mSpans[look].size(); ++span) {
        mSteps.push_back({look, span, Kind::glyphs, 0});
        for (size_t effect = 0; effect < mPlans[look].look.effects.size(); ++effect)
            mSteps.push_back({look, span, Kind::effect, effect});
        mSteps.push_back({look, span, Kind::merge, 0});
    }
}

bool PaintingSteps::prepare() {
    if (mNext == mSteps.size()) return false;
    mStep = mSteps[mNext++];
    if (mStep.kind == Kind::glyphs) beginSpan();
    if (mStep.kind == Kind::effect) mRun->choose(mStep.effect);
    return true;
}

void PaintingSteps::paint() {
    switch (mStep.kind) {
        case Kind::glyphs:
            return mRun->draw(mPart->masks);
        case Kind::effect:
            return mRun->paintChosen();
        default:
            mRun->merge();
            layMerged();
    }
}

/// A look's painter is kept from span to span: it copies the look.
void PaintingSteps::beginSpan() {
    const LayerSet& looks = mComposition.looks();
    if (mStep.span == 0) mPainter.emplace(looks.layers()[mStep.look]);
    mPart = mPainter->part(mComposition.text().layout(), mSpans[mStep.look][mStep.span]);
    mRun.emplace(looks.stack().looks()[mStep.look].look, mPlans[mStep.look].look, mPart->frame);
}

void PaintingSteps::layMerged() {
    Image picture = mRun->picture();
    mPainter->colour(picture, *mPart);
    mPainter->lay(picture, *mPart, mPicture, mComposition.canvas());
    mPainter->layPictures(*mPart, mPicture, mComposition.canvas());
}

}  // namespace vorelcompose
