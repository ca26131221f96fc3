#include "painting.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
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

namespace {

/// The bytes of the file of a picture on its background.
std::vector<uint8_t> fileOf(const Options& options, Image picture) {
    layOn(picture, options.background);
    return encodedPng(picture, options.png);
}

}  // namespace

Composition::Composition(const Options& options, Workbench& bench)
    : mSource(options),
      mText(bench.texts.text(options, bench.fonts, mSource)),
      mLooks(bench.styles.looks(options, mText->size(), mSource.colours(), mNotes.taker())),
      mMargins(marginsOf(mLooks->layers())),
      mCanvas(placedOn(options.canvas, mText->box(), mMargins)) {
    noteMissing(mText->layout(), mSource, mNotes.taker());
    noteCut(mCanvas, mText->layout().inkBox(), mMargins, mNotes.taker());
    if (options.strict) mNotes.refuse();
}

Composition::Composition(const Options& options) : Composition(options, std::make_unique<Workbench>()) {}

Composition::Composition(const Options& options, std::unique_ptr<Workbench> bench)
    : Composition(options, *bench) {}

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

void writePicture(const Options& options, Image picture) {
    writeFile(*options.output, fileOf(options, std::move(picture)));
}

PaintedPicture painted(const Options& options, const Composition& composition) {
    PaintedPicture picture;
    if (options.output) picture.file = fileOf(options, composition.paint());
    if (options.report) picture.report = reportOf(options, composition) + "\n";
    picture.notes = composition.notes();
    return picture;
}

void handOver(const Options& options, const PaintedPicture& picture, const Note& note) {
    if (options.output) writeFile(*options.output, picture.file);
    if (options.report) print(picture.report);
    picture.notes.giveTo(note);
}

}  // namespace vorelpaint
