#include "compose/step_pictures.h"

#include <voreleffect/VFEffect.h>

#include "compose/plan.h"

namespace vorelcompose {
namespace {

using VFontEffect::VFEffect;
using vorelstyle::kTextType;
using voreltext::Image;
using voreltext::Layer;

Image painted(const Composition& composition, const Layer& layer) {
    return voreltext::paint({layer}, composition.text().layout(), composition.canvas());
}

/// The layer of a look, which paints other effects where it stands, and nothing of colour fonts.
Layer layerOf(const Composition& composition, size_t look, const VFEffect& effects) {
    Layer layer = composition.looks().layers()[look];
    layer.effects = &effects;
    layer.takesPictures = false;
    return layer;
}

}  // namespace

Image coveragePicture(const Composition& composition, size_t look) {
    VFEffect effects;
    effects.addText(0xFFFFFF, 1);
    Layer layer = layerOf(composition, look, effects);
    layer.colours.clear();
    return painted(composition, layer);
}

Image effectPicture(const Composition& composition, size_t look, size_t effect) {
    const vorelstyle::Look& whole = composition.looks().stack().looks()[look].look;
    const LookPlan plan = planOf(whole);
    const int type = plan.effects[effect].type;
    VFEffect source(whole.effects());
    VFEffect alone;
    // A text opacity says no more than whether the run is layered; the clear fill cuts.
    alone.setTextOpacity(plan.layered ? 0.0F : 1.0F);
    alone.addText(0, 0);
    alone.addEffect(type, source.getEffect(type)->getProperty());
    Layer layer = layerOf(composition, look, alone);
    if (type != kTextType) layer.colours.clear();
    return painted(composition, layer);
}

Image fontPicture(const Composition& composition, size_t look) {
    VFEffect effects;
    effects.addText(0, 0);
    Layer layer = layerOf(composition, look, effects);
    layer.colours.clear();
    layer.takesPictures = composition.looks().layers()[look].takesPictures;
    return painted(composition, layer);
}

Image lookPicture(const Composition& composition, size_t look) {
    return painted(composition, composition.looks().layers()[look]);
}

}  // namespace vorelcompose
