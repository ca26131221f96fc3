#pragma once

#include "layer_set.h"
#include "note.h"
#include "options.h"
#include "set_text.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

/// The steps from what is asked for to a picture in its file. Each throws ToolError, StyleError or
/// TextError.
namespace vorelpaint {

/// A picture before it is painted: a text in its fonts, its looks, and the canvas on which they meet.
class Composition {
  public:
    /// A strict request's first note is thrown as ToolError.
    explicit Composition(const Options& options);

    const HeldNotes& notes() const { return mNotes; }
    const SourceText& source() const { return mSource; }
    const SetText& text() const { return mText; }
    const LayerSet& looks() const { return mLooks; }
    const voreltext::Margins& margins() const { return mMargins; }
    const voreltext::Canvas& canvas() const { return mCanvas; }

    voreltext::Image paint() const;

  private:
    HeldNotes mNotes;
    SourceText mSource;
    SetText mText;
    LayerSet mLooks;
    voreltext::Margins mMargins;
    voreltext::Canvas mCanvas;
};

/// Notes what of the text and its effects, which are `margins` around the ink, the canvas cuts off.
void noteCut(const voreltext::Canvas& canvas, const voreltext::Box& ink,
             const voreltext::Margins& margins, const Note& note);

/// The picture on its background into its file.
void writePicture(const Options& options, voreltext::Image picture);

/// Writes the picture, where an output is asked for, and prints its report, where one is.
void finish(const Options& options, const Composition& composition);

/// All of these steps, and then the notes.
void paintPicture(const Options& options, const Note& note);

}  // namespace vorelpaint
