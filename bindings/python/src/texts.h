#pragma once

#include <pybind11/pybind11.h>

namespace vorelpython {

/// Painting texts in fonts.
void defineTexts(pybind11::module_& module);

}  // namespace vorelpython
