#pragma once

#include "text/canvas.h"
#include "text/error.h"
#include "text/font.h"
#include "text/fonts.h"
#include "text/glyph_mask.h"
#include "text/image.h"
#include "text/layer_painter.h"
#include "text/layers.h"
#include "text/overlay.h"
#include "text/run.h"
#include "text/system_fonts.h"
#include "text/text_layout.h"
#include "text/text_settings.h"
#include "text/utf8.h"

/// Text from fonts to pixels: fonts are opened, lines shaped and set, glyphs rasterised, and painted by
/// a set of effects.
///
///     using namespace voreltext;
///     Fonts fonts{Font(FontBytes{data, size}, 96)};        // or FontFile{"font.ttf"}; the main font
///     fonts.add(Font(FontFile{"emoji.ttf"}, 96));          // for what it has not
///     TextSettings settings;
///     settings.align = Align::center;
///     settings.wrapWidth = 800;
///     const TextLayout text(fonts, decodeUtf8("Two\nlines"), settings);
///     VFontEffect::VFEffect effects;
///     effects.addStrokeText(4, 0xFFFFFF, 1, 0, 1);
///     effects.addText(0x3366CC, 1);                        // the fill
///     const Image picture = paint(effects, text, 8);       // premultiplied R, G, B, A
///
/// `paint` is the short way; Frame and Run are its steps. It paints the coverage of every glyph, of
/// those that are pictures too. TextLayout tells of each line and glyph where it stands and what it is
/// of.
///
/// SystemFonts finds the file of an installed family, and for Fonts::setFallback the installed font that
/// has a character. It is a library of its own, voreltext_system, that needs fontconfig; all else does
/// without.
///
/// Nothing is printed, no file is opened but a FontFile, and no state is kept between calls: threads may
/// use the library at once, each with objects of its own. What cannot be done throws TextError; memory
/// that runs out throws std::bad_alloc. Rows lie from top to bottom, boxes are half-open and in pixels.
namespace voreltext {}
