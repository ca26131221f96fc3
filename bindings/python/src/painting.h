#pragma once

#include <pybind11/pybind11.h>

namespace vorelpython {

/// Painting masks in looks.
void definePainting(pybind11::module_& module);

}  // namespace vorelpython
