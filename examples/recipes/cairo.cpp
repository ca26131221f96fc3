// A line of text on a Cairo surface, and the draw function of a GTK widget that shows it.
#include <cairo.h>

#include <cmath>
#include <memory>

#include "../shared/shaped_text.h"
#include "recipe.h"

using namespace VFontEffect;

namespace {

using Surface = std::unique_ptr<cairo_surface_t, decltype(&cairo_surface_destroy)>;
using Context = std::unique_ptr<cairo_t, decltype(&cairo_destroy)>;

Surface surfaceOf(cairo_format_t format, int width, int height) {
    return {cairo_image_surface_create(format, width, height), cairo_surface_destroy};
}

/// The coverage of a line and where it stands; the surface keeps the coverage. Pango draws into such a
/// surface, too: pango_cairo_show_layout.
Surface maskOf(const char* text, double pixels, Glyph& glyph) {
    const Surface any = surfaceOf(CAIRO_FORMAT_A8, 1, 1);
    const Context measuring(cairo_create(any.get()), cairo_destroy);
    cairo_select_font_face(measuring.get(), "DejaVu Sans", CAIRO_FONT_SLANT_NORMAL,
                           CAIRO_FONT_WEIGHT_BOLD);
    cairo_set_font_size(measuring.get(), pixels);
    cairo_text_extents_t extents;
    cairo_text_extents(measuring.get(), text, &extents);
    glyph.x = static_cast<int>(std::floor(extents.x_bearing)) - 1;
    glyph.y = static_cast<int>(std::floor(extents.y_bearing)) - 1;

    Surface mask = surfaceOf(CAIRO_FORMAT_A8, static_cast<int>(std::ceil(extents.width)) + 3,
                             static_cast<int>(std::ceil(extents.height)) + 3);
    const Context context(cairo_create(mask.get()), cairo_destroy);
    cairo_set_font_face(context.get(), cairo_get_font_face(measuring.get()));
    cairo_set_font_size(context.get(), pixels);
    cairo_move_to(context.get(), -glyph.x, -glyph.y);
    cairo_show_text(context.get(), text);
    cairo_surface_flush(mask.get());  // before its bytes are read
    glyph.coverage = cairo_image_surface_get_data(mask.get());
    glyph.width = cairo_image_surface_get_width(mask.get());
    glyph.height = cairo_image_surface_get_height(mask.get());
    glyph.stride = cairo_image_surface_get_stride(mask.get());
    return mask;
}

/// ARGB32 names a number, whose bytes lie as B, G, R, A in memory. It is premultiplied.
PictureView viewOf(cairo_surface_t* surface) {
    return {cairo_image_surface_get_data(surface), cairo_image_surface_get_width(surface),
            cairo_image_surface_get_height(surface), cairo_image_surface_get_stride(surface),
            PixelOrder::bgra};
}

/// Just large enough for the glyph with its margins. Painted once, it is drawn again and again.
Surface painted(const Look& look, const Glyph& glyph) {
    const Margins margins = look.margins();
    Surface surface = surfaceOf(CAIRO_FORMAT_ARGB32, margins.left + glyph.width + margins.right,
                                margins.top + glyph.height + margins.bottom);
    cairo_surface_flush(surface.get());  // before its bytes are written
    paint(look, glyph, viewOf(surface.get()), margins.left - glyph.x, margins.top - glyph.y);
    cairo_surface_mark_dirty(surface.get());
    return surface;
}

/// What a widget shows. In GTK it is the body of the function that gtk_drawing_area_set_draw_func takes:
/// void draw(GtkDrawingArea*, cairo_t* context, int width, int height, gpointer title).
void draw(cairo_t* context, int width, int height, cairo_surface_t* title) {
    cairo_set_source_rgb(context, 0xF6 / 255.0, 0xF0 / 255.0, 0xE0 / 255.0);
    cairo_paint(context);
    // At a whole pixel: between two of them Cairo would blur what it draws.
    const int x = (width - cairo_image_surface_get_width(title)) / 2;
    const int y = (height - cairo_image_surface_get_height(title)) / 2;
    cairo_set_source_surface(context, title, x, y);
    cairo_paint(context);
}

/// What Cairo has laid over the window is what the library lays over a page. Returns that page.
Page checkDrawn(const PictureView& window, const PictureView& title, const Look& look,
                const Glyph& glyph) {
    const Margins margins = look.margins();
    Page page(window.width, window.height, 0xF6F0E0);
    paint(look, glyph, page.view(), (window.width - title.width) / 2 + margins.left - glyph.x,
          (window.height - title.height) / 2 + margins.top - glyph.y);
    for (int y = 0; y < window.height; ++y)
        for (int x = 0; x < window.width; ++x) {
            const unsigned char* drawn = window.data + y * window.stride + x * 4;
            const unsigned char* painted = page.pixels().data() + (y * window.width + x) * 4;
            check(drawn[2] == painted[0] && drawn[1] == painted[1] && drawn[0] == painted[2],
                  "as on a page");
        }
    return page;
}

}  // namespace

int main() {
    Glyph glyph;
    const Surface mask = maskOf("Cairo", 80, glyph);
    Look look;
    look.add(OuterShadow(rgb(0x2B1508)).angle(110).distance(7).size(9).opacity(0.6F))
        .add(LinearGradient({{rgb(0xE0603A), 1, 0}, {rgb(0x5B1F3A), 1, 1}}).angle(270))
        .add(Stroke(3, rgb(0xFFFFFF)));

    const Surface title = painted(look, glyph);
    const Surface window = surfaceOf(CAIRO_FORMAT_ARGB32, 340, 130);
    const Context context(cairo_create(window.get()), cairo_destroy);
    draw(context.get(), 340, 130, title.get());
    cairo_surface_flush(window.get());
    const Page page = checkDrawn(viewOf(window.get()), viewOf(title.get()), look, glyph);
    check(page.writePng("cairo.png"), "a PNG");
    return 0;
}
