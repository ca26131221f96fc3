#pragma once

#include "compose/background.h"
#include "compose/composition.h"
#include "compose/error.h"
#include "compose/file_mark.h"
#include "compose/font_source.h"
#include "compose/layer_set.h"
#include "compose/limits.h"
#include "compose/note.h"
#include "compose/painting_steps.h"
#include "compose/plan.h"
#include "compose/request.h"
#include "compose/set_text.h"
#include "compose/shelf.h"
#include "compose/step_pictures.h"
#include "compose/stepped_run.h"
#include "compose/workbench.h"

/// From what is asked of one picture to the picture: a text in its fonts, the looks of a style, and the
/// canvas on which they meet.
///
///     using namespace vorelcompose;
///     SystemFontSource fonts;                         // or a FontSource of bytes
///     Workbench bench(fonts);                         // of one thread, for many pictures
///     Request request;
///     request.size = 48;
///     const Composition picture(request, SourceText("Hello", false), findStyle, bench);
///     picture.notes();                                // what is odd about it
///     Image image = picture.paint();                  // premultiplied R, G, B, A
///     layOn(image, Background{});                     // straight, as a PNG file has it
///
/// This part opens no file and knows no fontconfig, no console and no PNG: its fonts come from a
/// FontSource, its styles from a FindStyle. compose/system has those of files and of installed fonts,
/// and is a library of its own, vorelcompose_system.
namespace vorelcompose {}
