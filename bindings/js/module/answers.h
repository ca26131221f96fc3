#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "compose/vorelcompose.h"

namespace vorelscript {

/// A JSON text, and bytes of which it tells the places.
struct Answer {
    std::string json;
    std::vector<uint8_t> bytes;
};

/// What is known of a picture. In pixels of the picture are
///
///     x, y          of the text's origin, where its first baseline begins
///     baseline      the y of that baseline
///     ink, box      around the glyphs, and of the kind that was asked for: [left, top, right, bottom]
///
/// and beside it "width", "height", "premultiplied"; "size", of the font; "margins", of the effects
/// around the ink: [left, top, right, bottom]; "key", in hexadecimal; "fonts" that have a glyph;
/// "missing", the characters that none has; "notes" of what is odd. Straight on a background, unless it
/// stays premultiplied.
Answer pictureAnswer(const vorelcompose::Composition& composition, bool isPremultiplied,
                     const vorelcompose::Background& background);

/// What is known of a text that is set, in pixels from its origin: "glyphs", each with "x" and "y" of
/// its coverage, "width", "height" and "at", where its packed rows begin among the bytes, and the
/// positions "line", "word" and "cluster" that voreltext::Glyph has; "lines", each with "baseline" and
/// "box"; and, as of a picture, "ink", "box", "size", "fonts", "missing" and "notes".
Answer layoutAnswer(const vorelcompose::Composition& composition);

/// How looks are painted: "margins"; "looks", the lowest first, each with "layered" and the "reason" for
/// it, "place" with "placeReason", and "order", the topmost effect first, of "effect", "place" and
/// "reason"; "key", the fragments of the key of "name" and "meaning"; and "keyBytes", in hexadecimal.
Answer planAnswer(const vorelcompose::LayerSet& looks);

/// "width" and "height" of a picture, whose pixels are the bytes.
Answer imageAnswer(voreltext::Image image);

}  // namespace vorelscript
