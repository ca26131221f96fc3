#include "painting.h"

#include <string>
#include <utility>

#include "console.h"
#include "file_io.h"
#include "png_writer.h"
#include "ranges.h"
#include "report.h"
#include "style_file.h"

namespace vorelpaint {

using voreltext::Image;

namespace {

std::string bytesOfText(const Options& options) {
    if (options.text) return *options.text;
    std::string text = readFileOrInput(options.textFile.value(), kMaxTextBytes);
    if (!text.empty() && text.back() == '\n') text.pop_back();
    return text;
}

/// The bytes of the file of a picture on its background.
std::vector<uint8_t> fileOf(const Options& options, Image picture) {
    layOn(picture, options.background);
    return encodedPng(picture, options.png);
}

}  // namespace

SourceText sourceOf(const Options& options) {
    return {bytesOfText(options), options.markup};
}

Composition composed(const Options& options, Workbench& bench) {
    return {options, sourceOf(options), [&] { return chosenStyle(options, bench.styles); }, bench};
}

Composition composed(const Options& options) {
    Workbench bench;
    return composed(options, bench);
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
