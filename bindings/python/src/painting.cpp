#include "painting.h"

#include <pybind11/stl.h>
#include <unistd.h>

#include <memory>
#include <mutex>
#include <new>
#include <optional>
#include <vector>

#include "arrays.h"
#include "native_look.h"
#include "without_gil.h"

namespace vorelpython {
namespace {

using VFontEffect::Box;
using VFontEffect::Failure;
using VFontEffect::Glyphs;
using VFontEffect::Margins;
using VFontEffect::Painter;
using VFontEffect::Picture;
using VFontEffect::PictureView;

[[noreturn]] void raise(Failure why) {
    if (why == Failure::noMemory) throw std::bad_alloc();
    throw py::value_error(
        "the masks and their effects are too large: a layer has less than 2^31 bytes, "
        "and the left and top of a picture fit into 32 bits");
}

/// A painter that threads take turns with. Nothing is painted while the GIL is held.
class SharedPainter {
  public:
    explicit SharedPainter(const std::vector<std::shared_ptr<NativeLook>>& looks)
        : mLooks(looksOf(looks)) {}
    ~SharedPainter() {
        if (mProcess != ::getpid()) leaveTurns();
    }
    SharedPainter(const SharedPainter&) = delete;
    SharedPainter& operator=(const SharedPainter&) = delete;

    py::tuple margins() const {
        const Margins margins = mTurns->painter.margins();
        return py::make_tuple(margins.left, margins.top, margins.right, margins.bottom);
    }

    /// The picture, the columns and the rows of its left and top from the origin of the text.
    py::tuple paint(const py::sequence& masks) {
        const Placements placements(masks);
        std::optional<Picture> picture = painted(placements.glyphs());
        if (picture->isEmpty()) return py::make_tuple(emptyArray(), 0, 0);
        const int left = picture->left();
        const int top = picture->top();
        const int width = picture->width();
        const int height = picture->height();
        return py::make_tuple(arrayOf<Picture>(std::move(*picture), width, height,
                                               [](Picture& owner) -> uint8_t* { return owner.data(); }),
                              left, top);
    }

    py::tuple paintOnto(const py::sequence& masks, const py::array& onto, const py::object& x,
                        const py::object& y, bool isBgra) {
        const Placements placements(masks);
        const int column = integer(x, "x");
        const int row = integer(y, "y");
        const Box box = *paintedOn(placements.glyphs(), viewOf(onto, isBgra), column, row);
        return py::make_tuple(box.left, box.top, box.right, box.bottom);
    }

  private:
    struct Turns {
        explicit Turns(const std::vector<VFontEffect::Look>& looks) : painter(looks) {}

        std::mutex mutex;
        Painter painter;
    };

    static std::vector<VFontEffect::Look> looksOf(
        const std::vector<std::shared_ptr<NativeLook>>& natives) {
        std::vector<VFontEffect::Look> looks;
        looks.reserve(natives.size());
        for (const std::shared_ptr<NativeLook>& native : natives)
            looks.push_back(native->look);
        return looks;
    }
    static py::array emptyArray() { return py::array_t<uint8_t>(std::vector<py::ssize_t>{0, 0, 4}); }
    std::optional<Picture> painted(Glyphs glyphs) {
        Turns& turns = turnsOfProcess();
        const WithoutGil released;
        const std::lock_guard<std::mutex> alone(turns.mutex);
        std::optional<Picture> picture = turns.painter.paint(glyphs);
        if (!picture) raise(turns.painter.failure());
        return picture;
    }
    std::optional<Box> paintedOn(Glyphs glyphs, const PictureView& view, int x, int y) {
        Turns& turns = turnsOfProcess();
        const WithoutGil released;
        const std::lock_guard<std::mutex> alone(turns.mutex);
        const std::optional<Box> box = turns.painter.paint(glyphs, view, x, y);
        if (!box) raise(turns.painter.failure());
        return box;
    }

    /// Those of this process. A child that was forked has its own: those of its parent may have been in
    /// the hands of a thread that it has not, and stay as they are.
    Turns& turnsOfProcess() {
        if (mProcess != ::getpid()) {
            leaveTurns();
            mTurns = std::make_unique<Turns>(mLooks);
            mProcess = ::getpid();
        }
        return *mTurns;
    }
    void leaveTurns() { static_cast<void>(mTurns.release()); }

    std::vector<VFontEffect::Look> mLooks;
    pid_t mProcess = ::getpid();
    std::unique_ptr<Turns> mTurns{std::make_unique<Turns>(mLooks)};
};

}  // namespace

void definePainting(py::module_& module) {
    py::class_<SharedPainter>(module, "NativePainter")
        .def(py::init<const std::vector<std::shared_ptr<NativeLook>>&>())
        .def("margins", &SharedPainter::margins)
        .def("paint", &SharedPainter::paint)
        .def("paint_onto", &SharedPainter::paintOnto);
    module.def("pattern_pixels", [](const py::object& object) {
        const Pixels pixels = pixelsOf(object);
        return py::make_tuple(
            pixels.width, pixels.height,
            py::bytes(reinterpret_cast<const char*>(pixels.rgba.data()), pixels.rgba.size()));
    });
}

}  // namespace vorelpython
