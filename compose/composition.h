#pragma once

#include <functional>
#include <memory>

#include "compose/layer_set.h"
#include "compose/note.h"
#include "compose/request.h"
#include "compose/set_text.h"
#include "compose/workbench.h"
#include "style/vorelstyle.h"
#include "text/voreltext.h"

namespace vorelcompose {

/// Finds the style of a picture. Throws what is wrong with it.
using FindStyle = std::function<FoundStyle()>;

/// A picture before it is painted: a text in its fonts, its looks, and the canvas on which they meet.
class Composition {
  public:
    /// What it makes may be kept on the workbench, and taken from there. `findStyle` is asked once the
    /// text is set. A strict request's first note is thrown as ComposeError. Throws ComposeError,
    /// StyleError, TextError, and what findStyle throws.
    Composition(const Request& request, SourceText source, const FindStyle& findStyle, Workbench& bench);

    const HeldNotes& notes() const { return mNotes; }
    const SourceText& source() const { return mSource; }
    const SetText& text() const { return *mText; }
    const LayerSet& looks() const { return *mLooks; }
    const voreltext::Margins& margins() const { return mMargins; }
    const voreltext::Canvas& canvas() const { return mCanvas; }

    /// Premultiplied, on a transparent canvas. Throws TextError for one that is too large.
    voreltext::Image paint() const;

  private:
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

}  // namespace vorelcompose
