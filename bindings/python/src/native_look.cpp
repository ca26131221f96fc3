#include "native_look.h"

#include <pybind11/stl.h>

#include <functional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>
#include <variant>

namespace vorelpython {
namespace {

using vorelcompose::FoundStyle;
using vorelstyle::Length;
using vorelstyle::LookStyle;
using vorelstyle::PatternImage;
using vorelstyle::Stops;
using vorelstyle::Style;
using vorelstyle::StyleError;

Length pixels(const py::handle& value) {
    return {value.cast<float>()};
}

Stops stopsOf(const py::handle& list) {
    Stops stops;
    for (const py::handle& each : list) {
        const auto [color, place, opacity] = each.cast<std::tuple<uint32_t, float, float>>();
        stops.push_back({color, opacity, place});
    }
    return stops;
}

py::tuple tupleOf(const Stops& stops) {
    py::list list;
    for (const auto& stop : stops)
        list.append(py::make_tuple(stop.mColor, stop.mLocation, stop.mOpacity));
    return py::tuple(list);
}

std::vector<VFontEffect::Stop> stopsOf(const Stops& stops) {
    std::vector<VFontEffect::Stop> list;
    for (const auto& stop : stops)
        list.push_back({VFontEffect::rgb(stop.mColor), stop.mOpacity, stop.mLocation});
    return list;
}

template <typename Shadow>
vorelstyle::Effect shadowOf(const py::tuple& t) {
    return Shadow{
        {t[2].cast<float>(), pixels(t[3]), pixels(t[4]), t[1].cast<uint32_t>(), t[5].cast<float>()}};
}

template <typename Glow>
vorelstyle::Effect glowOf(const py::tuple& t) {
    return Glow{{pixels(t[1]), t[2].cast<uint32_t>(), t[3].cast<float>(), stopsOf(t[4])}};
}

vorelstyle::Effect linearOf(const py::tuple& t) {
    return vorelstyle::LinearGradient{t[1].cast<float>(), t[2].cast<float>(), t[3].cast<float>(),
                                      stopsOf(t[4])};
}

vorelstyle::Effect radialOf(const py::tuple& t) {
    return vorelstyle::RadialGradient{t[1].cast<float>(), t[2].cast<float>(), stopsOf(t[3])};
}

vorelstyle::Effect strokeOf(const py::tuple& t) {
    return vorelstyle::Stroke{pixels(t[1]), t[2].cast<uint32_t>(), t[3].cast<float>(), 0,
                              t[4].cast<int>()};
}

vorelstyle::Effect patternOf(const py::tuple& t) {
    return vorelstyle::Pattern{"", t[4].cast<float>(), t[5].cast<float>(), {}};
}

vorelstyle::Effect effectOf(const py::tuple& t) {
    static const std::unordered_map<std::string_view, vorelstyle::Effect (*)(const py::tuple&)> kinds{
        {"outerShadow", shadowOf<vorelstyle::OuterShadow>},
        {"innerShadow", shadowOf<vorelstyle::InnerShadow>},
        {"outerGlow", glowOf<vorelstyle::OuterGlow>},
        {"innerGlow", glowOf<vorelstyle::InnerGlow>},
        {"linearGradient", linearOf},
        {"radialGradient", radialOf},
        {"stroke", strokeOf},
        {"pattern", patternOf}};
    const auto kind = kinds.find(t[0].cast<std::string>());
    if (kind == kinds.end()) throw py::type_error("no effect");
    return kind->second(t);
}

PatternImage imageOf(const py::tuple& t) {
    PatternImage image{t[1].cast<int>(), t[2].cast<int>(), {}};
    const auto bytes = t[3].cast<std::string_view>();
    const bool isWhole =
        image.width > 0 && image.height > 0 &&
        bytes.size() / 4 / static_cast<size_t>(image.width) == static_cast<size_t>(image.height) &&
        bytes.size() % 4 == 0;
    if (!isWhole) throw py::type_error("a pattern without its pixels");
    image.pixels.assign(bytes.begin(), bytes.end());
    return image;
}

/// Adds the effects of a style to a look of look.h.
class Adder {
  public:
    Adder(VFontEffect::Look& look, const PatternImage& pattern) : mLook(look), mPattern(pattern) {}

    void operator()(const vorelstyle::OuterShadow& e) const { addShadow<VFontEffect::OuterShadow>(e); }
    void operator()(const vorelstyle::InnerShadow& e) const { addShadow<VFontEffect::InnerShadow>(e); }
    void operator()(const vorelstyle::OuterGlow& e) const { addGlow<VFontEffect::OuterGlow>(e); }
    void operator()(const vorelstyle::InnerGlow& e) const { addGlow<VFontEffect::InnerGlow>(e); }
    void operator()(const vorelstyle::LinearGradient& e) const {
        mLook.add(VFontEffect::LinearGradient(stopsOf(e.gradient))
                      .angle(e.angle)
                      .scale(e.scale)
                      .opacity(e.opacity));
    }
    void operator()(const vorelstyle::RadialGradient& e) const {
        mLook.add(VFontEffect::RadialGradient(stopsOf(e.gradient)).scale(e.scale).opacity(e.opacity));
    }
    void operator()(const vorelstyle::Stroke& e) const {
        mLook.add(VFontEffect::Stroke(e.size.value, VFontEffect::rgb(e.color))
                      .position(static_cast<VFontEffect::Position>(e.position))
                      .opacity(e.opacity));
    }
    void operator()(const vorelstyle::Pattern& e) const {
        mLook.add(VFontEffect::Pattern({mPattern.pixels.data(), mPattern.width, mPattern.height})
                      .scale(e.scale)
                      .opacity(e.opacity));
    }
    template <typename Other>
    void operator()(const Other& /*effect*/) const {}

  private:
    template <typename Shadow>
    void addShadow(const vorelstyle::Shadow& e) const {
        mLook.add(Shadow(VFontEffect::rgb(e.color))
                      .angle(e.angle)
                      .distance(e.distance.value)
                      .size(e.size.value)
                      .opacity(e.opacity));
    }
    template <typename Glow>
    void addGlow(const vorelstyle::Glow& e) const {
        mLook.add(
            Glow(e.size.value, VFontEffect::rgb(e.color)).stops(stopsOf(e.gradient)).opacity(e.opacity));
    }

    VFontEffect::Look& mLook;
    const PatternImage& mPattern;
};

/// What is to be told of an effect of a style; of a text's fill nothing.
class EffectState {
  public:
    explicit EffectState(const vorelstyle::LoadImage& load) : mLoad(load) {}

    py::tuple operator()(const vorelstyle::OuterShadow& e) const { return shadow("outerShadow", e); }
    py::tuple operator()(const vorelstyle::InnerShadow& e) const { return shadow("innerShadow", e); }
    py::tuple operator()(const vorelstyle::OuterGlow& e) const { return glow("outerGlow", e); }
    py::tuple operator()(const vorelstyle::InnerGlow& e) const { return glow("innerGlow", e); }
    py::tuple operator()(const vorelstyle::LinearGradient& e) const {
        return py::make_tuple("linearGradient", e.angle, e.scale, e.opacity, tupleOf(e.gradient));
    }
    py::tuple operator()(const vorelstyle::RadialGradient& e) const {
        return py::make_tuple("radialGradient", e.scale, e.opacity, tupleOf(e.gradient));
    }
    py::tuple operator()(const vorelstyle::Stroke& e) const {
        return py::make_tuple("stroke", e.size.value, e.color, e.opacity, e.position);
    }
    py::tuple operator()(const vorelstyle::Pattern& e) const {
        if (!mLoad) throw StyleError("pattern.image: " + e.image + " is not at hand");
        const PatternImage image = mLoad(e.image);
        const auto* const bytes = reinterpret_cast<const char*>(image.pixels.data());
        return py::make_tuple("pattern", image.width, image.height,
                              py::bytes(bytes, image.pixels.size()),
                              patternScale(e, image, [](const std::string&) {}), e.opacity);
    }
    py::tuple operator()(const vorelstyle::TextFill&) const { return py::tuple(); }
    py::tuple operator()(const vorelstyle::Relief&) const {
        throw StyleError("the library has no core for bevel and emboss");
    }

  private:
    static py::tuple shadow(const char* name, const vorelstyle::Shadow& e) {
        return py::make_tuple(name, e.color, e.angle, e.distance.value, e.size.value, e.opacity);
    }
    static py::tuple glow(const char* name, const vorelstyle::Glow& e) {
        return py::make_tuple(name, e.size.value, e.color, e.opacity, tupleOf(e.gradient));
    }

    const vorelstyle::LoadImage& mLoad;
};

float ownFillOpacityOf(const LookStyle& look) {
    for (const vorelstyle::Effect& effect : look.effects) {
        if (const auto* fill = std::get_if<vorelstyle::TextFill>(&effect)) return fill->opacity;
    }
    return 1;
}

void setFill(NativeLook& native, uint32_t fill, float fillOpacity, bool isFilled, float textOpacity) {
    native.look.fill(VFontEffect::rgb(fill), fillOpacity).textOpacity(textOpacity);
    LookStyle& style = native.style;
    style.isFilled = isFilled;
    if (!isFilled) {
        native.look.noFill();
        return;
    }
    style.color = fill;
    style.textOpacity = textOpacity;
    if (fillOpacity < 1) style.effects.emplace_back(vorelstyle::TextFill{fill, fillOpacity});
}

}  // namespace

NativeLook lookOf(const py::tuple& state) {
    const auto [fill, fillOpacity, isFilled, textOpacity, effects] =
        state.cast<std::tuple<uint32_t, float, bool, float, py::tuple>>();
    NativeLook native;
    for (const py::handle& each : effects) {
        const auto effect = each.cast<py::tuple>();
        native.style.effects.push_back(effectOf(effect));
        if (std::holds_alternative<vorelstyle::Pattern>(native.style.effects.back()))
            native.pattern = imageOf(effect);
        std::visit(Adder(native.look, native.pattern), native.style.effects.back());
    }
    setFill(native, fill, fillOpacity, isFilled, textOpacity);
    return native;
}

py::tuple stateOf(const Style& style, size_t position, const vorelstyle::LoadImage& load) {
    const LookStyle& look = style.looks[position];
    py::list effects;
    for (const vorelstyle::Effect& effect : look.effects) {
        const py::tuple state = std::visit(EffectState(load), effect);
        if (!state.empty()) effects.append(state);
    }
    const float textOpacity = look.isFilled ? look.textOpacity.value_or(1.0F) : 1.0F;
    return py::make_tuple(fillOf(look), ownFillOpacityOf(look), look.isFilled, textOpacity,
                          py::tuple(effects));
}

FoundStyle styleOf(const std::vector<std::shared_ptr<NativeLook>>& looks) {
    auto style = std::make_shared<Style>();
    style->version = 2;
    style->isList = looks.size() > 1;
    style->looks.clear();
    for (size_t i = 0; i < looks.size(); ++i) {
        style->looks.push_back(looks[i]->style);
        for (vorelstyle::Effect& effect : style->looks.back().effects) {
            if (auto* pattern = std::get_if<vorelstyle::Pattern>(&effect))
                pattern->image = std::to_string(i);
        }
    }
    const auto load = [looks](const std::string& name) { return looks[std::stoul(name)]->pattern; };
    return {std::move(style), load};
}

void defineLooks(py::module_& module) {
    py::class_<NativeLook, std::shared_ptr<NativeLook>>(module, "NativeLook")
        .def(
            py::init([](const py::tuple& state) { return std::make_shared<NativeLook>(lookOf(state)); }))
        .def("key", [](const NativeLook& self) { return py::bytes(self.look.key()); })
        .def("margins", [](const NativeLook& self) {
            const VFontEffect::Margins margins = self.look.margins();
            return py::make_tuple(margins.left, margins.top, margins.right, margins.bottom);
        });
}

}  // namespace vorelpython
