#include "painting.h"

#include <algorithm>
#include <array>
#include <string>
#include <utility>

#include "background.h"
#include "console.h"
#include "error.h"
#include "file_io.h"
#include "png_writer.h"
#include "report.h"

namespace vorelpaint {

using voreltext::Box;
using voreltext::Canvas;
using voreltext::Image;
using voreltext::Margins;

Composition::Composition(const Options& options)
    : mSource(options),
      mText(setToFit(options, mSource)),
      mLooks(options, chosenStyle(options), mText.size(), mSource.colours(), mNotes.taker()),
      mMargins(marginsOf(mLooks.layers())),
      mCanvas(placedOn(options.canvas, mText.box(), mMargins)) {
    noteMissing(mText.layout(), mSource, mNotes.taker());
    noteCut(mCanvas, mText.layout().inkBox(), mMargins, mNotes.taker());
    if (options.strict) mNotes.refuse();
}

Image Composition::paint() const {
    return voreltext::paint(mLooks.layers(), mText.layout(), mCanvas);
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

void writePicture(const Options& options, Image picture) {
    layOn(picture, options.background);
    writeFile(options.output.value(), [&](std::FILE* file) { writePng(file, picture, options.png); });
}

void finish(const Options& options, const Composition& composition) {
    if (options.output) writePicture(options, composition.paint());
    if (options.report) print(reportOf(options, composition) + "\n");
}

void paintPicture(const Options& options, const Note& note) {
    const Composition composition(options);
    finish(options, composition);
    composition.notes().giveTo(note);
}

}  // namespace vorelpaint
