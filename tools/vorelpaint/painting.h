#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "compose/vorelcompose.h"
#include "options.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"
#include "workbench.h"

/// The steps from what is asked for to a picture in its file. Each throws ToolError, ComposeError,
/// StyleError or TextError.
namespace vorelpaint {

/// The text that is asked for. Throws ComposeError, TextError or StyleError.
SourceText sourceOf(const Options& options);

/// The picture that is asked for, before it is painted.
Composition composed(const Options& options, Workbench& bench);

/// On a workbench of its own.
Composition composed(const Options& options);

/// The picture on its background into its file.
void writePicture(const Options& options, voreltext::Image picture);

/// A picture that is done but for being handed over.
struct PaintedPicture {
    std::vector<uint8_t> file;  ///< the bytes of the output, where one is asked for
    std::string report;         ///< a line, where one is asked for
    HeldNotes notes;
};

PaintedPicture painted(const Options& options, const Composition& composition);

/// Writes the output, prints the report, and gives the notes.
void handOver(const Options& options, const PaintedPicture& picture, const Note& note);

}  // namespace vorelpaint
