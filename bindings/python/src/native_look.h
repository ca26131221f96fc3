#pragma once

#include <pybind11/pybind11.h>
#include <voreleffect/look.h>

#include <memory>
#include <vector>

#include "compose/layer_set.h"
#include "style/vorelstyle.h"

namespace vorelpython {

namespace py = pybind11;

/// A look as Python holds it: a tuple of its fill, the fill's opacity, whether it is filled, the text's
/// opacity, and the effects in their order. Each effect is a tuple whose first element is its name in a
/// style file:
///
///     ("outerShadow", color, angle, distance, size, opacity), and "innerShadow"
///     ("outerGlow", size, color, opacity, stops), and "innerGlow"
///     ("linearGradient", angle, scale, opacity, stops)
///     ("radialGradient", scale, opacity, stops)
///     ("stroke", size, color, opacity, position)
///     ("pattern", width, height, bytes, scale, opacity)
///
/// Stops are tuples of (color, place, opacity), positions the numbers of Position.
struct NativeLook {
    VFontEffect::Look look;
    vorelstyle::LookStyle style;  ///< the same; its pattern has no name
    vorelstyle::PatternImage pattern;
};

/// Throws TypeError for what is no such tuple.
NativeLook lookOf(const py::tuple& state);

/// The tuple of a look of a style whose lengths are resolved. Throws StyleError for effects that are not
/// painted.
py::tuple stateOf(const vorelstyle::Style& style, size_t position, const vorelstyle::LoadImage& load);

/// A stack of looks as a style; a text that is painted in it is painted in the looks.
vorelcompose::FoundStyle styleOf(const std::vector<std::shared_ptr<NativeLook>>& looks);

void defineLooks(py::module_& module);

}  // namespace vorelpython
