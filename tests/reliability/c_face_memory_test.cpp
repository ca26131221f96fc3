#include <gtest/gtest.h>
#include <voreleffect/voreleffect_c.h>

#include <cstdint>
#include <string>
#include <vector>

#include "allocation_watch.h"
#include "refuse_each.h"
#include "tests/unit/capi/looks_in_c.h"

/// Memory that runs out in the C face: a status tells of it, nothing is lost and nothing has changed.
namespace {

using namespace vorel_test;

constexpr int kSide = 40;
using Bytes = std::vector<unsigned char>;

const unsigned char kTile[] = {255, 0, 0, 255, 0, 255, 0, 255};
const vorel_pixels kPixels = {kTile, 2, 1, 0};
const vorel_stop kRamp[] = {{0xFF0000, 1, 0}, {0x0000FF, 1, 1}};

/// Each effect once: what adds them, whatever comes of it.
using Add = vorel_status (*)(vorel_look* look);
const Add kAdds[] = {
    [](vorel_look* look) { return vorel_look_outer_shadow(look, 135, 4, 4, 0x203040, 1); },
    [](vorel_look* look) { return vorel_look_inner_shadow(look, 135, 4, 4, 0x400000, 1); },
    [](vorel_look* look) { return vorel_look_outer_glow(look, 4, 0, 1, kRamp, 2); },
    [](vorel_look* look) { return vorel_look_inner_glow(look, 3, 0xFFFFFF, 0.4F, kRamp, 2); },
    [](vorel_look* look) { return vorel_look_linear_gradient(look, 0, 1, 0.5F, kRamp, 2); },
    [](vorel_look* look) { return vorel_look_radial_gradient(look, 1, 0.3F, kRamp, 2); },
    [](vorel_look* look) { return vorel_look_stroke(look, 2, 0x00FF00, 1, VOREL_CENTRE); },
    [](vorel_look* look) { return vorel_look_pattern(look, &kPixels, 1, 0.5F); },
};

LookHandle everything() {
    LookHandle look = newLook();
    for (const Add add : kAdds)
        EXPECT_EQ(add(look.get()), VOREL_OK);
    return look;
}

class CFaceMemory : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!canWatchMemory()) GTEST_SKIP() << "malloc cannot be stood before in this build";
        // Its memory stays: it must not count as a leak of the code that throws first.
        EXPECT_THROW(throw std::bad_alloc(), std::bad_alloc);
    }
    vorel_glyph letter() const { return {12, 12, mCoverage.data(), 9, 9, 0}; }
    vorel_view view(Bytes& page) const { return {page.data(), kSide, kSide, 0, VOREL_RGBA}; }
    Bytes page() const { return Bytes(size_t{4} * kSide * kSide, 77); }

  private:
    const Bytes mCoverage = Bytes(81, 255);
};

/// `step` gives VOREL_NO_MEMORY wherever a buffer is refused, and is as good as ever the next time. It
/// returns its status and frees what it made.
template <class Step>
long expectRefusals(const std::string& what, Step step) {
    const long requests = refuseEach(what, [&](long n, Refusal refusal) {
        vorel_status status = VOREL_OK;
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            status = step();
            refused = RefusedMemory::refused();
        }
        EXPECT_EQ(status, refused ? VOREL_NO_MEMORY : VOREL_OK);
        return refused;
    });
    EXPECT_EQ(step(), VOREL_OK) << what;
    return requests;
}

/// The same, and so wherever an object is refused.
template <class Step>
void expectStatus(const std::string& what, Step step) {
    const long before = liveBlocks();
    {
        const RefusedObjects no;
        EXPECT_EQ(step(), VOREL_NO_MEMORY) << what;
    }
    EXPECT_EQ(before, liveBlocks()) << what << ": blocks leak";
    expectRefusals(what, step);
}

TEST_F(CFaceMemory, RefusedToAnEffect_LeavesTheLookAsItWas) {
    for (size_t i = 0; i < std::size(kAdds); ++i) {
        const LookHandle look = newLook();
        const std::string key = keyOf(look.get());
        {
            const RefusedObjects no;
            EXPECT_EQ(kAdds[i](look.get()), VOREL_NO_MEMORY) << i;
        }
        EXPECT_EQ(key, keyOf(look.get())) << i;
        EXPECT_EQ(kAdds[i](look.get()), VOREL_OK) << i;
        EXPECT_NE(key, keyOf(look.get())) << i;
    }
}

TEST_F(CFaceMemory, RefusedToAnEffectThatIsReplaced_LeavesTheLookAsItWas) {
    const LookHandle look = newLook();
    ASSERT_EQ(vorel_look_linear_gradient(look.get(), 45, 1, 0.5F, kRamp, 1), VOREL_OK);
    const std::string key = keyOf(look.get());
    {
        const RefusedObjects no;
        EXPECT_EQ(vorel_look_linear_gradient(look.get(), 0, 1, 1, kRamp, 2), VOREL_NO_MEMORY);
    }
    EXPECT_EQ(key, keyOf(look.get()));
}

TEST_F(CFaceMemory, RefusedWhileDescribing_GivesAStatus) {
    const LookHandle look = everything();
    vorel_look* const list[] = {look.get()};
    vorel_margins margins = {};
    size_t length = 0;
    int32_t equal = 0;
    expectStatus("a key of the C face", [&] { return vorel_look_key(look.get(), nullptr, 0, &length); });
    expectStatus("margins of the C face", [&] { return vorel_look_margins(look.get(), &margins); });
    expectStatus("comparing looks in C",
                 [&] { return vorel_look_equal(look.get(), look.get(), &equal); });
    expectStatus("copying a look in C", [&] {
        vorel_look* copy = look.get();
        const vorel_status status = vorel_look_copy(look.get(), &copy);
        EXPECT_EQ(copy == nullptr, status != VOREL_OK);
        vorel_look_free(copy);
        return status;
    });
    expectStatus("a painter of the C face", [&] {
        vorel_painter* painter = nullptr;
        const vorel_status status = vorel_painter_new(list, 1, &painter);
        EXPECT_EQ(painter == nullptr, status != VOREL_OK);
        vorel_painter_free(painter);
        return status;
    });
}

TEST_F(CFaceMemory, RefusedToANewLook_GivesAStatus) {
    const long requests = expectRefusals("a look of the C face", [] {
        vorel_look* look = nullptr;
        const vorel_status status = vorel_look_new(&look);
        EXPECT_EQ(look == nullptr, status != VOREL_OK);
        vorel_look_free(look);
        return status;
    });
    EXPECT_EQ(requests, 1);
}

TEST_F(CFaceMemory, RefusedWhileAPageIsPainted_LeavesEffectsOutOrThePageAsItWas) {
    const LookHandle look = everything();
    vorel_look* const list[] = {look.get()};
    const vorel_glyph glyph = letter();
    Bytes whole = page();
    vorel_view target = view(whole);
    ASSERT_EQ(vorel_paint(list, 1, &glyph, 1, &target, 0, 0, nullptr), VOREL_OK);
    refuseEach("painting in C", [&](long n, Refusal refusal) {
        Bytes painted = page();
        target = view(painted);
        vorel_status status = VOREL_OK;
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            status = vorel_paint(list, 1, &glyph, 1, &target, 0, 0, nullptr);
            refused = RefusedMemory::refused();
        }
        if (status != VOREL_OK) {
            EXPECT_EQ(status, VOREL_NO_MEMORY);
            EXPECT_EQ(painted, page());
        }
        EXPECT_TRUE(refused || painted == whole);
        return refused;
    });
    Bytes painted = page();
    target = view(painted);
    {
        const RefusedObjects no;
        EXPECT_EQ(vorel_paint(list, 1, &glyph, 1, &target, 0, 0, nullptr), VOREL_NO_MEMORY);
    }
    EXPECT_EQ(painted, page());
}

TEST_F(CFaceMemory, RefusedWhileAPictureIsPainted_GivesNone) {
    const LookHandle look = newLook();  // its fill paints without memory of its own
    const PainterHandle painter = newPainter({look.get()});
    const vorel_glyph glyph = letter();
    vorel_picture* kept = nullptr;
    ASSERT_EQ(vorel_painter_picture(painter.get(), &glyph, 1, &kept), VOREL_OK);
    const PictureHandle first(kept);
    expectStatus("a picture of the C face", [&] {
        vorel_picture* picture = nullptr;
        const vorel_status status = vorel_painter_picture(painter.get(), &glyph, 1, &picture);
        EXPECT_EQ(picture == nullptr, status != VOREL_OK);
        vorel_picture_free(picture);
        return status;
    });
}

TEST_F(CFaceMemory, OfAPainterThatHasPaintedAsManyGlyphs_IsNotAskedForObjects) {
    const LookHandle look = everything();
    const PainterHandle painter = newPainter({look.get()});
    const std::vector<vorel_glyph> glyphs(100, letter());
    Bytes first = page();
    Bytes second = page();
    vorel_view target = view(first);
    ASSERT_EQ(vorel_painter_paint(painter.get(), glyphs.data(), 100, &target, 0, 0, nullptr), VOREL_OK);
    target = view(second);
    {
        const RefusedObjects no;
        EXPECT_EQ(vorel_painter_paint(painter.get(), glyphs.data(), 100, &target, 0, 0, nullptr),
                  VOREL_OK);
    }
    EXPECT_EQ(first, second);
}

TEST_F(CFaceMemory, ListsThatNoMemoryHolds_GiveAStatus) {
    const LookHandle look = newLook();
    const PainterHandle painter = newPainter({look.get()});
    const vorel_glyph glyph = letter();
    Bytes bytes = page();
    const vorel_view target = view(bytes);
    for (const size_t count : {SIZE_MAX, SIZE_MAX / sizeof(vorel_glyph)})
        EXPECT_EQ(vorel_painter_paint(painter.get(), &glyph, count, &target, 0, 0, nullptr),
                  VOREL_NO_MEMORY);
    EXPECT_EQ(bytes, page());
}

}  // namespace
