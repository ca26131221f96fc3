#include "compose/composition.h"

#include <array>
#include <string>
#include <utility>

namespace vorelcompose {

using voreltext::Box;
using voreltext::Canvas;
using voreltext::Image;
using voreltext::Margins;

Composition::Composition(const Request& request, SourceText source, const FindStyle& findStyle,
                         Workbench& bench)
    : mSource(std::move(source)),
      mText(bench.texts.text(request, bench.fonts, mSource)),
      mLooks(bench.looks.looks(request, findStyle(), mText->size(), mSource.colours(), mNotes.taker())),
      mMargins(marginsOf(mLooks->layers())),
      mCanvas(placedOn(request.canvas, mText->box(), mMargins)) {
    noteMissing(mText->layout(), mSource, mNotes.taker());
    noteCut(mCanvas, mText->layout().inkBox(), mMargins, mNotes.taker());
    if (request.strict) mNotes.refuse();
}

Image Composition::paint() const {
    return voreltext::paint(mLooks->layers(), mText->layout(), mCanvas);
}

void noteCut(const Canvas& canvas, const Box& ink, const Margins& margins, const Note& note) {
    struct Side {
        const char* name;
        int beyond;
    };
    const std::array<Side, 4> sides{
        {{"on the left", -(canvas.x + ink.left - margins.left)},
         {"at the top", -(canvas.y + ink.top - margins.top)},
         {"on the right", canvas.x + ink.right + margins.right - canvas.width},
         {"at the bottom", canvas.y + ink.bottom + margins.bottom - canvas.height}}};
    std::string places;
    for (const Side& side : sides) {
        if (side.beyond <= 0) continue;
        places += (places.empty() ? "" : ", ") + std::to_string(side.beyond) + " " + side.name;
    }
    if (!places.empty()) note("the picture cuts pixels of the text or its effects off: " + places);
}

}  // namespace vorelcompose
