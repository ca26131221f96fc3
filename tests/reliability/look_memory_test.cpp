#include <gtest/gtest.h>
#include <voreleffect/look.h>

#include <cstdint>
#include <new>
#include <optional>
#include <vector>

#include "allocation_watch.h"
#include "refuse_each.h"

/// Memory that runs out in the modern face: describing throws std::bad_alloc, painting says so and has
/// painted nothing.
namespace {

using namespace vorel_test;
using namespace VFontEffect;

constexpr int kSide = 40;
using Bytes = std::vector<unsigned char>;

const unsigned char kTile[] = {255, 0, 0, 255, 0, 255, 0, 255};

/// Two that take no memory of their own while they paint; the lower one needs both layers.
std::vector<Look> plainStack() {
    return {Look().fill(rgb(0xFF0000)).textOpacity(0.5F), Look().fill(rgb(0x0000FF), 0.3F)};
}

Look everything() {
    const std::vector<Stop> ramp = {{rgb(0xFF0000), 1, 0}, {rgb(0x0000FF), 1, 1}};
    return Look()
        .add(OuterShadow(rgb(0x203040)))
        .add(InnerShadow(rgb(0x400000)))
        .add(OuterGlow(4, rgb(0)).stops(ramp))
        .add(InnerGlow(3, rgb(0xFFFFFF)).opacity(0.4F))
        .add(LinearGradient(ramp).opacity(0.5F))
        .add(RadialGradient(ramp).opacity(0.3F))
        .add(Stroke(2, rgb(0x00FF00)).position(Position::centre))
        .add(Pattern({kTile, 2, 1}).opacity(0.5F));
}

/// A glyph that is covered all over.
class Square {
  public:
    explicit Square(int side = 9) : mSide(side), mCoverage(static_cast<size_t>(side * side), 255) {}
    Glyph glyph() const { return {12, 12, mCoverage.data(), mSide, mSide}; }

  private:
    int mSide;
    Bytes mCoverage;
};

class LookMemory : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!canWatchMemory()) GTEST_SKIP() << "malloc cannot be stood before in this build";
        // Its memory stays: it must not count as a leak of the code that throws first.
        EXPECT_THROW(throw std::bad_alloc(), std::bad_alloc);
    }
    PictureView view(Bytes& page) const { return {page.data(), kSide, kSide}; }
    Bytes page() const { return Bytes(size_t{4} * kSide * kSide, 77); }

    const Square mLetter;
};

TEST_F(LookMemory, RefusedWhileAStackIsPainted_LeavesTheViewAsItWas) {
    Bytes whole = page();
    ASSERT_TRUE(paint(plainStack(), mLetter.glyph(), view(whole)));
    int lost = 0;
    refuseEach("painting a stack", [&](long n, Refusal refusal) {
        Painter painter(plainStack());
        Bytes painted = page();
        std::optional<Box> touched;
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            touched = painter.paint(mLetter.glyph(), view(painted));
            refused = RefusedMemory::refused();
        }
        if (!touched && refusal == Refusal::kOnce) ++lost;
        EXPECT_EQ(painter.failure(), touched ? Failure::none : Failure::noMemory);
        EXPECT_EQ(painted, touched ? whole : page());
        Bytes again = page();
        EXPECT_TRUE(painter.paint(mLetter.glyph(), view(again)));
        EXPECT_EQ(again, whole) << "the next run must be perfect";
        return refused;
    });
    EXPECT_EQ(lost, 8)
        << "two layers, and of two requests each two masks and the lower one's outer layer";
}

TEST_F(LookMemory, RefusedWhileAPictureIsPainted_GivesNone) {
    const auto whole = paint(plainStack(), mLetter.glyph());
    ASSERT_TRUE(whole);
    const Bytes wanted(whole->data(), whole->data() + whole->stride() * whole->height());
    int lost = 0;
    refuseEach("painting a picture", [&](long n, Refusal refusal) {
        Painter painter(plainStack());
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            const auto picture = painter.paint(mLetter.glyph());
            refused = RefusedMemory::refused();
            EXPECT_EQ(painter.failure(), picture ? Failure::none : Failure::noMemory);
            if (!picture && refusal == Refusal::kOnce) ++lost;
        }
        const auto again = painter.paint(mLetter.glyph());
        EXPECT_EQ(wanted, Bytes(again->data(), again->data() + again->stride() * again->height()));
        return refused;
    });
    EXPECT_EQ(lost, 8);
}

TEST_F(LookMemory, RefusedWhileEffectsArePainted_LeavesThemOutOrTheViewAsItWas) {
    Bytes whole = page();
    ASSERT_TRUE(paint(everything(), mLetter.glyph(), view(whole)));
    refuseEach("painting every effect", [&](long n, Refusal refusal) {
        Painter painter(everything());
        Bytes painted = page();
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            if (!painter.paint(mLetter.glyph(), view(painted))) {
                EXPECT_EQ(painted, page());
                EXPECT_EQ(painter.failure(), Failure::noMemory);
            }
            refused = RefusedMemory::refused();
        }
        EXPECT_TRUE(refused || painted == whole);
        Bytes again = page();
        EXPECT_TRUE(painter.paint(mLetter.glyph(), view(again)));
        EXPECT_EQ(again, whole) << "the next run must be perfect";
        return refused;
    });
}

/// `step` throws wherever memory is refused, and is as good as ever the next time.
template <class Step>
void expectThrows(const char* what, Step step) {
    const long requests = refuseEach(what, [&](long n, Refusal refusal) {
        bool refused = false;
        bool thrown = false;
        {
            const RefusedMemory no(n, refusal);
            try {
                step();
            } catch (const std::bad_alloc&) {
                thrown = true;
            }
            refused = RefusedMemory::refused();
        }
        EXPECT_EQ(thrown, refused);
        return refused;
    });
    EXPECT_GT(requests, 0);
    const RefusedObjects no;
    EXPECT_THROW(step(), std::bad_alloc);
}

TEST_F(LookMemory, RefusedWhileDescribing_Throws) {
    const Look look = everything();
    expectThrows("a key", [&] { return look.key().size(); });
    expectThrows("margins", [&] { return look.margins().left; });
    expectThrows("a painter", [&] { Painter painter(look); });
    const auto picture = paint(plainStack(), mLetter.glyph());
    const RefusedMemory no(1);
    EXPECT_THROW(Picture copy(*picture), std::bad_alloc);
}

/// Assigning `other` to a copy of `original` throws and leaves it, or succeeds.
template <class Value, class KeyOf>
void expectAllOrNothing(const Value& original, const Value& other, KeyOf keyOf) {
    Value value = original;
    {
        const RefusedObjects no;
        EXPECT_THROW(value = other, std::bad_alloc);
    }
    EXPECT_EQ(keyOf(value), keyOf(original));
    value = other;
    EXPECT_EQ(keyOf(value), keyOf(other));
}

/// Both looks have as many effects: their list has room already.
TEST_F(LookMemory, RefusedWhileAssigned_LeavesWhatWasThere) {
    const std::vector<Stop> none;
    const Look plain = Look()
                           .fill(rgb(9))
                           .add(Stroke(9, rgb(1)))
                           .add(OuterGlow(2, rgb(2)))
                           .add(InnerGlow(2, rgb(3)))
                           .add(OuterShadow(rgb(4)))
                           .add(InnerShadow(rgb(5)))
                           .add(Pattern({kTile, 1, 1}))
                           .add(LinearGradient(none))
                           .add(RadialGradient(none));
    expectAllOrNothing(plain, everything(), [](const Look& look) { return look.key(); });
    const RadialGradient narrow = RadialGradient({{rgb(1)}}).scale(0.3F);
    const RadialGradient wide = RadialGradient({{rgb(2)}, {rgb(3), 1, 1}}).scale(0.7F);
    expectAllOrNothing(narrow, wide, [](const RadialGradient& ramp) { return Look().add(ramp).key(); });
}

TEST_F(LookMemory, OfAPainterThatIsMade_IsAskedForWithoutThrowing) {
    Painter painter({everything(), plainStack()[0]});
    Bytes painted = page();
    const RefusedObjects no;
    EXPECT_TRUE(painter.paint(mLetter.glyph(), view(painted)));
    EXPECT_TRUE(painter.paint(mLetter.glyph()));
}

TEST_F(LookMemory, OfALaterRun_IsThatOfTheClasses) {
    Painter painter(Look().add(OuterShadow(rgb(0))).add(Stroke(4, rgb(0xFFFFFF))));
    Bytes painted = page();
    const Square large(11);
    painter.paint(large.glyph(), view(painted));
    VFEffect set;
    set.addOuterShadowText(135, 4, 4, 0, 1);
    set.addStrokeText(4, 0xFFFFFF, 1, 0, 1);
    set.addText(0, 1);
    const int left = set.getLeftOffset();
    const int top = set.getTopOffset();
    const int width = left + 9 + set.getRightOffset();
    const int height = top + 9 + set.getBottomOffset();
    VFBitmap picture(static_cast<unsigned>(width), static_cast<unsigned>(height), 4);
    const auto paintByClasses = [&] {
        set.initEffect(width, height);
        set.setDstBitmap(&picture);
        VFGlyph glyph = {const_cast<unsigned char*>(mLetter.glyph().coverage), 9, 9};
        set.renderEffectLayer(left, top, &glyph);
        set.doEffectPostProcessing();
        set.compositeLayers(&picture);
    };
    paintByClasses();  // plans, which takes memory of its own
    const long byClasses = requestsOf(paintByClasses);
    for (int i = 0; i < 1000; ++i) {
        const RefusedObjects noObjects;
        ASSERT_EQ(byClasses, requestsOf([&] { painter.paint(mLetter.glyph(), view(painted)); }));
    }
}

}  // namespace
