#pragma once

#include <stddef.h>
#include <stdint.h>

#include "VFExport.h"
#include "VFVersion.h"

#ifdef __cplusplus
extern "C" {
#endif

/// @file
/// The words of look.h in C99, for C and for all languages that call C: looks, painted with one call.
///
///     vorel_look* look = NULL;
///     vorel_look_new(&look);
///     vorel_look_fill(look, 0x3366CC, 1);
///     vorel_look_outer_shadow(look, 135, 6, 8, 0x000000, 0.6F);
///     vorel_look_stroke(look, 4, 0xFFFFFF, 1, VOREL_OUTSIDE);
///     vorel_paint(&look, 1, glyphs, count, &page, 40, 80, NULL);
///     vorel_look_free(look);
///
/// Conventions:
///  - What can fail returns a vorel_status. When it is not VOREL_OK the call has changed nothing, but a
///    handle that it was to make is null, and vorel_look_key may have told a length.
///  - No pointer may be null but those that are said to be, and lists of no entries; nor may a handle.
///    VOREL_BAD_ARGUMENT tells of one.
///  - Numbers out of range, and what is no number, become what look.h makes of them: the nearest in
///    range, 0 for no number. Constants that there are not are refused: VOREL_BAD_ARGUMENT.
///  - Input is const and stays the caller's; glyphs, views and pixels are looked at only during the call
///    that they are handed to.
///  - No exception leaves a call, and memory that runs out ends no process: VOREL_NO_MEMORY.
///  - A handle is made by a function whose name ends in new, copy or picture, and is the caller's to
///    free. Painters have copies of their looks.
///  - A handle belongs to one thread at a time, but several may read a look or a picture: hand it to
///    parameters that are const, and lists of looks. Different handles are independent.
///  - Colours are 0xRRGGBB; what lies above is ignored. Opacities are 0 to 1.
///
/// The layout of the structures is frozen: docs/versioning.md tells what may change when.

/// What became of a call: VOREL_OK or one of the reasons beside it.
typedef int32_t vorel_status;

enum {
    VOREL_OK = 0,            ///< done
    VOREL_BAD_ARGUMENT = 1,  ///< null, no constant, no pixels, a negative size, too short a stride, rows
                             ///< farther apart than pointers span
    VOREL_TOO_LARGE = 2,     ///< a glyph beyond 65535 pixels on a side, a layer or a pattern of 2^31
                             ///< bytes and more, a picture whose left or top is below -2^31, a key
                             ///< beyond its buffer
    VOREL_NO_MEMORY = 3      ///< memory ran out
};

/// Where a stroke lies on the edge of the glyphs.
enum { VOREL_CENTRE = 0, VOREL_OUTSIDE = 1, VOREL_INSIDE = 2 };

/// How the four bytes of a premultiplied pixel stand in memory.
enum { VOREL_RGBA = 0, VOREL_BGRA = 1 };

/// What text looks like: a fill and effects.
typedef struct vorel_look vorel_look;
/// Paints in a look, or in a stack of looks, again and again.
typedef struct vorel_painter vorel_painter;
/// A picture that owns its pixels: premultiplied R, G, B, A in packed rows.
typedef struct vorel_picture vorel_picture;

/// One colour of a ramp.
typedef struct vorel_stop {
    uint32_t color;  ///< 0xRRGGBB
    float opacity;   ///< 0 to 1
    float place;     ///< 0 to 1, ascending from stop to stop
} vorel_stop;

/// Pixels that an effect needs around the glyphs.
typedef struct vorel_margins {
    int32_t left;    ///< 0 or more
    int32_t top;     ///< 0 or more
    int32_t right;   ///< 0 or more
    int32_t bottom;  ///< 0 or more
} vorel_margins;

/// Half-open, in whole pixels; empty when all numbers are 0.
typedef struct vorel_box {
    int32_t left;    ///< first column
    int32_t top;     ///< first row
    int32_t right;   ///< one past the last column
    int32_t bottom;  ///< one past the last row
} vorel_box;

/// The coverage of one glyph, or of a whole line, and where it stands. One of no width or no height is
/// skipped, with or without coverage.
typedef struct vorel_glyph {
    int32_t x;                ///< left edge, from the origin of the text
    int32_t y;                ///< top edge
    const uint8_t* coverage;  ///< 0 to 255, top row first
    int32_t width;            ///< 0 to 65535
    int32_t height;           ///< 0 to 65535
    ptrdiff_t stride;         ///< bytes from row to row, at least the width; 0 for packed rows
} vorel_glyph;

/// A picture to paint on: premultiplied pixels of 4 bytes. One of no width or no height can be painted
/// on, to no effect.
typedef struct vorel_view {
    uint8_t* data;     ///< top row first
    int32_t width;     ///< pixels of a row
    int32_t height;    ///< rows
    ptrdiff_t stride;  ///< bytes from row to row, at least 4 * width; 0 for packed rows
    int32_t order;     ///< of its bytes: VOREL_RGBA or VOREL_BGRA
} vorel_view;

/// The pixels of a pattern: R, G, B, A, straight, that is not premultiplied.
typedef struct vorel_pixels {
    const uint8_t* data;  ///< top row first
    int32_t width;        ///< pixels of a row, 1 or more
    int32_t height;       ///< rows, 1 or more
    ptrdiff_t stride;     ///< bytes from row to row, at least 4 * width; 0 for packed rows
} vorel_pixels;

/// The version of the library that runs as a text, "0.9.0": that of the headers is VOREL_VERSION_STRING.
VF_API const char* vorel_version(void);
/// The same as one number, in the order of versions: that of the headers is VOREL_VERSION.
VF_API int32_t vorel_version_number(void);

/// A few English words, never null; of a number that is no status, too.
VF_API const char* vorel_status_text(vorel_status status);

/// Makes a look with a black fill and no effects.
VF_API vorel_status vorel_look_new(vorel_look** look);
/// Makes an independent copy.
VF_API vorel_status vorel_look_copy(const vorel_look* look, vorel_look** copy);
/// Frees it; null may be freed.
VF_API void vorel_look_free(vorel_look* look);

/// Fills the glyphs. Through a fill whose own opacity is below 1 what lies beneath the text is seen.
VF_API vorel_status vorel_look_fill(vorel_look* look, uint32_t color, float opacity);
/// Leaves out the fill. What lies beneath the text is cut out of the glyphs; what lies inside them is
/// painted.
VF_API vorel_status vorel_look_no_fill(vorel_look* look);
/// The opacity of the text, which the fill's is multiplied with. Below 1 what lies beneath the text is
/// cut out of the glyphs, and so is not seen through them. It may be told before or after the fill.
VF_API vorel_status vorel_look_text_opacity(vorel_look* look, float opacity);

/// Adds a shadow behind the glyphs. As with every effect, one of its kind that is there already is
/// replaced, at its place in the order.
///
/// The light comes from `angle` degrees: 0 the right, 90 above. The shadow is moved away from it by
/// `distance`, 0 to 100 pixels, and blurred with the radius `size`, 0 to 100 pixels.
VF_API vorel_status vorel_look_outer_shadow(vorel_look* look, float angle, float distance, float size,
                                            uint32_t color, float opacity);
/// Adds a shadow that falls into the glyphs, by the numbers of an outer one.
VF_API vorel_status vorel_look_inner_shadow(vorel_look* look, float angle, float distance, float size,
                                            uint32_t color, float opacity);
/// Adds a halo around the glyphs, 0 to 100 pixels wide. With `stops` it has their colours, from the edge
/// of the glyphs outwards, instead of the one; of more than 256 the first 256.
VF_API vorel_status vorel_look_outer_glow(vorel_look* look, float size, uint32_t color, float opacity,
                                          const vorel_stop* stops, size_t count);
/// Adds a glow from the edges of the glyphs inwards, by the numbers of an outer one.
VF_API vorel_status vorel_look_inner_glow(vorel_look* look, float size, uint32_t color, float opacity,
                                          const vorel_stop* stops, size_t count);
/// Adds a ramp across the box of the glyphs. `angle` in degrees: 0 runs to the right, 90 upwards;
/// `scale` is the length of the ramp in lengths of the box, 0.1 to 2, less paints nothing. Of more than
/// 256 stops the first 256 count; none paint nothing.
VF_API vorel_status vorel_look_linear_gradient(vorel_look* look, float angle, float scale, float opacity,
                                               const vorel_stop* stops, size_t count);
/// Adds a ramp from the centre of the box of the glyphs; its length is in half widths of the box.
VF_API vorel_status vorel_look_radial_gradient(vorel_look* look, float scale, float opacity,
                                               const vorel_stop* stops, size_t count);
/// Adds an outline, 0 to 100 pixels wide, at the position VOREL_CENTRE, VOREL_OUTSIDE or VOREL_INSIDE.
VF_API vorel_status vorel_look_stroke(vorel_look* look, float size, uint32_t color, float opacity,
                                      int32_t position);
/// Adds a picture tiled over the glyphs from the top left corner of their box; its pixels are copied.
/// `scale` is the pixels that are painted for one of the picture's, 0.1 to 10; less paints nothing.
VF_API vorel_status vorel_look_pattern(vorel_look* look, const vorel_pixels* pixels, float scale,
                                       float opacity);

/// How far the look paints beyond the glyphs; nothing is cut off.
VF_API vorel_status vorel_look_margins(const vorel_look* look, vorel_margins* margins);
/// The look as bytes, none of them zero, for a cache: Look::key() of look.h. No zero is set behind them.
///
/// `length` becomes the number of bytes, also when VOREL_TOO_LARGE says that it is more than `capacity`;
/// the buffer is then as it was. With a null buffer and the capacity 0 the length alone is asked for.
VF_API vorel_status vorel_look_key(const vorel_look* look, char* buffer, size_t capacity,
                                   size_t* length);
/// `equal` becomes 1 when the keys of both are the same, else 0.
VF_API vorel_status vorel_look_equal(const vorel_look* a, const vorel_look* b, int32_t* equal);

/// Makes a painter of a stack of looks, the last on top; of none it paints nothing. The looks are
/// read, not changed.
VF_API vorel_status vorel_painter_new(vorel_look* const* looks, size_t count, vorel_painter** painter);
/// Frees it; null may be freed.
VF_API void vorel_painter_free(vorel_painter* painter);
/// How far the looks paint beyond the glyphs, all of them together.
VF_API vorel_status vorel_painter_margins(const vorel_painter* painter, vorel_margins* margins);
/// Lays the painted glyphs over the view, clipped, so that the origin of the text stands at (x, y): each
/// channel becomes over + under * (255 - alpha) / 255, rounded to nearest, at most 255.
///
/// `touched`, which may be null, becomes the box that holds all that was touched, an empty one where
/// there was nothing to paint within the view. An effect that memory runs out for while it paints is
/// missing, the others are there.
VF_API vorel_status vorel_painter_paint(vorel_painter* painter, const vorel_glyph* glyphs, size_t count,
                                        const vorel_view* view, int32_t x, int32_t y,
                                        vorel_box* touched);
/// Paints a picture of its own, just large enough for the box of the glyphs and the margins. It is
/// empty, without pixels, when there is nothing to paint.
VF_API vorel_status vorel_painter_picture(vorel_painter* painter, const vorel_glyph* glyphs,
                                          size_t count, vorel_picture** picture);

/// Paints once what a painter of the looks would.
VF_API vorel_status vorel_paint(vorel_look* const* looks, size_t lookCount, const vorel_glyph* glyphs,
                                size_t count, const vorel_view* view, int32_t x, int32_t y,
                                vorel_box* touched);

/// Frees it; null may be freed.
VF_API void vorel_picture_free(vorel_picture* picture);
/// Pixels of a row; 0 of null.
VF_API int32_t vorel_picture_width(const vorel_picture* picture);
/// Rows; 0 of null.
VF_API int32_t vorel_picture_height(const vorel_picture* picture);
/// Bytes from row to row, 4 * width; 0 of null.
VF_API int32_t vorel_picture_stride(const vorel_picture* picture);
/// Its left column, from the origin of the text; 0 of null.
VF_API int32_t vorel_picture_left(const vorel_picture* picture);
/// Its top row, from the origin of the text; 0 of null.
VF_API int32_t vorel_picture_top(const vorel_picture* picture);
/// Its pixels, as long as it lives; null of null and of an empty one.
VF_API const uint8_t* vorel_picture_data(const vorel_picture* picture);
/// `view` becomes one of the picture's own pixels, to paint on, as long as it lives.
VF_API vorel_status vorel_picture_view(vorel_picture* picture, vorel_view* view);
/// Lays it over the view, clipped, as a painter does. `touched` may be null. The view must not show the
/// picture's own pixels: they would be changed while they are read.
VF_API vorel_status vorel_picture_lay_over(const vorel_picture* picture, const vorel_view* view,
                                           int32_t x, int32_t y, vorel_box* touched);

#ifdef __cplusplus
}
#endif
