#include "arrays.h"

#include <limits>
#include <string>

namespace vorelpython {
namespace {

using VFontEffect::Glyph;
using VFontEffect::PictureView;
using VFontEffect::PixelOrder;

/// Of a layer that the library paints; see Failure::tooLarge.
constexpr py::ssize_t kMostPixels = 0x7FFFFFFF / 4;
constexpr py::ssize_t kLargestSide = 65535;

std::string spelled(const py::array& array) {
    return "an array of " + std::string(py::str(array.dtype())) + " with the shape " +
           std::string(py::str(array.attr("shape")));
}

py::array arrayLike(const py::object& object, const char* what) {
    try {
        return py::array(object);
    } catch (const py::error_already_set& error) {
        if (!error.matches(PyExc_TypeError) && !error.matches(PyExc_ValueError)) throw;
        throw py::type_error(std::string(what) + ", not " +
                             std::string(py::str(py::type::of(object).attr("__name__"))));
    }
}

void requireBytes(const py::array& array, py::ssize_t dimensions, const char* what) {
    if (!py::isinstance<py::array_t<uint8_t>>(array) || array.ndim() != dimensions ||
        (dimensions == 3 && array.shape(2) != 4)) {
        throw py::type_error(std::string(what) + ", not " + spelled(array));
    }
}

void requireSides(py::ssize_t width, py::ssize_t height, const char* what) {
    if (width <= kLargestSide && height <= kLargestSide && width * height <= kMostPixels) return;
    throw py::value_error(std::string(what) + " of " + std::to_string(width) + " x " +
                          std::to_string(height) +
                          " pixels: it has at most 65535 on a side and 536870911 in all");
}

/// Whether the library can read the rows where they lie: pixels packed, and each row behind the last.
bool hasRows(const py::array& array, py::ssize_t pixelBytes) {
    const py::ssize_t height = array.shape(0);
    const py::ssize_t width = array.shape(1);
    const bool isPacked = width <= 1 || array.strides(1) == pixelBytes;
    return isPacked && (height <= 1 || array.strides(0) >= width * pixelBytes) &&
           (array.ndim() == 2 || array.strides(2) == 1);
}

std::ptrdiff_t strideOf(const py::array& array) {
    return array.shape(0) <= 1 ? 0 : array.strides(0);
}

py::array packed(const py::array& array) {
    return py::array_t<uint8_t, py::array::c_style | py::array::forcecast>(array);
}

}  // namespace

int integer(const py::handle& value, const char* name) {
    const py::object whole = py::reinterpret_steal<py::object>(PyNumber_Index(value.ptr()));
    if (!whole) throw py::error_already_set();
    int overflow = 0;
    const long long number = PyLong_AsLongLongAndOverflow(whole.ptr(), &overflow);
    if (overflow != 0 || number < std::numeric_limits<int>::min() ||
        number > std::numeric_limits<int>::max()) {
        throw py::value_error(std::string(name) + ": beyond 32 bits");
    }
    return static_cast<int>(number);
}

Placements::Placements(const py::sequence& placements) {
    constexpr const char* kMask = "a mask is a (height, width) array of uint8";
    for (const py::handle& each : placements) {
        if (!py::isinstance<py::tuple>(each) || py::len(each) != 3)
            throw py::type_error("masks are one array, or a list of (x, y, mask)");
        const auto placement = py::reinterpret_borrow<py::tuple>(each);
        py::array mask = arrayLike(placement[2], kMask);
        requireBytes(mask, 2, kMask);
        const Glyph at{integer(placement[0], "x"), integer(placement[1], "y")};
        if (mask.size() == 0) continue;
        requireSides(mask.shape(1), mask.shape(0), "a mask");
        if (!hasRows(mask, 1)) mask = packed(mask);
        mGlyphs.push_back({at.x, at.y, static_cast<const unsigned char*>(mask.data()),
                           static_cast<int>(mask.shape(1)), static_cast<int>(mask.shape(0)),
                           strideOf(mask)});
        mMasks.push_back(std::move(mask));
    }
}

PictureView viewOf(const py::array& array, bool isBgra) {
    requireBytes(array, 3, "a picture is painted onto a (height, width, 4) array of uint8");
    if (!array.writeable()) throw py::value_error("the array that is painted onto is read-only");
    if (array.shape(0) > std::numeric_limits<int>::max() ||
        array.shape(1) > std::numeric_limits<int>::max())
        throw py::value_error("the array that is painted onto has a side of 2^31 pixels or more");
    if (array.size() != 0 && !hasRows(array, 4)) {
        throw py::value_error(
            "the pixels of the array that is painted onto must be packed within its "
            "rows, and the rows stand from the top to the bottom");
    }
    PictureView view;
    view.data = static_cast<unsigned char*>(const_cast<void*>(array.data()));
    view.width = static_cast<int>(array.shape(1));
    view.height = static_cast<int>(array.shape(0));
    view.stride = array.size() == 0 ? 0 : strideOf(array);
    view.order = isBgra ? PixelOrder::bgra : PixelOrder::rgba;
    return view;
}

Pixels pixelsOf(const py::object& object) {
    constexpr const char* kPattern = "the pixels of a pattern are a (height, width, 4) array of uint8";
    const py::array array = arrayLike(object, kPattern);
    requireBytes(array, 3, kPattern);
    if (array.size() == 0) throw py::value_error("a pattern without pixels");
    requireSides(array.shape(1), array.shape(0), "a pattern");
    const py::array rows = packed(array);
    const auto* const bytes = static_cast<const uint8_t*>(rows.data());
    return {static_cast<int>(array.shape(1)), static_cast<int>(array.shape(0)),
            std::vector<uint8_t>(bytes, bytes + rows.size())};
}

}  // namespace vorelpython
