#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "layer_set.h"
#include "note.h"
#include "options.h"
#include "set_text.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"
#include "workbench.h"

/// The steps from what is asked for to a picture in its file. Each throws ToolError, StyleError or
/// TextError.
namespace vorelpaint {

/// A picture before it is painted: a text in its fonts, its looks, and the canvas on which they meet.
class Composition {
  public:
    /// What it makes may be kept on the workbench, and taken from there. A strict request's first note
    /// is thrown as ToolError.
    Composition(const Options& options, Workbench& bench);

    /// On a workbench of its own.
    explicit Composition(const Options& options);

    const HeldNotes& notes() const { return mNotes; }
    const SourceText& source() const { return mSource; }
    const SetText& text() const { return *mText; }
    const LayerSet& looks() const { return *mLooks; }
    const voreltext::Margins& margins() const { return mMargins; }
    const voreltext::Canvas& canvas() const { return mCanvas; }

    voreltext::Image paint() const;

  private:
    Composition(const Options& options, std::unique_ptr<Workbench> bench);

    HeldNotes mNotes;
    SourceText mSource;
    std::shared_ptr<const SetText> mText;
    std::shared_ptr<const LayerSet> mLooks;
    voreltext::Margins mMargins;
    voreltext::Canvas mCanvas;
};

/// Notes what of the text and its effects, which are `margins` around the ink, the canvas cuts off.
void noteCut(const voreltext::Canvas& canvas, const voreltext::Box& ink,
             const voreltext::Margins& margins, const Note& note);

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
