/// The bytes up to the first 0 are a style file, those behind it choose the font size and the scale.
/// Either the file is read, with every number in its range and one fill a look at most, resolved, and
/// becomes a stack of sets of effects and a C++ source, or it is refused with a StyleError of one line;
/// nothing else may be thrown.
#include <algorithm>
#include <cmath>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "decoder.h"
#include "demand.h"
#include "style/vorelstyle.h"

namespace {

using namespace vorel_fuzz;
using namespace vorelstyle;

void demandStops(const Stops& stops) {
    float last = 0.0F;
    for (const VFontEffect::VFGradient& stop : stops) {
        demandColour(stop.mColor);
        demandIn(stop.mOpacity, 0, 1, "stop opacity");
        demandIn(stop.mLocation, last, 1, "stop location");
        last = stop.mLocation;
    }
}

/// The numbers of one effect lie in the ranges of its add-call.
struct RangeCheck {
    bool isResolved;

    void operator()(const Shadow& e) const {
        demandIn(e.angle, -360, 360, "shadow angle");
        demandSize(e.distance, "shadow distance");
        demandSize(e.size, "shadow size");
        demandIn(e.opacity, 0, 1, "shadow opacity");
        demandColour(e.color);
    }
    void operator()(const Glow& e) const {
        demandSize(e.size, "glow size");
        demandIn(e.opacity, 0, 1, "glow opacity");
        demandColour(e.color);
        demandStops(e.gradient);
    }
    void operator()(const Relief& e) const {
        demandSize(e.size, "relief size");
        demandIn(e.opacity, 0, 1, "relief opacity");
        demandColour(e.highlightColor);
        demandColour(e.shadowColor);
    }
    void operator()(const LinearGradient& e) const {
        demandIn(e.angle, -360, 360, "gradient angle");
        demandIn(e.opacity, 0, 1, "gradient opacity");
        demand(!e.gradient.empty(), "a gradient has no stops");
        demandStops(e.gradient);
    }
    void operator()(const RadialGradient& e) const {
        demandIn(e.opacity, 0, 1, "gradient opacity");
        demand(!e.gradient.empty(), "a gradient has no stops");
        demandStops(e.gradient);
    }
    void operator()(const Stroke& e) const {
        demandSize(e.size, "stroke size");
        demandIn(e.opacity, 0, 1, "stroke opacity");
        demandIn(e.position, 0, 2, "stroke position");
        demandColour(e.color);
    }
    void operator()(const Pattern& e) const {
        demandIn(e.opacity, 0, 1, "pattern opacity");
        demandIn(e.scale, static_cast<double>(kSmallestPatternScale), 10, "pattern scale");
        if (e.width) demandIn(e.width->value, 0.001F, isResolved ? HUGE_VAL : 1000, "tile width");
        demand(!e.image.empty(), "a pattern has no image");
    }
    void operator()(const TextFill& e) const {
        demandIn(e.opacity, 0, 1, "text opacity");
        demandColour(e.color);
    }

  private:
    void demandSize(const Length& length, const char* name) const {
        demandIn(length.value, 0, 100, name);
        if (!isResolved) return;
        demand(length.unit == Length::Unit::pixels, "a share is not resolved");
    }
};

void demandLook(const LookStyle& look, bool isResolved) {
    demand(!look.color || !hasTextFill(look), "a look has two fills");
    if (look.color) demandColour(*look.color);
    if (look.textOpacity) demandIn(*look.textOpacity, 0, 1, "text opacity");
    for (const Length& offset : {look.offsetX, look.offsetY})
        demandIn(std::abs(offset.value), 0, isResolved ? kMaxOffset : 1000, "offset");
    for (const Effect& effect : look.effects) {
        demand(!effectName(effect).empty(), "an effect has no name");
        std::visit(RangeCheck{isResolved}, effect);
    }
}

void demandStyle(const Style& style, bool isResolved) {
    demandIn(static_cast<double>(style.looks.size()), 1, 32, "looks");
    for (const LookStyle& look : style.looks)
        demandLook(look, isResolved);
}

/// A picture for every pattern but those that have no name.
PatternImage load(const std::string& image) {
    if (image.size() < 2) throw StyleError("no picture");
    return {1, 1, {1, 2, 3, 4}};
}

/// The key tells of every look, and of no more effects than there are: a pattern leaves no trace in it.
void demandKey(const Stack& stack) {
    size_t effects = 0;
    for (const StackedLook& stacked : stack.looks())
        effects += stacked.look.added().size();
    size_t places = 0;
    const std::vector<KeyFragment> fragments = keyFragments(stack.key());
    for (const KeyFragment& fragment : fragments) {
        demand(!fragment.name.empty(), "a fragment has no name");
        if (fragment.name == "place") ++places;
    }
    const bool isOne = stack.looks().size() == 1 && places == 0;
    demand(isOne || places == stack.looks().size(), "a look has no place in the key");
    demand(fragments.size() - places <= effects, "a key has too many fragments");
}

void demandStack(const Style& style) {
    const Stack stack(style, {}, {}, load);
    demand(stack.looks().size() == style.looks.size(), "a look is lost");
    for (size_t i = 0; i < style.looks.size(); ++i) {
        const Look& look = stack.looks()[i].look;
        const size_t effects = style.looks[i].effects.size();
        demand(look.added().size() <= effects + 1, "a look has effects that its style has not");
        demand(look.added().size() + look.unpainted().size() >= effects, "an effect is lost");
    }
    for (const std::string& note : stack.notes())
        demandLine(note);
    demandKey(stack);
    const std::string source = writtenAsCpp(functionName(style.description), style, {}, {}, load);
    demand(!source.empty(), "a style is written as nothing");
}

void readAndPaint(std::string_view json, Decoder& choices) {
    const Style style = parseStyle(json, "styles");
    demandStyle(style, false);
    constexpr int kSteps = 20;  // of a scale from 0.05 to 20
    const int fontSize = choices.atEnd() ? 96 : choices.between(1, 1000);
    const int steps = choices.atEnd() ? kSteps : choices.between(1, 20 * kSteps);
    const float scale = static_cast<float>(steps) / static_cast<float>(kSteps);
    const Style resolved = resolvedStyle(style, fontSize, scale, demandLine);
    demandStyle(resolved, true);
    demandStack(resolved);
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    const std::string_view json = bytes.substr(0, bytes.find('\0'));
    const size_t behind = std::min(size, json.size() + 1);
    Decoder choices(data + behind, size - behind);
    try {
        readAndPaint(json, choices);
    } catch (const StyleError& error) {
        demandLine(error.what());
    }
    return 0;
}
