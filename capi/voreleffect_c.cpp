#include "voreleffect/voreleffect_c.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "voreleffect/VFBitmap.h"
#include "voreleffect/VFECore.h"
#include "voreleffect/VFEffect.h"
#include "voreleffect/VFProperty.h"

// The C face is look.h behind handles. This source alone of the library's is compiled with exceptions:
// what look.h throws for want of memory becomes a status here, after its destructors have run.
//
// What look.h defines is this source's own, hence the namespaces around it and all of its includes
// above: a program without exceptions that is linked with the static library has the same inline
// functions, and the linker would take its copies, which end the process, for these.
namespace capi {
namespace {
namespace VFontEffect {
using namespace ::VFontEffect;
}  // namespace VFontEffect

#include "voreleffect/look.h"
}  // namespace
}  // namespace capi

using capi::VFontEffect::Box;
using capi::VFontEffect::Effect;
using capi::VFontEffect::Failure;
using capi::VFontEffect::Glyph;
using capi::VFontEffect::Glyphs;
using capi::VFontEffect::Look;
using capi::VFontEffect::Margins;
using capi::VFontEffect::Painter;
using capi::VFontEffect::Picture;
using capi::VFontEffect::PictureView;
using capi::VFontEffect::PixelOrder;
using capi::VFontEffect::PixelView;
using capi::VFontEffect::Position;
using capi::VFontEffect::rgb;
using capi::VFontEffect::look_internal::Kind;

struct vorel_look {
    Look look;
};

struct vorel_painter {
    Painter painter;
    std::vector<Glyph> glyphs;  ///< of the last call: kept for its memory
};

struct vorel_picture {
    Picture picture;
};

namespace {

/// What the work returns; VOREL_NO_MEMORY where it throws, which it does for want of memory alone.
template <class Work>
vorel_status guarded(const Work& work) noexcept {
    try {
        return work();
    } catch (...) {
        return VOREL_NO_MEMORY;
    }
}

bool areNull(const void* list, size_t count) {
    return list == nullptr && count != 0;
}

vorel_status statusOf(Failure failure) {
    switch (failure) {
        case Failure::none:
            return VOREL_OK;
        case Failure::badArgument:
            return VOREL_BAD_ARGUMENT;
        case Failure::tooLarge:
            return VOREL_TOO_LARGE;
        case Failure::noMemory:
            break;
    }
    return VOREL_NO_MEMORY;
}

vorel_margins marginsOf(const Margins& margins) {
    return {margins.left, margins.top, margins.right, margins.bottom};
}

void tell(vorel_box* touched, const Box& box) {
    if (touched != nullptr) *touched = {box.left, box.top, box.right, box.bottom};
}

/// Nothing for no view, and for one of an order that there is not.
std::optional<PictureView> viewOf(const vorel_view* view) {
    if (view == nullptr || (view->order != VOREL_RGBA && view->order != VOREL_BGRA)) return std::nullopt;
    const PixelOrder order = view->order == VOREL_BGRA ? PixelOrder::bgra : PixelOrder::rgba;
    return PictureView{view->data, view->width, view->height, view->stride, order};
}

void takeGlyphs(std::vector<Glyph>& list, const vorel_glyph* glyphs, size_t count) {
    list.clear();
    list.reserve(count);
    for (size_t i = 0; i < count; ++i) {
        const vorel_glyph& glyph = glyphs[i];
        list.push_back({glyph.x, glyph.y, glyph.coverage, glyph.width, glyph.height, glyph.stride});
    }
}

/// Whether there is a list of looks, none of them null.
bool areLooks(vorel_look* const* looks, size_t count) {
    return !areNull(looks, count) && std::find(looks, looks + count, nullptr) == looks + count;
}

vorel_painter painterOf(vorel_look* const* looks, size_t count) {
    std::vector<Look> list;
    list.reserve(count);
    for (size_t i = 0; i < count; ++i)
        list.push_back(looks[i]->look);
    return {Painter(list), {}};
}

/// The numbers that a call tells of an effect; those that it leaves out do not count for its kind.
struct Numbers {
    float opacity;
    float size = 0;
    float angle = 0;
    float distance = 0;
    float scale = 1;
    Position position = Position::outside;
};

/// An effect of a kind that is told by its number: one function adds all of them, which the classes of
/// look.h would take one each for.
class AnyEffect : public Effect {
  public:
    AnyEffect(Kind kind, uint32_t color, const Numbers& numbers) : Effect(Data(kind, rgb(color))) {
        mData.opacity = numbers.opacity;
        mData.size = numbers.size;
        mData.angle = numbers.angle;
        mData.distance = numbers.distance;
        mData.scale = numbers.scale;
        mData.position = numbers.position;
    }
    /// The first 256: what is beyond is not painted.
    void take(const vorel_stop* stops, size_t count) {
        constexpr size_t kMostStops = 256;
        mData.stops.reserve(std::min(count, kMostStops));
        for (size_t i = 0; i < std::min(count, kMostStops); ++i)
            mData.stops.push_back({rgb(stops[i].color), stops[i].opacity, stops[i].place});
    }
    void take(const PixelView& pixels) { mData.tile = capi::VFontEffect::look_internal::tileOf(pixels); }
};

vorel_status add(vorel_look* look, Kind kind, uint32_t color, const Numbers& numbers,
                 const vorel_stop* stops = nullptr, size_t count = 0) {
    if (look == nullptr || areNull(stops, count)) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        AnyEffect effect(kind, color, numbers);
        effect.take(stops, count);
        look->look.add(effect);
        return VOREL_OK;
    });
}

vorel_status paint(vorel_painter& painter, const vorel_glyph* glyphs, size_t count,
                   const PictureView& view, int32_t x, int32_t y, vorel_box* touched) {
    takeGlyphs(painter.glyphs, glyphs, count);
    const std::optional<Box> box = painter.painter.paint(Glyphs(painter.glyphs), view, x, y);
    if (box) tell(touched, *box);
    return statusOf(painter.painter.failure());
}

/// Whether the pixels of a pattern can be read, and are not too many.
vorel_status statusOf(const vorel_pixels& pixels) {
    namespace look = capi::VFontEffect::look_internal;
    if (pixels.data == nullptr || pixels.width < 1 || pixels.height < 1) return VOREL_BAD_ARGUMENT;
    if (int64_t{pixels.width} * pixels.height > look::kMostBytes / 4) return VOREL_TOO_LARGE;
    return look::areRows(pixels.data, pixels.width, pixels.height, 4, pixels.stride)
               ? VOREL_OK
               : VOREL_BAD_ARGUMENT;
}

}  // namespace

const char* vorel_version(void) {
    return VOREL_VERSION_STRING;
}

int32_t vorel_version_number(void) {
    return VOREL_VERSION;
}

const char* vorel_status_text(vorel_status status) {
    switch (status) {
        case VOREL_OK:
            return "done";
        case VOREL_BAD_ARGUMENT:
            return "bad argument";
        case VOREL_TOO_LARGE:
            return "too large";
        case VOREL_NO_MEMORY:
            return "out of memory";
        default:
            return "unknown status";
    }
}

vorel_status vorel_look_new(vorel_look** look) {
    if (look == nullptr) return VOREL_BAD_ARGUMENT;
    *look = new (std::nothrow) vorel_look;
    return *look == nullptr ? VOREL_NO_MEMORY : VOREL_OK;
}

vorel_status vorel_look_copy(const vorel_look* look, vorel_look** copy) {
    if (copy == nullptr) return VOREL_BAD_ARGUMENT;
    *copy = nullptr;
    if (look == nullptr) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        *copy = new vorel_look(*look);
        return VOREL_OK;
    });
}

void vorel_look_free(vorel_look* look) {
    delete look;
}

vorel_status vorel_look_fill(vorel_look* look, uint32_t color, float opacity) {
    if (look == nullptr) return VOREL_BAD_ARGUMENT;
    look->look.fill(rgb(color), opacity);
    return VOREL_OK;
}

vorel_status vorel_look_no_fill(vorel_look* look) {
    if (look == nullptr) return VOREL_BAD_ARGUMENT;
    look->look.noFill();
    return VOREL_OK;
}

vorel_status vorel_look_text_opacity(vorel_look* look, float opacity) {
    if (look == nullptr) return VOREL_BAD_ARGUMENT;
    look->look.textOpacity(opacity);
    return VOREL_OK;
}

vorel_status vorel_look_outer_shadow(vorel_look* look, float angle, float distance, float size,
                                     uint32_t color, float opacity) {
    return add(look, Kind::kOuterShadow, color, {opacity, size, angle, distance});
}

vorel_status vorel_look_inner_shadow(vorel_look* look, float angle, float distance, float size,
                                     uint32_t color, float opacity) {
    return add(look, Kind::kInnerShadow, color, {opacity, size, angle, distance});
}

vorel_status vorel_look_outer_glow(vorel_look* look, float size, uint32_t color, float opacity,
                                   const vorel_stop* stops, size_t count) {
    return add(look, Kind::kOuterGlow, color, {opacity, size}, stops, count);
}

vorel_status vorel_look_inner_glow(vorel_look* look, float size, uint32_t color, float opacity,
                                   const vorel_stop* stops, size_t count) {
    return add(look, Kind::kInnerGlow, color, {opacity, size}, stops, count);
}

vorel_status vorel_look_linear_gradient(vorel_look* look, float angle, float scale, float opacity,
                                        const vorel_stop* stops, size_t count) {
    return add(look, Kind::kLinearGradient, 0, {opacity, 0, angle, 0, scale}, stops, count);
}

vorel_status vorel_look_radial_gradient(vorel_look* look, float scale, float opacity,
                                        const vorel_stop* stops, size_t count) {
    return add(look, Kind::kRadialGradient, 0, {opacity, 0, 0, 0, scale}, stops, count);
}

vorel_status vorel_look_stroke(vorel_look* look, float size, uint32_t color, float opacity,
                               int32_t position) {
    static_assert(static_cast<int>(Position::centre) == VOREL_CENTRE);
    static_assert(static_cast<int>(Position::outside) == VOREL_OUTSIDE);
    static_assert(static_cast<int>(Position::inside) == VOREL_INSIDE);
    if (position < VOREL_CENTRE || position > VOREL_INSIDE) return VOREL_BAD_ARGUMENT;
    return add(look, Kind::kStroke, color, {opacity, size, 0, 0, 1, static_cast<Position>(position)});
}

vorel_status vorel_look_pattern(vorel_look* look, const vorel_pixels* pixels, float scale,
                                float opacity) {
    if (look == nullptr || pixels == nullptr) return VOREL_BAD_ARGUMENT;
    const vorel_status status = statusOf(*pixels);
    if (status != VOREL_OK) return status;
    return guarded([&] {
        AnyEffect pattern(Kind::kPattern, 0, {opacity, 0, 0, 0, scale});
        pattern.take(PixelView{pixels->data, pixels->width, pixels->height, pixels->stride});
        look->look.add(pattern);
        return VOREL_OK;
    });
}

vorel_status vorel_look_margins(const vorel_look* look, vorel_margins* margins) {
    if (look == nullptr || margins == nullptr) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        *margins = marginsOf(look->look.margins());
        return VOREL_OK;
    });
}

vorel_status vorel_look_key(const vorel_look* look, char* buffer, size_t capacity, size_t* length) {
    if (look == nullptr || length == nullptr || areNull(buffer, capacity)) return VOREL_BAD_ARGUMENT;
    return guarded([&]() -> vorel_status {
        const std::string key = look->look.key();
        *length = key.size();
        if (buffer == nullptr) return VOREL_OK;
        if (key.size() > capacity) return VOREL_TOO_LARGE;
        std::copy_n(key.data(), key.size(), buffer);
        return VOREL_OK;
    });
}

vorel_status vorel_look_equal(const vorel_look* a, const vorel_look* b, int32_t* equal) {
    if (a == nullptr || b == nullptr || equal == nullptr) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        *equal = a->look == b->look ? 1 : 0;
        return VOREL_OK;
    });
}

vorel_status vorel_painter_new(vorel_look* const* looks, size_t count, vorel_painter** painter) {
    if (painter == nullptr) return VOREL_BAD_ARGUMENT;
    *painter = nullptr;
    if (!areLooks(looks, count)) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        *painter = new vorel_painter(painterOf(looks, count));
        return VOREL_OK;
    });
}

void vorel_painter_free(vorel_painter* painter) {
    delete painter;
}

vorel_status vorel_painter_margins(const vorel_painter* painter, vorel_margins* margins) {
    if (painter == nullptr || margins == nullptr) return VOREL_BAD_ARGUMENT;
    *margins = marginsOf(painter->painter.margins());
    return VOREL_OK;
}

vorel_status vorel_painter_paint(vorel_painter* painter, const vorel_glyph* glyphs, size_t count,
                                 const vorel_view* view, int32_t x, int32_t y, vorel_box* touched) {
    const std::optional<PictureView> page = viewOf(view);
    if (painter == nullptr || areNull(glyphs, count) || !page) return VOREL_BAD_ARGUMENT;
    return guarded([&] { return paint(*painter, glyphs, count, *page, x, y, touched); });
}

vorel_status vorel_painter_picture(vorel_painter* painter, const vorel_glyph* glyphs, size_t count,
                                   vorel_picture** picture) {
    if (picture == nullptr) return VOREL_BAD_ARGUMENT;
    *picture = nullptr;
    if (painter == nullptr || areNull(glyphs, count)) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        takeGlyphs(painter->glyphs, glyphs, count);
        std::optional<Picture> painted = painter->painter.paint(Glyphs(painter->glyphs));
        if (painted) *picture = new vorel_picture{*std::move(painted)};
        return statusOf(painter->painter.failure());
    });
}

vorel_status vorel_paint(vorel_look* const* looks, size_t lookCount, const vorel_glyph* glyphs,
                         size_t count, const vorel_view* view, int32_t x, int32_t y,
                         vorel_box* touched) {
    const std::optional<PictureView> page = viewOf(view);
    if (!areLooks(looks, lookCount) || areNull(glyphs, count) || !page) return VOREL_BAD_ARGUMENT;
    return guarded([&] {
        vorel_painter painter = painterOf(looks, lookCount);
        return paint(painter, glyphs, count, *page, x, y, touched);
    });
}

void vorel_picture_free(vorel_picture* picture) {
    delete picture;
}

int32_t vorel_picture_width(const vorel_picture* picture) {
    return picture == nullptr ? 0 : picture->picture.width();
}

int32_t vorel_picture_height(const vorel_picture* picture) {
    return picture == nullptr ? 0 : picture->picture.height();
}

int32_t vorel_picture_stride(const vorel_picture* picture) {
    return picture == nullptr ? 0 : picture->picture.stride();
}

int32_t vorel_picture_left(const vorel_picture* picture) {
    return picture == nullptr ? 0 : picture->picture.left();
}

int32_t vorel_picture_top(const vorel_picture* picture) {
    return picture == nullptr ? 0 : picture->picture.top();
}

const uint8_t* vorel_picture_data(const vorel_picture* picture) {
    return picture == nullptr ? nullptr : picture->picture.data();
}

vorel_status vorel_picture_view(vorel_picture* picture, vorel_view* view) {
    if (picture == nullptr || view == nullptr) return VOREL_BAD_ARGUMENT;
    const PictureView own = picture->picture.view();
    *view = {own.data, own.width, own.height, own.stride, VOREL_RGBA};
    return VOREL_OK;
}

vorel_status vorel_picture_lay_over(const vorel_picture* picture, const vorel_view* view, int32_t x,
                                    int32_t y, vorel_box* touched) {
    const std::optional<PictureView> page = viewOf(view);
    if (picture == nullptr || !page) return VOREL_BAD_ARGUMENT;
    const std::optional<Box> box = picture->picture.layOver(*page, x, y);
    if (!box) return VOREL_BAD_ARGUMENT;
    tell(touched, *box);
    return VOREL_OK;
}
