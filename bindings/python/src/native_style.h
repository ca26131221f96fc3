#pragma once

#include <pybind11/pybind11.h>

#include <map>
#include <memory>
#include <string>

#include "compose/layer_set.h"
#include "style/vorelstyle.h"

namespace vorelpython {

namespace py = pybind11;

/// A style with the pictures of its patterns.
struct NativeStyle {
    using Images = std::map<std::string, vorelstyle::PatternImage>;

    vorelcompose::FoundStyle found;
    std::shared_ptr<const Images> images;
};

void defineStyles(py::module_& module);

}  // namespace vorelpython
