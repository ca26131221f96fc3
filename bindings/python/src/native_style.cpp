#include "native_style.h"

#include <pybind11/stl.h>

#include <optional>
#include <string_view>
#include <utility>
#include <variant>

#include "arrays.h"
#include "compose/limits.h"
#include "compose/request.h"
#include "compose/system/png_reader.h"
#include "native_look.h"

namespace vorelpython {
namespace {

using vorelcompose::FoundStyle;
using vorelcompose::LayerSet;
using vorelcompose::Request;
using vorelstyle::LoadImage;
using vorelstyle::PatternImage;
using vorelstyle::Style;
using vorelstyle::StyleError;
using Images = NativeStyle::Images;

LoadImage loaderOf(std::shared_ptr<const Images> images) {
    return [images = std::move(images)](const std::string& name) {
        const auto image = images->find(name);
        if (image == images->end()) throw StyleError("'" + name + "' is not among the images");
        return image->second;
    };
}

/// The names of the pictures of its patterns.
std::vector<std::string> imageNames(const Style& style) {
    std::vector<std::string> names;
    for (const vorelstyle::LookStyle& look : style.looks) {
        for (const vorelstyle::Effect& effect : look.effects) {
            if (const auto* pattern = std::get_if<vorelstyle::Pattern>(&effect))
                names.push_back(pattern->image);
        }
    }
    return names;
}

Images imagesOf(const py::dict& given) {
    Images images;
    for (const auto& [name, pixels] : given) {
        Pixels read = pixelsOf(py::reinterpret_borrow<py::object>(pixels));
        images[name.cast<std::string>()] = {read.width, read.height, std::move(read.rgba)};
    }
    return images;
}

/// `images` has pictures by their names, the others are files in `folder`.
NativeStyle styleOf(const std::string& json, const std::string& name, const py::dict& images,
                    const std::optional<std::string>& folder) {
    if (json.size() > vorelcompose::kMaxStyleBytes) {
        throw StyleError("a style of more than " + std::to_string(vorelcompose::kMaxStyleBytes) +
                         " bytes");
    }
    auto style = std::make_shared<const Style>(vorelstyle::parseStyle(json, name));
    auto held = std::make_shared<Images>(imagesOf(images));
    for (const std::string& image : imageNames(*style)) {
        if (held->count(image) != 0) continue;
        if (!folder) continue;
        try {
            voreltext::Image read = vorelcompose::readPng(std::filesystem::path(*folder) / image);
            (*held)[image] = {read.width, read.height, std::move(read.pixels)};
        } catch (const vorelcompose::ComposeError& error) {
            throw StyleError(vorelstyle::faultPrefix(name) + "pattern.image: " + error.what());
        }
    }
    FoundStyle found{std::move(style), loaderOf(held), {}, true};
    return {std::move(found), std::move(held)};
}

py::dict imagesOf(const NativeStyle& style) {
    py::dict images;
    for (const auto& [name, image] : *style.images) {
        const auto* const bytes = reinterpret_cast<const char*>(image.pixels.data());
        images[py::str(name)] =
            py::make_tuple(image.width, image.height, py::bytes(bytes, image.pixels.size()));
    }
    return images;
}

/// The looks as those of a font size.
LayerSet layersOf(const NativeStyle& style, int size, float effectScale) {
    Request request;
    request.size = size;
    request.effectScale = effectScale;
    return {request, *style.found.style, style.found.load, size, {}, [](const std::string&) {}};
}

py::list looksOf(const NativeStyle& style, int size, float effectScale) {
    const Style resolved = vorelstyle::resolvedStyle(*style.found.style, size, effectScale, {});
    const vorelstyle::Place inPlace;
    py::list looks;
    for (const vorelstyle::Place& place : vorelstyle::placesOf(resolved)) {
        const bool isInPlace = place.offsetX == inPlace.offsetX && place.offsetY == inPlace.offsetY &&
                               place.span == inPlace.span;
        if (!isInPlace) {
            throw StyleError(vorelstyle::faultPrefix(resolved.name) +
                             vorelstyle::lookPath(resolved, looks.size()) +
                             "offset, span: a look alone is not moved, and is of the whole block");
        }
        looks.append(stateOf(resolved, looks.size(), style.found.load));
    }
    return looks;
}

}  // namespace

void defineStyles(py::module_& module) {
    py::class_<NativeStyle, std::shared_ptr<NativeStyle>>(module, "NativeStyle")
        .def(py::init([](const std::string& json, const std::string& name, const py::dict& images,
                         const std::optional<std::string>& folder) {
            return std::make_shared<NativeStyle>(styleOf(json, name, images, folder));
        }))
        .def("description", [](const NativeStyle& self) { return self.found.style->description; })
        .def("images", [](const NativeStyle& self) { return imagesOf(self); })
        .def("looks", looksOf)
        .def("key",
             [](const NativeStyle& self, int size, float effectScale) {
                 return py::bytes(layersOf(self, size, effectScale).stack().key());
             })
        .def("margins", [](const NativeStyle& self, int size, float effectScale) {
            const voreltext::Margins margins = marginsOf(layersOf(self, size, effectScale).layers());
            return py::make_tuple(margins.left, margins.top, margins.right, margins.bottom);
        });
}

}  // namespace vorelpython
