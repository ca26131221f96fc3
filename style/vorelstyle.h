#pragma once

#include "style/colour.h"
#include "style/error.h"
#include "style/json_object.h"
#include "style/key_text.h"
#include "style/look.h"
#include "style/markup.h"
#include "style/message.h"
#include "style/nearest.h"
#include "style/pattern_image.h"
#include "style/presets.h"
#include "style/style.h"
#include "style/style_scale.h"
#include "style/write_cpp.h"

/// Looks as data: style files are read, scaled, turned into sets of effects and written out as C++.
///
///     using namespace vorelstyle;
///     const Style style = scaledStyle(parseStyle(json, "look.json"), 0.5F);
///     Look look(style, fillOf(style), opacityOf(style), loadPicture);
///     look.effects();  // paints runs, see VFEffect.h
///     look.key();      // for a cache; keyFragments tells what it says
///
/// `json` is the text of a style file, "look.json" what messages call it, and `loadPicture` reads the
/// pictures of patterns (LoadImage); where there is none, styles with a pattern are refused.
///
/// docs/style-files.md lists every key of a style file, vorelpaint-style.schema.json says the same to
/// editors, and presets/ has style files to start from.
///
/// Nothing is printed, no file is opened but the directory of presetNames, and no state is kept between
/// calls: threads may use the library at once, each with objects of its own. What is wrong with a style
/// throws StyleError; memory that runs out throws std::bad_alloc. Texts are UTF-8.
namespace vorelstyle {}
