/// The bytes are a style file. Either it is read, with every number in its range and one fill at most,
/// and becomes a set of effects and a C++ source, or it is refused with a StyleError of one line;
/// nothing else may be thrown.
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <sstream>
#include <string>
#include <string_view>

#include "style/vorelstyle.h"

namespace {

using namespace vorelstyle;

[[noreturn]] void fail(const char* what) {
    std::fprintf(stderr, "%s\n", what);
    std::abort();
}

void requireIn(double value, double low, double high, const char* name) {
    if (!(value >= low && value <= high)) fail(name);
}

void requireColour(uint32_t color) {
    if (color > 0xFFFFFF) fail("a colour has an alpha byte");
}

void requireStops(const Stops& stops) {
    float last = 0.0F;
    for (const VFontEffect::VFGradient& stop : stops) {
        requireColour(stop.mColor);
        requireIn(stop.mOpacity, 0, 1, "stop opacity");
        requireIn(stop.mLocation, last, 1, "stop location");
        last = stop.mLocation;
    }
}

/// The numbers of one effect lie in the ranges of its add-call.
struct RangeCheck {
    void operator()(const Shadow& e) const {
        requireIn(e.angle, -360, 360, "shadow angle");
        requireIn(e.distance, 0, 100, "shadow distance");
        requireIn(e.size, 0, 100, "shadow size");
        requireIn(e.opacity, 0, 1, "shadow opacity");
        requireColour(e.color);
    }
    void operator()(const Glow& e) const {
        requireIn(e.size, 0, 100, "glow size");
        requireIn(e.opacity, 0, 1, "glow opacity");
        requireColour(e.color);
        requireStops(e.gradient);
    }
    void operator()(const Relief& e) const {
        requireIn(e.size, 0, 100, "relief size");
        requireIn(e.opacity, 0, 1, "relief opacity");
        requireColour(e.highlightColor);
        requireColour(e.shadowColor);
    }
    void operator()(const LinearGradient& e) const {
        requireIn(e.angle, -360, 360, "gradient angle");
        requireIn(e.opacity, 0, 1, "gradient opacity");
        if (e.gradient.empty()) fail("a gradient has no stops");
        requireStops(e.gradient);
    }
    void operator()(const RadialGradient& e) const {
        requireIn(e.opacity, 0, 1, "gradient opacity");
        if (e.gradient.empty()) fail("a gradient has no stops");
        requireStops(e.gradient);
    }
    void operator()(const Stroke& e) const {
        requireIn(e.size, 0, 100, "stroke size");
        requireIn(e.opacity, 0, 1, "stroke opacity");
        requireIn(e.position, 0, 2, "stroke position");
        requireColour(e.color);
    }
    void operator()(const Pattern& e) const {
        requireIn(e.opacity, 0, 1, "pattern opacity");
        if (e.image.empty()) fail("a pattern has no image");
    }
    void operator()(const TextFill& e) const {
        requireIn(e.opacity, 0, 1, "text opacity");
        requireColour(e.color);
    }
};

void require(const Style& style) {
    if (style.color && hasTextFill(style)) fail("a style has two fills");
    if (style.color) requireColour(*style.color);
    if (style.textOpacity) requireIn(*style.textOpacity, 0, 1, "text opacity");
    for (const Effect& effect : style.effects) {
        if (effectName(effect).empty()) fail("an effect has no name");
        std::visit(RangeCheck(), effect);
    }
}

/// A picture for every pattern but those that have no name.
PatternImage load(const std::string& image) {
    if (image.size() < 2) throw StyleError("no picture");
    return {1, 1, {1, 2, 3, 4}};
}

void requireLook(const Style& style) {
    const Look look(style, fillOf(style), opacityOf(style), load);
    if (look.added().size() > style.effects.size() + 1)
        fail("a look has effects that its style has not");
    if (look.added().size() + look.unpainted().size() < style.effects.size()) fail("an effect is lost");
    // A pattern leaves no trace in a key.
    if (keyFragments(look.key()).size() > look.added().size()) fail("a key has too many fragments");
    std::ostringstream source;
    writeCpp(source, functionName(style.description), style, fillOf(style), opacityOf(style), load);
    if (source.str().empty()) fail("a look is written as nothing");
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string_view json(reinterpret_cast<const char*>(data), size);
    try {
        const Style style = parseStyle(json, "styles");
        require(style);
        for (const float factor : {0.01F, 0.5F, 1.0F})
            require(scaledStyle(style, factor));
        requireLook(style);
    } catch (const StyleError& error) {
        const std::string_view message = error.what();
        if (message.empty() || message.find('\n') != std::string_view::npos) {
            fail("the message of a refused style is not one line");
        }
    }
    return 0;
}
