#pragma once

#include "style/colour.h"
#include "style/error.h"
#include "style/json_object.h"
#include "style/key_text.h"
#include "style/length.h"
#include "style/look.h"
#include "style/markup.h"
#include "style/message.h"
#include "style/nearest.h"
#include "style/note.h"
#include "style/pattern_image.h"
#include "style/resolved_style.h"
#include "style/stack.h"
#include "style/style.h"
#include "style/write_cpp.h"

/// Looks as data: style files are read, resolved for a font size, turned into stacks of sets of effects
/// and written out as C++.
///
///     using namespace vorelstyle;
///     const Style style = resolvedStyle(parseStyle(json, "look.json"), fontSizePx, 1, note);
///     Stack stack(style, {}, {}, loadPicture);
///     stack.key();  // for a cache; keyFragments tells what it says
///     for (StackedLook& stacked : stack.looks()) {  // the lowest first
///         stacked.look.effects();  // paints runs, see VFEffect.h
///         stacked.place;           // how far its picture is moved, and what is one run
///     }
///
/// `json` is the text of a style file, "look.json" what messages call it. Lengths of the style may be
/// shares of the font's size: `fontSizePx` makes them pixels, and `note` takes a line for each that is
/// painted otherwise than asked for. `loadPicture` reads the pictures of patterns (LoadImage); where
/// there is none, styles with a pattern are refused.
///
/// docs/style-files.md lists every key of a style file, vorelpaint-style.schema.json says the same to
/// editors, and presets/ has style files to start from.
///
/// Nothing is printed, no file is opened, and no state is kept between
/// calls: threads may use the library at once, each with objects of its own. What is wrong with a style
/// throws StyleError; memory that runs out throws std::bad_alloc. Texts are UTF-8.
namespace vorelstyle {}
