#include <cairo-ft.h>
#include <cairo.h>

#include <cstring>

#include "core_jobs.h"
#include "fill_paint.h"
#include "font_face.h"
#include "peers.h"

/// cairo's image backend: outlines drawn from the text's path into coverage, and fills through the
/// mask of the text.
namespace vorel_bench {
namespace {

constexpr char kCairo[] = "cairo";

struct Release {
    void operator()(cairo_surface_t* surface) const { cairo_surface_destroy(surface); }
    void operator()(cairo_t* context) const { cairo_destroy(context); }
    void operator()(cairo_pattern_t* pattern) const { cairo_pattern_destroy(pattern); }
    void operator()(cairo_path_t* path) const { cairo_path_destroy(path); }
};
using Surface = std::unique_ptr<cairo_surface_t, Release>;
using Context = std::unique_ptr<cairo_t, Release>;
using Pattern = std::unique_ptr<cairo_pattern_t, Release>;
using Path = std::unique_ptr<cairo_path_t, Release>;

Surface blank(cairo_format_t format, int width, int height) {
    return Surface(cairo_image_surface_create(format, width, height));
}

/// The text's path is given; stroked with round joins and filled, it is the grown text.
class OutlineJob : public Job {
  public:
    OutlineJob(const Workload* workload, int radius)
        : mFont(workload->font, workload->sizePx),
          mSurface(blank(CAIRO_FORMAT_A8, workload->width + 2 * radius, workload->height + 2 * radius)),
          mContext(cairo_create(mSurface.get())) {
        cairo_font_face_t* const face =
            cairo_ft_font_face_create_for_ft_face(mFont.face(), FT_LOAD_NO_HINTING);
        cairo_set_font_face(mContext.get(), face);
        cairo_set_font_size(mContext.get(), workload->sizePx);
        cairo_text_extents_t extents;
        cairo_text_extents(mContext.get(), workload->text.c_str(), &extents);
        cairo_move_to(mContext.get(), radius - extents.x_bearing, radius - extents.y_bearing);
        cairo_text_path(mContext.get(), workload->text.c_str());
        mPath.reset(cairo_copy_path(mContext.get()));
        cairo_new_path(mContext.get());
        cairo_set_font_face(mContext.get(), nullptr);
        cairo_font_face_destroy(face);
        cairo_set_line_width(mContext.get(), 2.0 * radius);
        cairo_set_line_join(mContext.get(), CAIRO_LINE_JOIN_ROUND);
    }

    void reset() override {
        cairo_surface_flush(mSurface.get());
        const auto bytes = static_cast<size_t>(cairo_image_surface_get_stride(mSurface.get())) *
                           static_cast<size_t>(cairo_image_surface_get_height(mSurface.get()));
        std::memset(cairo_image_surface_get_data(mSurface.get()), 0, bytes);
        cairo_surface_mark_dirty(mSurface.get());
    }

    void paint() override {
        cairo_append_path(mContext.get(), mPath.get());
        cairo_stroke_preserve(mContext.get());
        cairo_fill(mContext.get());
        cairo_surface_flush(mSurface.get());
    }

  private:
    FontFace mFont;
    Surface mSurface;
    Context mContext;
    Path mPath;
};

using MakePattern = Pattern (*)(const Workload&);

void addStops(cairo_pattern_t* pattern) {
    for (const literal::Stop& stop : rampStops<literal::Stop>()) {
        const auto channel = [&](int shift) { return (stop.color >> shift & 0xFF) / 255.0; };
        cairo_pattern_add_color_stop_rgb(pattern, static_cast<double>(stop.location), channel(16),
                                         channel(8), channel(0));
    }
}

Pattern linearPattern(const Workload& workload) {
    Pattern pattern(cairo_pattern_create_linear(0, workload.height, 0, 0));
    addStops(pattern.get());
    return pattern;
}

Pattern radialPattern(const Workload& workload) {
    const double x = workload.width * 0.5;
    const double y = workload.height * 0.5;
    Pattern pattern(cairo_pattern_create_radial(x, y, 0, x, y, x));
    addStops(pattern.get());
    return pattern;
}

Pattern tilePattern(const Workload&) {
    const Surface tile = blank(CAIRO_FORMAT_ARGB32, kTileSide, kTileSide);
    const std::vector<uint8_t> bytes = tileBytes();
    unsigned char* const words = cairo_image_surface_get_data(tile.get());
    for (size_t i = 0; i < bytes.size(); ++i)
        words[i] = bytes[i / 4 * 4 + (3 - i % 4)];  // A, R, G, B to the words' memory order
    cairo_surface_mark_dirty(tile.get());
    Pattern pattern(cairo_pattern_create_for_surface(tile.get()));
    cairo_pattern_set_extend(pattern.get(), CAIRO_EXTEND_REPEAT);
    cairo_pattern_set_filter(pattern.get(), CAIRO_FILTER_BILINEAR);
    cairo_matrix_t matrix;
    cairo_matrix_init_scale(&matrix, 1.0 / double{kTileScale}, 1.0 / double{kTileScale});
    cairo_pattern_set_matrix(pattern.get(), &matrix);
    return pattern;
}

class FillJob : public Job {
  public:
    FillJob(const Workload* workload, MakePattern makePattern)
        : mMask(blank(CAIRO_FORMAT_A8, workload->width, workload->height)),
          mLayer(blank(CAIRO_FORMAT_ARGB32, workload->width, workload->height)),
          mContext(cairo_create(mLayer.get())) {
        const int stride = cairo_image_surface_get_stride(mMask.get());
        for (int y = 0; y < workload->height; ++y) {
            std::memcpy(cairo_image_surface_get_data(mMask.get()) + std::ptrdiff_t{y} * stride,
                        workload->mask.data() + std::ptrdiff_t{y} * workload->width,
                        static_cast<size_t>(workload->width));
        }
        cairo_surface_mark_dirty(mMask.get());
        const Pattern pattern = makePattern(*workload);
        cairo_set_source(mContext.get(), pattern.get());
    }

    void paint() override {
        cairo_mask_surface(mContext.get(), mMask.get(), 0, 0);
        cairo_surface_flush(mLayer.get());
    }

  private:
    Surface mMask;
    Surface mLayer;
    Context mContext;
};

void addFill(Cases& cases, const std::string& name, const Workload& workload, MakePattern makePattern) {
    cases.push_back(caseOf<FillJob>("fill/" + name + "/" + workload.name, kCairo,
                                    workload.grownPixels(0), &workload, makePattern));
}

}  // namespace

void addCairoCases(Cases& cases) {
    for (const Workload* workload : {&line48(), &title160()}) {
        for (const int radius : kRadii) {
            cases.push_back(
                caseOf<OutlineJob>("stroke/outside/" + workload->name + "/R:" + std::to_string(radius),
                                   kCairo, workload->grownPixels(radius), workload, radius));
        }
        addFill(cases, "linear", *workload, linearPattern);
        addFill(cases, "radial", *workload, radialPattern);
        addFill(cases, "pattern", *workload, tilePattern);
    }
}

}  // namespace vorel_bench
