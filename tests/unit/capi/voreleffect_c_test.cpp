#include <gtest/gtest.h>
#include <voreleffect/look.h>
#include <voreleffect/voreleffect_c.h>

#include <climits>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <limits>
#include <string>
#include <type_traits>
#include <vector>

#include "tests/support/compare.h"
#include "tests/support/float_states.h"
#include "tests/support/thinned.h"
#include "tests/unit/capi/looks_in_c.h"
#include "tests/unit/look/looks_by_hand.h"

// The C face paints what look.h paints, and refuses what its header says it refuses.

namespace {

using namespace VFontEffect;
using namespace vorel_test;

// What a program that was compiled against an earlier header relies on, where pointers take 8 bytes.
static_assert(sizeof(void*) != 8 || (sizeof(vorel_glyph) == 32 && sizeof(vorel_view) == 32));
static_assert(sizeof(void*) != 8 || sizeof(vorel_pixels) == 24);
static_assert(sizeof(void*) != 8 ||
              (offsetof(vorel_glyph, coverage) == 8 && offsetof(vorel_glyph, width) == 16 &&
               offsetof(vorel_glyph, height) == 20 && offsetof(vorel_glyph, stride) == 24));
static_assert(sizeof(void*) != 8 ||
              (offsetof(vorel_view, width) == 8 && offsetof(vorel_view, height) == 12 &&
               offsetof(vorel_view, stride) == 16 && offsetof(vorel_view, order) == 24));
static_assert(sizeof(void*) != 8 ||
              (offsetof(vorel_pixels, width) == 8 && offsetof(vorel_pixels, height) == 12 &&
               offsetof(vorel_pixels, stride) == 16));
static_assert(offsetof(vorel_glyph, x) == 0 && offsetof(vorel_glyph, y) == 4);
static_assert(offsetof(vorel_view, data) == 0 && offsetof(vorel_pixels, data) == 0);
static_assert(sizeof(vorel_stop) == 12 && offsetof(vorel_stop, color) == 0 &&
              offsetof(vorel_stop, opacity) == 4 && offsetof(vorel_stop, place) == 8);
static_assert(sizeof(vorel_box) == 16 && offsetof(vorel_box, left) == 0 &&
              offsetof(vorel_box, top) == 4 && offsetof(vorel_box, right) == 8 &&
              offsetof(vorel_box, bottom) == 12);
static_assert(sizeof(vorel_margins) == 16 && offsetof(vorel_margins, left) == 0 &&
              offsetof(vorel_margins, top) == 4 && offsetof(vorel_margins, right) == 8 &&
              offsetof(vorel_margins, bottom) == 12);
static_assert(std::is_same_v<vorel_status, int32_t>);
static_assert(VOREL_OK == 0 && VOREL_BAD_ARGUMENT == 1 && VOREL_TOO_LARGE == 2 && VOREL_NO_MEMORY == 3);
static_assert(VOREL_CENTRE == 0 && VOREL_OUTSIDE == 1 && VOREL_INSIDE == 2);
static_assert(VOREL_RGBA == 0 && VOREL_BGRA == 1);

constexpr float kNan = std::numeric_limits<float>::quiet_NaN();

::testing::AssertionResult samePage(const Page& expected, const Page& actual) {
    return sameBytes(expected.bytes.data(), actual.bytes.data(), expected.width, expected.height, 4);
}

void expectSame(const Box& expected, const vorel_box& actual) {
    EXPECT_EQ(expected.left, actual.left);
    EXPECT_EQ(expected.top, actual.top);
    EXPECT_EQ(expected.right, actual.right);
    EXPECT_EQ(expected.bottom, actual.bottom);
}

void expectSame(const Margins& expected, const vorel_margins& actual) {
    EXPECT_EQ(expected.left, actual.left);
    EXPECT_EQ(expected.top, actual.top);
    EXPECT_EQ(expected.right, actual.right);
    EXPECT_EQ(expected.bottom, actual.bottom);
}

/// Random looks in both languages.
struct RandomStack {
    RandomStack(Random& random, int most) {
        for (int i = random.between(1, most); i > 0; --i) {
            LookInBoth both = randomLookInBoth(random);
            EXPECT_NE(both.handle, nullptr);
            looks.push_back(both.look);
            inC.push_back(both.handle.get());
            mHandles.push_back(std::move(both.handle));
        }
    }
    std::vector<Look> looks;
    std::vector<vorel_look*> inC;

  private:
    std::vector<LookHandle> mHandles;
};

// --- Equal to look.h ----------------------------------------------------------------------------

TEST(CFace, RandomLooks_HaveTheKeysAndMarginsOfTheirTwins) {
    for (int seed = 0; seed < thinned(3000); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 400'000);
        const LookInBoth both = randomLookInBoth(random);
        ASSERT_NE(both.handle, nullptr);
        ASSERT_EQ(both.look.key(), keyOf(both.handle.get()));
        vorel_margins margins = {};
        ASSERT_EQ(vorel_look_margins(both.handle.get(), &margins), VOREL_OK);
        expectSame(both.look.margins(), margins);
        if (HasFailure()) break;
    }
}

TEST(CFace, RandomStacksOnRandomPages_AreThoseOfLooks) {
    for (int seed = 0; seed < thinned(3000); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 500'000);
        const RandomStack stack(random, 3);
        const Text text = randomText(random);
        Page expected = randomPage(random, random.between(1, 70), random.between(1, 60));
        Page once = expected;
        Page byPainter = expected;
        const int x = random.between(-30, 50);
        const int y = random.between(-30, 40);
        PictureView view = expected.view();
        view.order = random.chance(50) ? PixelOrder::rgba : PixelOrder::bgra;
        const std::optional<Box> box = paint(stack.looks, text.glyphs(), view, x, y);
        ASSERT_TRUE(box);
        const std::vector<vorel_glyph> glyphs = inC(text.glyphs());
        vorel_view page = inC(view);
        vorel_box touched = {};
        page.data = once.bytes.data();
        ASSERT_EQ(vorel_paint(stack.inC.data(), stack.inC.size(), glyphs.data(), glyphs.size(), &page, x,
                              y, &touched),
                  VOREL_OK);
        expectSame(*box, touched);
        page.data = byPainter.bytes.data();
        const PainterHandle painter = newPainter(stack.inC);
        ASSERT_EQ(vorel_painter_paint(painter.get(), glyphs.data(), glyphs.size(), &page, x, y, nullptr),
                  VOREL_OK);
        EXPECT_TRUE(samePage(expected, once));
        EXPECT_TRUE(samePage(expected, byPainter));
        if (HasFailure()) break;
    }
}

void expectSame(const Picture& expected, const vorel_picture* actual) {
    ASSERT_EQ(expected.width(), vorel_picture_width(actual));
    ASSERT_EQ(expected.height(), vorel_picture_height(actual));
    EXPECT_EQ(expected.stride(), vorel_picture_stride(actual));
    EXPECT_EQ(expected.left(), vorel_picture_left(actual));
    EXPECT_EQ(expected.top(), vorel_picture_top(actual));
    const auto bytes = static_cast<size_t>(expected.stride()) * static_cast<size_t>(expected.height());
    EXPECT_EQ(0, std::memcmp(expected.data(), vorel_picture_data(actual), bytes));
}

TEST(CFace, RandomPictures_AreThoseOfLooks) {
    for (int seed = 0; seed < thinned(1000); ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        Random random(static_cast<uint64_t>(seed) + 600'000);
        const RandomStack stack(random, 3);
        const PainterHandle painter = newPainter(stack.inC);
        vorel_margins margins = {};
        ASSERT_EQ(vorel_painter_margins(painter.get(), &margins), VOREL_OK);
        expectSame(Painter(stack.looks).margins(), margins);
        const Text text = randomText(random);
        const std::vector<vorel_glyph> glyphs = inC(text.glyphs());
        const std::optional<Picture> picture = paint(stack.looks, text.glyphs());
        vorel_picture* made = nullptr;
        ASSERT_EQ(vorel_painter_picture(painter.get(), glyphs.data(), glyphs.size(), &made), VOREL_OK);
        const PictureHandle handle(made);
        expectSame(*picture, made);
        Page expected = randomPage(random, 50, 40);
        Page actual = expected;
        const Box box = *picture->layOver(expected.view(), 9, 7);
        const vorel_view page = inC(actual.view());
        vorel_box touched = {};
        ASSERT_EQ(vorel_picture_lay_over(made, &page, 9, 7, &touched), VOREL_OK);
        expectSame(box, touched);
        EXPECT_TRUE(samePage(expected, actual));
        if (HasFailure()) break;
    }
}

TEST(CFace, InEveryFloatState_PaintsTheSame) {
    const std::vector<unsigned char> coverage(9, 255);
    const vorel_glyph glyph = {3, 3, coverage.data(), 3, 3, 0};
    const auto painted = [&glyph] {
        Page page(9, 9);
        const vorel_view view = inC(page.view());
        const LookHandle look = newLook();
        vorel_look* const list[] = {look.get()};
        EXPECT_EQ(vorel_look_fill(look.get(), 0x80FF40, 0.4F), VOREL_OK);
        EXPECT_EQ(vorel_look_text_opacity(look.get(), 0.75F), VOREL_OK);
        EXPECT_EQ(vorel_look_outer_shadow(look.get(), 120, 1, 2, 0xFF, 0.3F), VOREL_OK);
        EXPECT_EQ(vorel_paint(list, 1, &glyph, 1, &view, 0, 0, nullptr), VOREL_OK);
        return page;
    };
    const Page expected = painted();
    for (const FloatState& state : floatStates()) {
        Page page(9, 9);
        {
            const InFloatState callers(state);
            page = painted();
        }
        EXPECT_TRUE(samePage(expected, page)) << state.name;
    }
}

// --- Looks --------------------------------------------------------------------------------------

TEST(CFace, CopiesOfLooks_AreIndependent) {
    const LookHandle look = newLook();
    vorel_look* made = nullptr;
    ASSERT_EQ(vorel_look_copy(look.get(), &made), VOREL_OK);
    const LookHandle copy(made);
    int32_t equal = 0;
    EXPECT_EQ(vorel_look_equal(look.get(), made, &equal), VOREL_OK);
    EXPECT_EQ(equal, 1);
    EXPECT_EQ(vorel_look_fill(made, 0xFF0000, 1), VOREL_OK);
    EXPECT_EQ(vorel_look_equal(look.get(), made, &equal), VOREL_OK);
    EXPECT_EQ(equal, 0);
    EXPECT_EQ(Look().key(), keyOf(look.get()));
}

TEST(CFace, PaintersHaveCopiesOfTheirLooks) {
    const LookHandle look = newLook();
    ASSERT_EQ(vorel_look_fill(look.get(), 0x0000FF, 1), VOREL_OK);
    const PainterHandle painter = newPainter({look.get()});
    ASSERT_EQ(vorel_look_fill(look.get(), 0xFF0000, 1), VOREL_OK);
    const unsigned char covered = 255;
    const vorel_glyph glyph = {0, 0, &covered, 1, 1, 0};
    Page page(1, 1);
    const vorel_view view = inC(page.view());
    ASSERT_EQ(vorel_painter_paint(painter.get(), &glyph, 1, &view, 0, 0, nullptr), VOREL_OK);
    EXPECT_EQ(page.bytes, (std::vector<unsigned char>{0, 0, 255, 255}));
}

TEST(CFace, Key_ThatDoesNotFit_TellsItsLengthAndLeavesTheBuffer) {
    const LookHandle look = newLook();
    const std::string key = Look().key();
    std::string buffer(key.size() + 1, 'x');
    size_t length = 0;
    EXPECT_EQ(vorel_look_key(look.get(), buffer.data(), key.size() - 1, &length), VOREL_TOO_LARGE);
    EXPECT_EQ(length, key.size());
    EXPECT_EQ(buffer, std::string(key.size() + 1, 'x'));
    length = 0;
    EXPECT_EQ(vorel_look_key(look.get(), buffer.data(), 0, &length), VOREL_TOO_LARGE);
    EXPECT_EQ(length, key.size());
    EXPECT_EQ(vorel_look_key(look.get(), buffer.data(), buffer.size(), &length), VOREL_OK);
    EXPECT_EQ(buffer, key + 'x') << "no zero is set behind the key";
}

TEST(CFace, ConstantsThatThereAreNot_AreRefusedAndChangeNothing) {
    const LookHandle look = newLook();
    for (const int32_t position : {-1, 3, INT32_MIN, INT32_MAX})
        EXPECT_EQ(vorel_look_stroke(look.get(), 2, 0, 1, position), VOREL_BAD_ARGUMENT) << position;
    EXPECT_EQ(keyOf(look.get()), Look().key());
    const PainterHandle painter = newPainter({look.get()});
    vorel_look* const list[] = {look.get()};
    for (const int32_t order : {-1, 2, INT32_MIN, INT32_MAX}) {
        Page page(1, 1);
        vorel_view view = inC(page.view());
        view.order = order;
        EXPECT_EQ(vorel_painter_paint(painter.get(), nullptr, 0, &view, 0, 0, nullptr),
                  VOREL_BAD_ARGUMENT);
        EXPECT_EQ(vorel_paint(list, 1, nullptr, 0, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    }
}

TEST(CFace, NumbersOutOfRange_AreThoseOfTheAddCalls) {
    for (const float number : {kNan, INFINITY, -INFINITY, -1.0F, 1e30F}) {
        const LookHandle look = newLook();
        EXPECT_EQ(vorel_look_stroke(look.get(), number, 5, number, VOREL_INSIDE), VOREL_OK);
        EXPECT_EQ(vorel_look_fill(look.get(), 7, number), VOREL_OK);
        const Look same = Look()
                              .add(Stroke(number, rgb(5)).opacity(number).position(Position::inside))
                              .fill(rgb(7), number);
        EXPECT_EQ(keyOf(look.get()), same.key()) << number;
    }
}

TEST(CFace, PatternsThatCannotBeRead_AreRefusedAndChangeNothing) {
    const LookHandle look = newLook();
    const unsigned char bytes[16] = {};
    for (const vorel_pixels& pixels :
         {vorel_pixels{nullptr, 2, 2, 0}, vorel_pixels{bytes, 0, 2, 0}, vorel_pixels{bytes, 2, 0, 0},
          vorel_pixels{bytes, -1, 2, 0}, vorel_pixels{bytes, 2, -1, 0}, vorel_pixels{bytes, 2, 2, 7},
          vorel_pixels{bytes, 2, 2, -8}})
        EXPECT_EQ(vorel_look_pattern(look.get(), &pixels, 1, 1), VOREL_BAD_ARGUMENT);
    for (const vorel_pixels& pixels :
         {vorel_pixels{bytes, 1 << 29, 1, 0}, vorel_pixels{bytes, 1 << 20, 1 << 20, 0},
          vorel_pixels{bytes, INT32_MAX, INT32_MAX, 0}})
        EXPECT_EQ(vorel_look_pattern(look.get(), &pixels, 1, 1), VOREL_TOO_LARGE);
    EXPECT_EQ(keyOf(look.get()), Look().key());
}

// --- Views, glyphs and pictures -----------------------------------------------------------------

/// What painting a glyph on a view gives, with one look.
vorel_status painted(const vorel_glyph& glyph, const vorel_view& view) {
    const LookHandle look = newLook();
    const PainterHandle painter = newPainter({look.get()});
    vorel_look* const list[] = {look.get()};
    const vorel_status once = vorel_paint(list, 1, &glyph, 1, &view, 0, 0, nullptr);
    EXPECT_EQ(once, vorel_painter_paint(painter.get(), &glyph, 1, &view, 0, 0, nullptr));
    return once;
}

TEST(CFace, ViewsAndGlyphsThatCannotBeRead_AreRefused) {
    Page page(4, 4);
    const unsigned char coverage[16] = {};
    const vorel_glyph glyph = {0, 0, coverage, 2, 2, 0};
    const vorel_view view = inC(page.view());
    EXPECT_EQ(painted(glyph, view), VOREL_OK);
    unsigned char* const data = view.data;
    for (const vorel_view& bad :
         {vorel_view{nullptr, 4, 4, 0, VOREL_RGBA}, vorel_view{data, -1, 4, 0, VOREL_RGBA},
          vorel_view{data, 4, -1, 0, VOREL_RGBA}, vorel_view{data, 4, 4, 15, VOREL_RGBA},
          vorel_view{data, 4, 4, -16, VOREL_RGBA}})
        EXPECT_EQ(painted(glyph, bad), VOREL_BAD_ARGUMENT);
    for (const vorel_glyph& bad :
         {vorel_glyph{0, 0, nullptr, 2, 2, 0}, vorel_glyph{0, 0, coverage, -1, 2, 0},
          vorel_glyph{0, 0, coverage, 2, -1, 0}, vorel_glyph{0, 0, coverage, 2, 2, 1}})
        EXPECT_EQ(painted(bad, view), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(painted({0, 0, coverage, 65536, 1, 0}, view), VOREL_TOO_LARGE);
    EXPECT_EQ(painted({0, 0, nullptr, 0, 2, 0}, view), VOREL_OK) << "skipped";
    EXPECT_EQ(painted(glyph, {nullptr, 0, 4, 0, VOREL_RGBA}), VOREL_OK) << "to no effect";
}

TEST(CFace, RowsFartherApartThanPointersSpan_AreRefused) {
    Page page(4, 4);
    const unsigned char coverage[16] = {};
    const vorel_glyph glyph = {0, 0, coverage, 2, 2, 0};
    const vorel_view view = inC(page.view());
    // The last of three rows begins two strides from the first: that its end is within what pointers
    // span leaves half of that, less half a row, for each.
    constexpr ptrdiff_t kGlyphStride = (PTRDIFF_MAX - 2) / 2 + 1;
    constexpr ptrdiff_t kViewStride = (PTRDIFF_MAX - 16) / 2 + 1;
    EXPECT_EQ(painted({0, 0, coverage, 2, 3, kGlyphStride}, view), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(painted(glyph, {view.data, 4, 3, kViewStride, VOREL_RGBA}), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(painted({9, 9, coverage, 2, 2, 0}, {view.data, 4, 3, kViewStride - 1, VOREL_RGBA}),
              VOREL_OK);
    const vorel_pixels pixels = {coverage, 1, 3, kViewStride + 6};
    const LookHandle look = newLook();
    EXPECT_EQ(vorel_look_pattern(look.get(), &pixels, 1, 1), VOREL_BAD_ARGUMENT);
}

TEST(CFace, PackedRowsOfMoreThanPointersSpan_AreRefused) {
    Page page(4, 4);
    const unsigned char coverage[16] = {};
    const vorel_glyph glyph = {0, 0, coverage, 2, 2, 0};
    if (sizeof(ptrdiff_t) > 4) GTEST_SKIP() << "there is no such width";
    for (const int32_t width : {1 << 29, INT32_MAX})
        EXPECT_EQ(painted(glyph, {page.view().data, width, 2, 0, VOREL_RGBA}), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(painted(glyph, {page.view().data, 1 << 15, 1 << 15, 0, VOREL_RGBA}), VOREL_BAD_ARGUMENT);
}

TEST(CFace, GlyphsFarApart_AreTooLargeForALayer) {
    const unsigned char covered = 255;
    const vorel_glyph glyphs[] = {{INT32_MIN, 0, &covered, 1, 1, 0}, {INT32_MAX, 0, &covered, 1, 1, 0}};
    const LookHandle look = newLook();
    const PainterHandle painter = newPainter({look.get()});
    vorel_picture* picture = nullptr;
    EXPECT_EQ(vorel_painter_picture(painter.get(), glyphs, 2, &picture), VOREL_TOO_LARGE);
    EXPECT_EQ(picture, nullptr);
}

TEST(CFace, PictureWhoseOriginDoesNotFit_IsTooLarge) {
    const unsigned char covered = 255;
    const LookHandle look = newLook();
    ASSERT_EQ(vorel_look_stroke(look.get(), 3, 0xFF, 1, VOREL_OUTSIDE), VOREL_OK);
    const PainterHandle painter = newPainter({look.get()});
    vorel_margins margins = {};
    ASSERT_EQ(vorel_painter_margins(painter.get(), &margins), VOREL_OK);
    vorel_glyph glyph = {INT32_MIN + margins.left, INT32_MIN + margins.top, &covered, 1, 1, 0};
    vorel_picture* picture = nullptr;
    EXPECT_EQ(vorel_painter_picture(painter.get(), &glyph, 1, &picture), VOREL_OK);
    EXPECT_EQ(vorel_picture_left(picture), INT32_MIN);
    EXPECT_EQ(vorel_picture_top(picture), INT32_MIN);
    vorel_picture_free(picture);
    --glyph.x;
    EXPECT_EQ(vorel_painter_picture(painter.get(), &glyph, 1, &picture), VOREL_TOO_LARGE);
    EXPECT_EQ(picture, nullptr);
}

TEST(CFace, NothingToPaint_TouchesNothingAndGivesAnEmptyPicture) {
    Page page(4, 4);
    const vorel_view view = inC(page.view());
    const LookHandle look = newLook();
    const PainterHandle painter = newPainter({look.get()});
    vorel_box touched = {1, 2, 3, 4};
    EXPECT_EQ(vorel_painter_paint(painter.get(), nullptr, 0, &view, 0, 0, &touched), VOREL_OK);
    expectSame(Box{}, touched);
    vorel_picture* made = nullptr;
    EXPECT_EQ(vorel_painter_picture(painter.get(), nullptr, 0, &made), VOREL_OK);
    const PictureHandle picture(made);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(vorel_picture_width(made), 0);
    EXPECT_EQ(vorel_picture_data(made), nullptr);
    vorel_view own = {};
    EXPECT_EQ(vorel_picture_view(made, &own), VOREL_OK);
    EXPECT_EQ(vorel_picture_lay_over(made, &own, 0, 0, nullptr), VOREL_OK);
    const unsigned char covered = 255;
    const vorel_glyph glyph = {0, 0, &covered, 1, 1, 0};
    EXPECT_EQ(vorel_paint(nullptr, 0, &glyph, 1, &view, 0, 0, &touched), VOREL_OK) << "no looks";
    EXPECT_EQ(page.bytes, Page(4, 4).bytes);
}

TEST(CFace, ViewOfAPicture_PaintsIntoIt) {
    const LookHandle look = newLook();
    const PainterHandle painter = newPainter({look.get()});
    const unsigned char covered = 255;
    const vorel_glyph glyph = {0, 0, &covered, 1, 1, 0};
    vorel_picture* made = nullptr;
    ASSERT_EQ(vorel_painter_picture(painter.get(), &glyph, 1, &made), VOREL_OK);
    const PictureHandle picture(made);
    vorel_view own = {};
    ASSERT_EQ(vorel_picture_view(made, &own), VOREL_OK);
    ASSERT_EQ(vorel_look_fill(look.get(), 0xFF0000, 1), VOREL_OK);
    vorel_look* const list[] = {look.get()};
    ASSERT_EQ(vorel_paint(list, 1, &glyph, 1, &own, -vorel_picture_left(made), -vorel_picture_top(made),
                          nullptr),
              VOREL_OK);
    const Picture red = *paint(Look().fill(rgb(0xFF0000)), Glyph{0, 0, &covered, 1, 1});
    expectSame(red, made);
}

// --- Null pointers, every one in turn ------------------------------------------------------------

TEST(CFace, NullLooks_AreRefused) {
    const LookHandle handle = newLook();
    vorel_look* const look = handle.get();
    vorel_look* made = look;
    EXPECT_EQ(vorel_look_new(nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_copy(look, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_copy(nullptr, &made), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(made, nullptr);
    EXPECT_EQ(vorel_look_fill(nullptr, 0, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_no_fill(nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_text_opacity(nullptr, 1), VOREL_BAD_ARGUMENT);
    vorel_margins margins = {};
    EXPECT_EQ(vorel_look_margins(nullptr, &margins), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_margins(look, nullptr), VOREL_BAD_ARGUMENT);
    char buffer[1000];
    size_t length = 0;
    EXPECT_EQ(vorel_look_key(nullptr, buffer, sizeof buffer, &length), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_key(look, nullptr, 1, &length), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_key(look, buffer, sizeof buffer, nullptr), VOREL_BAD_ARGUMENT);
    int32_t equal = 0;
    EXPECT_EQ(vorel_look_equal(nullptr, look, &equal), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_equal(look, nullptr, &equal), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_equal(look, look, nullptr), VOREL_BAD_ARGUMENT);
}

TEST(CFace, NullsOfEffects_AreRefusedAndChangeNothing) {
    const LookHandle handle = newLook();
    vorel_look* const look = handle.get();
    const vorel_stop stop = {0, 1, 0};
    const unsigned char bytes[4] = {};
    const vorel_pixels pixels = {bytes, 1, 1, 0};
    EXPECT_EQ(vorel_look_outer_shadow(nullptr, 0, 0, 0, 0, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_inner_shadow(nullptr, 0, 0, 0, 0, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_outer_glow(nullptr, 1, 0, 1, &stop, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_outer_glow(look, 1, 0, 1, nullptr, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_inner_glow(nullptr, 1, 0, 1, &stop, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_inner_glow(look, 1, 0, 1, nullptr, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_linear_gradient(nullptr, 0, 1, 1, &stop, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_linear_gradient(look, 0, 1, 1, nullptr, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_radial_gradient(nullptr, 1, 1, &stop, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_radial_gradient(look, 1, 1, nullptr, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_stroke(nullptr, 1, 0, 1, VOREL_OUTSIDE), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_pattern(nullptr, &pixels, 1, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_look_pattern(look, nullptr, 1, 1), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(keyOf(look), Look().key());
}

TEST(CFace, NullsOfPainting_AreRefused) {
    const LookHandle look = newLook();
    const PainterHandle handle = newPainter({look.get()});
    vorel_painter* const painter = handle.get();
    vorel_look* const none[] = {look.get(), nullptr};
    vorel_painter* made = painter;
    EXPECT_EQ(vorel_painter_new(none, 1, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_new(nullptr, 1, &made), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(made, nullptr);
    EXPECT_EQ(vorel_painter_new(none, 2, &made), VOREL_BAD_ARGUMENT);
    vorel_margins margins = {};
    EXPECT_EQ(vorel_painter_margins(nullptr, &margins), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_margins(painter, nullptr), VOREL_BAD_ARGUMENT);
    Page page(1, 1);
    const vorel_view view = inC(page.view());
    const unsigned char covered = 255;
    const vorel_glyph glyph = {0, 0, &covered, 1, 1, 0};
    EXPECT_EQ(vorel_painter_paint(nullptr, &glyph, 1, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_paint(painter, nullptr, 1, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_paint(painter, &glyph, 1, nullptr, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_paint(nullptr, 1, &glyph, 1, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_paint(none, 2, &glyph, 1, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_paint(none, 1, nullptr, 1, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_paint(none, 1, &glyph, 1, nullptr, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(page.bytes, Page(1, 1).bytes);
    vorel_picture* picture = nullptr;
    EXPECT_EQ(vorel_painter_picture(nullptr, &glyph, 1, &picture), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_picture(painter, nullptr, 1, &picture), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_painter_picture(painter, &glyph, 1, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(picture, nullptr);
}

TEST(CFace, NullPictures_HaveNothingAndAreRefused) {
    EXPECT_EQ(vorel_picture_width(nullptr), 0);
    EXPECT_EQ(vorel_picture_height(nullptr), 0);
    EXPECT_EQ(vorel_picture_stride(nullptr), 0);
    EXPECT_EQ(vorel_picture_left(nullptr), 0);
    EXPECT_EQ(vorel_picture_top(nullptr), 0);
    EXPECT_EQ(vorel_picture_data(nullptr), nullptr);
    Page page(1, 1);
    vorel_view view = inC(page.view());
    const PainterHandle painter = newPainter({});
    vorel_picture* made = nullptr;
    ASSERT_EQ(vorel_painter_picture(painter.get(), nullptr, 0, &made), VOREL_OK);
    const PictureHandle picture(made);
    EXPECT_EQ(vorel_picture_view(nullptr, &view), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_picture_view(made, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_picture_lay_over(nullptr, &view, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    EXPECT_EQ(vorel_picture_lay_over(made, nullptr, 0, 0, nullptr), VOREL_BAD_ARGUMENT);
    vorel_look_free(nullptr);
    vorel_painter_free(nullptr);
    vorel_picture_free(nullptr);
}

TEST(CFace, Texts_AreNeverNullAndDiffer) {
    for (const vorel_status status : {-1, 4, INT32_MIN, INT32_MAX})
        EXPECT_STREQ(vorel_status_text(status), "unknown status");
    for (vorel_status a = VOREL_OK; a <= VOREL_NO_MEMORY; ++a)
        for (vorel_status b = VOREL_OK; b < a; ++b)
            EXPECT_STRNE(vorel_status_text(a), vorel_status_text(b));
}

}  // namespace
