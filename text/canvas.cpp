#include "text/canvas.h"

#include <algorithm>
#include <string>

#include "text/error.h"
#include "text/units.h"

namespace voreltext {
namespace {

/// The thirds of the canvas: 0 for left or top, 1 for the middle, 2 for right or bottom.
int columnOf(Anchor anchor) {
    return static_cast<int>(anchor) % 3;
}
int rowOf(Anchor anchor) {
    return static_cast<int>(anchor) / 3;
}

/// One side of a canvas: its length and the place of the text's origin.
struct Side {
    int length;
    int origin;
};

struct Extent {
    int64_t begin;
    int64_t end;
    int64_t before;  ///< of the effects
    int64_t after;
};

Side sideOf(std::optional<int> asked, const CanvasRequest& request, int third, const Extent& box) {
    const int64_t length = box.end - box.begin;
    const int64_t margin = request.margin;
    const int64_t padding = request.padding;
    if (!asked) {
        const int64_t before = box.before + padding;
        return {notTooFar(before + length + box.after + padding), notTooFar(before - box.begin)};
    }
    const int64_t free = *asked - 2 * margin - length;
    const int64_t shift = third == 0 ? 0 : third == 1 ? floorOf(free, 2) : free;
    return {*asked, notTooFar(margin + shift - box.begin)};
}

std::optional<int> within(std::optional<int> length, int margin) {
    if (!length) return std::nullopt;
    const int64_t room = int64_t{*length} - 2 * int64_t{margin};
    if (room >= 1) return static_cast<int>(room);
    throw TextError("margins of " + std::to_string(margin) + " pixels leave no room in a canvas of " +
                    std::to_string(*length));
}

}  // namespace

int notTooFar(int64_t place) {
    return static_cast<int>(std::clamp<int64_t>(place, -kFarAway, kFarAway));
}

bool Room::holds(const Box& box) const {
    return box.width() <= width.value_or(box.width()) && box.height() <= height.value_or(box.height());
}

Room roomOf(const CanvasRequest& request) {
    return {within(request.width, request.margin), within(request.height, request.margin)};
}

Canvas placedOn(const CanvasRequest& request, const Box& box, const Margins& effects) {
    const Side across = sideOf(request.width, request, columnOf(request.anchor),
                               {box.left, box.right, effects.left, effects.right});
    const Side down = sideOf(request.height, request, rowOf(request.anchor),
                             {box.top, box.bottom, effects.top, effects.bottom});
    checkSize(across.length, down.length);
    return {across.length, down.length, across.origin, down.origin};
}

std::optional<int> largestThatFits(int size, const std::function<bool(int)>& fits) {
    if (fits(size)) return size;
    int largest = 0;
    for (int tooLarge = size; tooLarge - largest > 1;) {
        const int middle = largest + (tooLarge - largest) / 2;
        (fits(middle) ? largest : tooLarge) = middle;
    }
    return largest == 0 ? std::nullopt : std::optional<int>(largest);
}

}  // namespace voreltext
