#pragma once

#include <pybind11/numpy.h>
#include <pybind11/pybind11.h>
#include <voreleffect/look.h>

#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

/// Arrays of numpy as the library's views, and its pictures as arrays. All of it needs the GIL.
namespace vorelpython {

namespace py = pybind11;

/// Glyphs whose coverage lies in arrays, which it keeps alive.
class Placements {
  public:
    /// Of (x, y, mask), each mask a (height, width) array of uint8. What has packed pixels in its rows
    /// is not copied. Throws TypeError or ValueError.
    explicit Placements(const py::sequence& placements);

    VFontEffect::Glyphs glyphs() const { return mGlyphs; }

  private:
    std::vector<py::array> mMasks;
    std::vector<VFontEffect::Glyph> mGlyphs;
};

/// A writable (height, width, 4) array of uint8 whose pixels are packed within their rows. Throws
/// TypeError or ValueError.
VFontEffect::PictureView viewOf(const py::array& array, bool isBgra);

/// The same of straight pixels that are read: bytes in packed rows, top row first.
struct Pixels {
    int width = 0;
    int height = 0;
    std::vector<uint8_t> rgba;
};
Pixels pixelsOf(const py::object& object);

/// A (height, width, 4) array that owns what it is made of; nothing is copied. `owner` lives as long as
/// the array or anything that is made of it.
template <typename Owner>
py::array arrayOf(Owner owner, int width, int height, uint8_t* (*dataOf)(Owner&)) {
    auto kept = std::make_unique<Owner>(std::move(owner));
    const py::capsule capsule(kept.get(), [](void* pointer) { delete static_cast<Owner*>(pointer); });
    Owner& held = *kept.release();
    const py::array::ShapeContainer shape{py::ssize_t{height}, py::ssize_t{width}, py::ssize_t{4}};
    return py::array(py::dtype::of<uint8_t>(), shape, dataOf(held), capsule);
}

/// A whole number within 32 bits. Throws TypeError, or ValueError which names it.
int integer(const py::handle& value, const char* name);

}  // namespace vorelpython
