#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <ostream>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include "allocation_watch.h"
#include "refuse_each.h"
#include "tests/support/compare.h"
#include "tests/support/core_compare.h"
#include "tests/support/fake_core.h"
#include "tests/support/float_states.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/pixel_cases.h"
#include "voreleffect/voreleffect.h"

/// Memory that runs out: every request for memory of every operation is refused once, alone and with
/// all later ones. Whatever happens, nothing is half painted, nothing leaks, and the next call is as
/// good as if nothing had been.
namespace {

using namespace vorel_test;
using namespace VFontEffect;

using Bytes = std::vector<uint8_t>;
using Types = std::set<int>;

std::array<VFGradient, 3> gStops = {
    {{0xFFFF0000, 1.0F, 0.0F}, {0xC000FF00, 1.0F, 0.5F}, {0xFF0000FF, 1.0F, 1.0F}}};

VFBitmap& tile() {
    static VFBitmap bitmap = [] {
        VFBitmap pixels(4, 3, 4);
        for (unsigned char i = 0; i < 48; ++i)
            pixels.mData[i] = static_cast<unsigned char>(255 - 5 * i);
        return pixels;
    }();
    return bitmap;
}

literal::Mask& letter() {
    static literal::Mask mask = discMask(20, 18, 9.0F, 8.0F, 7.0F, true);
    return mask;
}

/// Skips where the build cannot see the library's requests.
class MemoryTest : public ::testing::Test {
  protected:
    void SetUp() override {
        if (!canWatchMemory()) GTEST_SKIP() << "malloc cannot be stood before in this build";
        // Their memory stays: it must not count as a leak of the code that uses them first.
        tile();
        letter();
        EXPECT_THROW(throw std::bad_alloc(), std::bad_alloc);
    }
};

// --- The cores by themselves ------------------------------------------------------------------------

/// A scene as a core takes it.
class Canvas {
  public:
    explicit Canvas(const Scene& scene)
        : mMask(bitmapOf(scene.mask)),
          mDst(bitmapOf(scene.dst)),
          mSub(bitmapOf(scene.sub ? *scene.sub : literal::Picture{})),
          mText(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom),
          mParams{&mDst, &mMask, &mText, scene.useOuterLayer ? 1 : 0, scene.sub ? &mSub : nullptr} {}
    Canvas(const Canvas&) = delete;
    Canvas& operator=(const Canvas&) = delete;

    VFECore::ParamPostProcessing* params() { return &mParams; }
    ::testing::AssertionResult holds(const Scene& scene) const {
        ::testing::AssertionResult same = holds(mDst, scene.dst);
        return same && scene.sub ? holds(mSub, *scene.sub) : same;
    }

  private:
    static ::testing::AssertionResult holds(const VFBitmap& bitmap, const literal::Picture& picture) {
        return sameBytes(picture.bytes.data(), bitmap.mData, picture.width, picture.height, 4);
    }

    VFBitmap mMask;
    VFBitmap mDst;
    VFBitmap mSub;
    VFRect mText;
    VFECore::ParamPostProcessing mParams;
};

struct CoreCase {
    std::string name;
    std::shared_ptr<VFECore> core;
    std::shared_ptr<VFProperty> record;
    std::shared_ptr<VFProperty> other;  ///< paints differently
    bool layered;
    long paintRequests;  ///< what painting asks for; 0 means that it works without memory
    long copyRequests;   ///< what taking a copy of the record asks for

    friend std::ostream& operator<<(std::ostream& out, const CoreCase& c) { return out << c.name; }
};

template <class Core, class Record>
CoreCase coreCase(std::string name, Record record, Record other, bool layered, long paintRequests,
                  long copyRequests) {
    return {std::move(name),
            std::make_shared<Core>(),
            std::make_shared<Record>(record),
            std::make_shared<Record>(other),
            layered,
            paintRequests,
            copyRequests};
}

CoreCase strokeCase(const std::string& name, float radius, int position, bool layered) {
    const bool centred = position == 0;
    const VFStrokeProperty record(centred ? 2 * radius : radius, 0x80402010, 0.5F, 0, position);
    const VFStrokeProperty other(1, 0xFF00FF00, 1, 0, position);
    // What the dilation works in, or both of a centred stroke.
    return coreCase<VFStroke>(name, record, other, layered, 1, 1);
}

std::vector<CoreCase> strokeCases() {
    std::vector<CoreCase> cases;
    const std::string names[] = {"StrokeCentre", "StrokeOutside", "StrokeInside"};
    for (int position = 0; position < 3; ++position) {
        // Larger discs and the smallest ones are dilated by in ways of their own.
        for (const bool layered : {false, true})
            cases.push_back(
                strokeCase(names[position] + (layered ? "Layered" : ""), 3, position, layered));
        cases.push_back(strokeCase("Thin" + names[position], 1.5F, position, false));
        cases.push_back(strokeCase("Wide" + names[position], 20, position, false));
    }
    return cases;
}

template <class Core, class Record>
void addGlowCases(std::vector<CoreCase>& cases, const std::string& name) {
    VFGradient* const stops = gStops.data();
    // What growth works in, and what the blur does; the widest are by differences.
    cases.push_back(coreCase<Core>(name, Record(4, 0xC0FF8000, 0.75F, 0, nullptr),
                                   Record(2, 0xFF0080FF, 1, 0, nullptr), false, 2, 1));
    cases.push_back(coreCase<Core>(name + "WithStops", Record(4, 0, 1, 3, stops),
                                   Record(2, 0, 1, 2, stops), true, 2, 2));
    cases.push_back(coreCase<Core>("Widest" + name, Record(104, 0xC0FF8000, 0.75F, 0, nullptr),
                                   Record(2, 0xFF0080FF, 1, 0, nullptr), false, 2, 1));
    cases.push_back(coreCase<Core>(name + "Layered", Record(4, 0xC0FF8000, 0.75F, 0, nullptr),
                                   Record(2, 0, 1, 2, stops), true, 2, 1));
}

std::vector<CoreCase> coreCases() {
    VFGradient* const stops = gStops.data();
    std::vector<CoreCase> cases = strokeCases();
    addGlowCases<VFOuterGlow, VFOuterGlowProperty>(cases, "OuterGlow");
    addGlowCases<VFInnerGlow, VFInnerGlowProperty>(cases, "InnerGlow");
    // So small that its border, which needs no blur, lies in the picture.
    using InnerGlow = VFInnerGlowProperty;
    cases.push_back(coreCase<VFInnerGlow>("SmallInnerGlow", InnerGlow(1, 0xC0FF8000, 0.75F, 0, nullptr),
                                          InnerGlow(2, 0xFF0080FF, 1, 0, nullptr), false, 2, 1));
    for (const bool layered : {false, true}) {
        const std::string suffix = layered ? "Layered" : "";
        using Outer = VFOuterShadowProperty;
        using Inner = VFInnerShadowProperty;
        using Linear = VFLinearGradientProperty;
        using Radial = VFRadialGradientProperty;
        cases.push_back(coreCase<VFText>("Text" + suffix, VFTextProperty(0x80808080, 0.5F),
                                         VFTextProperty(0xFF204060, 1), layered, 0, 1));
        // Sums of the wide ones take 32 bits; the widest blurs are by differences. All ask for what the
        // blur works in.
        for (const auto& [kind, size] :
             {std::pair("", 3.0F), std::pair("Wide", 10.0F), std::pair("Widest", 100.0F)}) {
            cases.push_back(coreCase<VFOuterShadow>(kind + ("OuterShadow" + suffix),
                                                    Outer(120, 4, size, 0x80202020, 0.5F),
                                                    Outer(30, 2, 0, 0xFFFFFFFF, 1), layered, 1, 1));
            cases.push_back(coreCase<VFInnerShadow>(kind + ("InnerShadow" + suffix),
                                                    Inner(120, 4, size, 0x80202020, 0.5F),
                                                    Inner(30, 2, 0, 0xFFFFFFFF, 1), layered, 1, 1));
        }
        // Moved clear of itself the glyph is drawn by its own coverage, which takes no memory.
        cases.push_back(coreCase<VFInnerShadow>("InnerShadowWholeGlyph" + suffix,
                                                Inner(180, 90, 3, 0x80202020, 0.5F),
                                                Inner(30, 2, 0, 0xFFFFFFFF, 1), layered, 0, 1));
        // Ramps are computed where they are painted.
        cases.push_back(coreCase<VFLinearGradient>("LinearGradient" + suffix, Linear(30, 1, 1, 3, stops),
                                                   Linear(80, 2, 1, 2, stops), layered, 0, 2));
        cases.push_back(coreCase<VFRadialGradient>("RadialGradient" + suffix, Radial(0, 1, 1, 3, stops),
                                                   Radial(0, 2, 1, 2, stops), layered, 0, 2));
        // What the tiling works in.
        cases.push_back(coreCase<VFPattern>("Pattern" + suffix, VFPatternProperty(&tile(), 1.5F, 1),
                                            VFPatternProperty(&tile(), 1, 0.5F), layered, 1, 3));
    }
    return cases;
}

class CoreMemory : public MemoryTest, public ::testing::WithParamInterface<CoreCase> {
  protected:
    CoreMemory() : mCore(*GetParam().core) {
        mScene.mask = discMask(30, 24, 14.0F, 11.0F, 8.0F, true);
        mScene.text = {6, 5, 24, 19};
        mScene.dst = filledPicture(30, 24, 0x40302010);
        mScene.useOuterLayer = GetParam().layered;
        if (GetParam().layered) mScene.sub = filledPicture(30, 24, 0x20100800);
        mCore.setProperty(GetParam().record.get());
    }

    VFECore& mCore;
    Scene mScene;
};

INSTANTIATE_TEST_SUITE_P(EveryCore, CoreMemory, ::testing::ValuesIn(coreCases()),
                         [](const auto& test) { return test.param.name; });

TEST_P(CoreMemory, RefusedWhilePainting_PaintsNothing) {
    const Scene expected = painted(mCore, mScene);
    ASSERT_FALSE(samePaint(mScene, expected)) << "the core must paint when it has memory";
    const long requests = refuseEach(GetParam().name, [&](long n, Refusal refusal) {
        Canvas canvas(mScene);
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            mCore.doPostProcessing(canvas.params());
            refused = RefusedMemory::refused();
        }
        EXPECT_TRUE(canvas.holds(refused ? mScene : expected));
        EXPECT_TRUE(samePaint(expected, painted(mCore, mScene))) << "the next call must be perfect";
        return refused;
    });
    EXPECT_EQ(requests, GetParam().paintRequests);
}

TEST_P(CoreMemory, RefusedWhileCopyingARecord_KeepsTheStoredOne) {
    const Scene first = painted(mCore, mScene);
    const std::vector<int> reach = {mCore.getLeftOffset(), mCore.getTopOffset(), mCore.getRightOffset(),
                                    mCore.getBottomOffset()};
    const VFProperty* const stored = mCore.getProperty();
    bool replaced = false;
    for (const Refusal refusal : kRefusals) {
        for (long n = 1; n <= GetParam().copyRequests; ++n) {
            SCOPED_TRACE("request " + std::to_string(n) + " " + nameOf(refusal));
            const long before = liveBlocks();
            {
                const RefusedMemory no(n, refusal);
                mCore.setProperty(GetParam().other.get());
                replaced = !RefusedMemory::refused();
            }
            EXPECT_FALSE(replaced);
            EXPECT_EQ(before, liveBlocks());
            EXPECT_EQ(stored, mCore.getProperty());
            EXPECT_TRUE(samePaint(first, painted(mCore, mScene)));
            EXPECT_EQ(reach, (std::vector<int>{mCore.getLeftOffset(), mCore.getTopOffset(),
                                               mCore.getRightOffset(), mCore.getBottomOffset()}));
        }
    }
    {
        const RefusedMemory no(GetParam().copyRequests + 1);
        mCore.setProperty(GetParam().record.get());
        replaced = !RefusedMemory::refused();
    }
    EXPECT_TRUE(replaced);
    EXPECT_TRUE(samePaint(first, painted(mCore, mScene)));
}

// --- The pieces -----------------------------------------------------------------------------------

using PieceMemory = MemoryTest;

TEST_F(PieceMemory, BitmapWithoutMemory_KeepsItsNumbersAndHasNoPixels) {
    VFBitmap source(6, 5, 4);
    VFBitmap mask(6, 5, 1);
    Bytes pixels(6 * 5 * 4, 9);
    VFRect crop(1, 1, 5, 4);
    const long before = liveBlocks();
    const auto expectEmpty = [](const VFBitmap& bitmap, unsigned width, unsigned height,
                                unsigned bytes) {
        EXPECT_EQ(nullptr, bitmap.mData);
        EXPECT_EQ(width, bitmap.mWidth);
        EXPECT_EQ(height, bitmap.mHeight);
        EXPECT_EQ(bytes, bitmap.mBytesPerPixel);
    };
    {
        const RefusedMemory no(1, Refusal::kFromThenOn);
        const VFBitmap zeroed(6, 5, 4);
        const VFBitmap filled(6, 5, pixels.data(), 4);
        const VFBitmap copied(source);
        const VFBitmap cropped(mask, &crop);
        VFBitmap assigned;
        assigned = source;
        EXPECT_EQ(5, RefusedMemory::requests());
        expectEmpty(zeroed, 6, 5, 4);
        expectEmpty(filled, 6, 5, 4);
        expectEmpty(copied, 6, 5, 4);
        expectEmpty(cropped, 4, 3, 1);
        expectEmpty(assigned, 6, 5, 4);
    }
    VFBitmap held(2, 2, 1);
    {
        const RefusedMemory no(1);
        held = source;
        expectEmpty(held, 6, 5, 4);
    }
    held = source;
    EXPECT_EQ(bytesOf(source), bytesOf(held));
    EXPECT_EQ(before + 1, liveBlocks()) << "only the pixels of the last assignment are new";
}

TEST_F(PieceMemory, CircleKernelWithoutMemory_StoresNothing) {
    unsigned char untouched = 0;
    unsigned char* kernel = &untouched;
    {
        const RefusedMemory no(1);
        makeCircleKernel(&kernel, 2.0F);
        EXPECT_TRUE(RefusedMemory::refused());
    }
    EXPECT_EQ(&untouched, kernel);
    EXPECT_EQ(5, makeCircleKernel(&kernel, 2.0F));
    ASSERT_NE(&untouched, kernel);
    std::free(kernel);
}

TEST_F(PieceMemory, BoxFilterWithoutMemory_LeavesTheMask) {
    VFOuterGlow outer;
    VFInnerGlow inner;
    Random random(5);
    const Bytes mask = noiseMask(random, 12, 10, 50).bytes;
    Bytes grown = mask;
    outer.increaseByBoxFilter(grown.data(), 2, 12, 10);
    ASSERT_NE(mask, grown);
    for (const bool isOuter : {true, false}) {
        const long requests =
            refuseEach(isOuter ? "outer box filter" : "inner box filter", [&](long n, Refusal refusal) {
                Bytes copy = mask;
                bool refused = false;
                {
                    const RefusedMemory no(n, refusal);
                    if (isOuter)
                        outer.increaseByBoxFilter(copy.data(), 2, 12, 10);
                    else
                        inner.increaseByBoxFilter(copy.data(), 2, 12, 10);
                    refused = RefusedMemory::refused();
                }
                EXPECT_EQ(refused ? mask : grown, copy);
                return refused;
            });
        EXPECT_EQ(1, requests);
    }
}

// --- The effect set ---------------------------------------------------------------------------------

constexpr int kWidth = 40;
constexpr int kHeight = 32;
constexpr uint8_t kBackground = 60;

struct Size {
    int width;
    int height;
};
constexpr Size kSmall = {kWidth, kHeight};
/// Effects paint by turns there.
constexpr Size kLarge = {1024, 2052};

// Type numbers.
constexpr int kOuterShadow = 1;
constexpr int kInnerShadow = 2;
constexpr int kOuterGlow = 3;
constexpr int kInnerGlow = 4;
constexpr int kLinear = 7;
constexpr int kRadial = 8;
constexpr int kStroke = 10;
constexpr int kPattern = 11;
constexpr int kText = 12;
constexpr int kEveryType[] = {kOuterShadow, kInnerShadow, kOuterGlow, kInnerGlow, kLinear,
                              kRadial,      kStroke,      kPattern,   kText};

const char* nameOf(int type) {
    constexpr const char* kNames[] = {
        "",    "outer shadow",    "inner shadow",    "outer glow", "inner glow", "",
        "",    "linear gradient", "radial gradient", "",           "stroke",     "pattern",
        "text"};
    return kNames[type];
}

unsigned addEffect(VFEffect& look, int type, int strokePosition = 1) {
    VFGradient* const stops = gStops.data();
    switch (type) {
        case kOuterShadow:
            return look.addOuterShadowText(120, 4, 3, 0x203040, 0.7F);
        case kInnerShadow:
            return look.addInnerShadowText(300, 2, 2, 0x400000, 0.5F);
        case kOuterGlow:
            return look.addOuterGlowText(4, 0xFFAA00, 0.8F, 3, stops);
        case kInnerGlow:
            return look.addInnerGlowText(3, 0xFFFFFF, 0.4F, 0, nullptr);
        case kLinear:
            return look.addLinearGradientText(30, 1, 0.5F, 3, stops);
        case kRadial:
            return look.addRadialGradientText(1, 0.3F, 2, stops);
        case kStroke:
            return look.addStrokeText(2, 0x00FF00, 0.6F, 0, strokePosition);
        case kPattern:
            return look.addPatternText(&tile(), 1.5F, 0.5F);
        default:
            return look.addText(0x3366CC, 1);
    }
}

/// A look with every effect.
struct Look {
    std::string name;
    float textOpacity;
    int strokePosition;

    void describe(VFEffect& look) const {
        for (const int type : kEveryType)
            addEffect(look, type, strokePosition);
        look.setTextOpacity(textOpacity);
    }
    bool layered() const { return textOpacity < 1 || strokePosition == 0; }
};

const Look kLooks[] = {{"every effect", 1, 1},
                       {"every effect, translucent text", 0.5F, 2},
                       {"every effect, centred stroke", 1, 0}};

/// One run of a look, in its steps.
class OneRun {
  public:
    explicit OneRun(const Size& size = kSmall)
        : mSize(size),
          mDestination(static_cast<unsigned>(size.width), static_cast<unsigned>(size.height), 4) {
        std::memset(mDestination.mData, kBackground, static_cast<size_t>(size.width * size.height * 4));
    }
    void begin(VFEffect& look) {
        look.initEffect(mSize.width, mSize.height);
        render(look);
    }
    void render(VFEffect& look) {
        look.setDstBitmap(&mDestination);
        VFGlyph glyph{letter().bytes.data(), 20, 18};
        look.renderEffectLayer(9, 7, &glyph);
    }
    void end(VFEffect& look) { look.compositeLayers(&mDestination); }
    Bytes bytes() const { return bytesOf(mDestination); }
    bool holds(const Bytes& pixels) const {
        return std::equal(pixels.begin(), pixels.end(), mDestination.mData);
    }

  private:
    Size mSize;
    VFBitmap mDestination;
};

void removeTypes(VFEffect& look, const Types& removed) {
    for (const int type : removed) {
        if (VFECore* const core = look.getEffect(type)) look.removeEffect(core->getId());
    }
}

/// The picture of a whole run. `removed` cores are taken out after the planning, so that the others
/// keep their order and their layers.
Bytes paintedWithout(VFEffect& look, const Types& removed, const Size& size = kSmall) {
    OneRun run(size);
    run.begin(look);
    removeTypes(look, removed);
    look.doEffectPostProcessing();
    run.end(look);
    return run.bytes();
}

Bytes paintedBy(VFEffect& look) {
    return paintedWithout(look, {});
}

::testing::AssertionResult sameRun(const Bytes& expected, const Bytes& actual) {
    return sameBytes(expected.data(), actual.data(), kWidth, kHeight, 4);
}

/// The cores of a planned look in paint order with what each asks for while it paints.
struct PaintRequests {
    int type;
    long requests;
};

std::vector<PaintRequests> paintRequestsOf(const Look& look) {
    const auto requestsWithout = [&](const Types& removed) {
        VFEffect set;
        look.describe(set);
        OneRun run;
        run.begin(set);
        removeTypes(set, removed);
        return requestsOf([&] { set.doEffectPostProcessing(); });
    };
    VFEffect set;
    look.describe(set);
    set.initEffect(kWidth, kHeight);
    std::vector<PaintRequests> all;
    for (VFECore* core : effectsOf(set))
        all.push_back({core->getStyle(), requestsWithout({}) - requestsWithout({core->getStyle()})});
    return all;
}

/// The cores that cannot paint when request `n` is refused.
Types silencedBy(const std::vector<PaintRequests>& cores, long n, Refusal refusal) {
    Types silenced;
    long last = 0;
    for (const PaintRequests& core : cores) {
        const long first = last + 1;
        last += core.requests;
        const bool hit = first <= n && n <= last;
        const bool after = refusal == Refusal::kFromThenOn && n < first && core.requests > 0;
        if (hit || after) silenced.insert(core.type);
    }
    return silenced;
}

using SetMemory = MemoryTest;

TEST_F(SetMemory, RefusedWhileTheCoresPaint_LeavesOutTheirPaintAlone) {
    for (const Look& look : kLooks) {
        const std::vector<PaintRequests> cores = paintRequestsOf(look);
        ASSERT_EQ(std::size(kEveryType), cores.size());
        const auto expected = [&](const Types& silenced) {
            VFEffect set;
            look.describe(set);
            return paintedWithout(set, silenced);
        };
        const Bytes whole = expected({});
        long wanted = 0;
        for (const PaintRequests& core : cores) {
            wanted += core.requests;
            ASSERT_FALSE(sameRun(whole, expected({core.type}))) << nameOf(core.type) << " must show";
        }
        const long requests = refuseEach(look.name, [&](long n, Refusal refusal) {
            VFEffect set;
            look.describe(set);
            OneRun run;
            run.begin(set);
            bool refused = false;
            {
                const RefusedMemory no(n, refusal);
                set.doEffectPostProcessing();
                refused = RefusedMemory::refused();
            }
            run.end(set);
            EXPECT_TRUE(sameRun(expected(silencedBy(cores, n, refusal)), run.bytes()));
            EXPECT_TRUE(sameRun(whole, paintedBy(set))) << "the next run must be perfect";
            return refused;
        });
        EXPECT_EQ(wanted, requests);
        EXPECT_EQ(requests, 8) << "as docs/reliability.md says";
    }
}

// On a large picture effects paint by turns, if there is memory for all of them; if not, one after the
// other.
TEST_F(SetMemory, RefusedWhileTheCoresPaintByTurns_LeavesOutWhatHasNoMemoryByItself) {
    const Look& look = kLooks[2];
    const auto expected = [&](const Types& silenced) {
        VFEffect set;
        look.describe(set);
        return paintedWithout(set, silenced, kLarge);
    };
    const Bytes whole = expected({});
    const Bytes without = expected(silencedBy(paintRequestsOf(look), 1, Refusal::kFromThenOn));
    ASSERT_NE(whole, without);
    const long requests = refuseEach("large picture", [&](long n, Refusal refusal) {
        VFEffect set;
        look.describe(set);
        OneRun run(kLarge);
        run.begin(set);
        bool refused = false;
        {
            const RefusedMemory no(n, refusal);
            set.doEffectPostProcessing();
            refused = RefusedMemory::refused();
        }
        run.end(set);
        const bool isLost = refused && refusal == Refusal::kFromThenOn;
        EXPECT_TRUE(run.holds(isLost ? without : whole));
        return refused;
    });
    EXPECT_EQ(requests, 9) << "as docs/reliability.md says";
}

TEST_F(SetMemory, RefusedWhilePlanning_DrawsNothingAndTheMaskTells) {
    for (const Look& look : kLooks) {
        const Bytes nothing = OneRun().bytes();
        VFEffect sound;
        look.describe(sound);
        const Bytes whole = paintedBy(sound);

        const long requests = refuseEach("planning, " + look.name, [&](long n, Refusal refusal) {
            VFEffect set;
            look.describe(set);
            OneRun run;
            bool refused = false;
            {
                const RefusedMemory no(n, refusal);
                set.initEffect(kWidth, kHeight);
                refused = RefusedMemory::refused();
            }
            const VFBitmap* const mask = set.getSrcBitmap();
            EXPECT_EQ(refused, mask == nullptr || mask->mData == nullptr);
            // Only the mask's own object can be missing: else it has its size, and glyphs grow the box.
            const bool sized = mask != nullptr && mask->mWidth == kWidth && mask->mHeight == kHeight;
            EXPECT_TRUE(sized || n == 1 || refusal == Refusal::kFromThenOn);
            run.render(set);
            set.doEffectPostProcessing();
            run.end(set);
            EXPECT_TRUE(sameRun(refused ? nothing : whole, run.bytes()));
            EXPECT_TRUE(sameRun(whole, paintedBy(set))) << "the next run must be perfect";
            return refused;
        });
        // Object and pixels of each layer.
        EXPECT_EQ(requests, look.layered() ? 4 : 2) << "as docs/reliability.md says";
    }
}

TEST_F(SetMemory, AMaskOfTheCallersDoesNotStandInForTheOuterLayer) {
    for (const Look& look : kLooks) {
        if (!look.layered()) continue;
        VFEffect set;
        look.describe(set);
        OneRun run;
        {
            const RefusedMemory no(3, Refusal::kFromThenOn);
            set.initEffect(kWidth, kHeight);
        }
        delete set.getSrcBitmap();
        set.setSrcBitmap(new VFBitmap(kWidth, kHeight, 1));
        run.render(set);
        set.doEffectPostProcessing();
        run.end(set);
        EXPECT_TRUE(sameRun(OneRun().bytes(), run.bytes()));
    }
}

TEST_F(SetMemory, RefusedWhilePlanningAgain_DropsTheRunBefore) {
    for (const Look& look : kLooks) {
        VFEffect set;
        look.describe(set);
        const Bytes whole = paintedBy(set);
        refuseEach("planning again, " + look.name, [&](long n, Refusal refusal) {
            OneRun givenUp;
            givenUp.begin(set);
            bool refused = false;
            {
                const RefusedMemory no(n, refusal);
                set.initEffect(kWidth, kHeight);
                refused = RefusedMemory::refused();
            }
            set.releaseBitmap();
            EXPECT_TRUE(sameRun(whole, paintedBy(set)));
            return refused;
        });
    }
}

TEST_F(SetMemory, MergingAndGlyphs_TakeNoMemory) {
    for (const Look& look : kLooks) {
        VFEffect set;
        look.describe(set);
        OneRun run;
        set.initEffect(kWidth, kHeight);
        EXPECT_EQ(0, requestsOf([&] { run.render(set); }));
        set.doEffectPostProcessing();
        EXPECT_EQ(0, requestsOf([&] { run.end(set); }));
    }
}

TEST_F(SetMemory, RefusedWhileAdding_PaintsWithoutTheEffectUntilItIsAddedAgain) {
    for (const int type : kEveryType) {
        const int beneath = type == kText ? kStroke : kText;
        const auto picture = [&](bool withIt) {
            VFEffect set;
            addEffect(set, beneath);
            if (withIt) addEffect(set, type);
            return paintedBy(set);
        };
        const Bytes without = picture(false);
        const Bytes with = picture(true);
        ASSERT_FALSE(sameRun(without, with));

        const long requests =
            refuseEach(std::string("adding the ") + nameOf(type), [&](long n, Refusal refusal) {
                VFEffect set;
                VFEffect retried;
                bool refused = false;
                for (VFEffect* each : {&set, &retried}) {
                    addEffect(*each, beneath);
                    unsigned id = 0;
                    {
                        const RefusedMemory no(n, refusal);
                        id = addEffect(*each, type);
                        refused = RefusedMemory::refused();
                    }
                    VFECore* const core = each->getEffect(type);
                    EXPECT_EQ(core != nullptr ? 1U : 0xFFFFFFFFU, id);
                    const bool holdsRecord = core != nullptr && core->getProperty() != nullptr;
                    EXPECT_EQ(refused, !holdsRecord);
                }
                EXPECT_TRUE(sameRun(refused ? without : with, paintedBy(set)));
                EXPECT_EQ(1U, addEffect(retried, type)) << "a failed core takes no id";
                EXPECT_TRUE(sameRun(with, paintedBy(retried)));
                return refused;
            });
        // The core and its record at least.
        EXPECT_GE(requests, 2);
    }
}

TEST_F(SetMemory, RefusedWhileUpdating_KeepsTheOldEffectAndReturnsItsId) {
    const auto update = [](VFEffect& set, int type) {
        return type == kPattern ? set.addPatternText(&tile(), 3, 1) : addEffect(set, type, 2);
    };
    for (const int type : kEveryType) {
        refuseEach(std::string("updating the ") + nameOf(type), [&](long n, Refusal refusal) {
            VFEffect set;
            const unsigned id = addEffect(set, type);
            VFProperty* const old = set.getEffect(type)->getProperty();
            bool refused = false;
            {
                const RefusedMemory no(n, refusal);
                EXPECT_EQ(update(set, type), id);
                refused = RefusedMemory::refused();
            }
            EXPECT_TRUE(!refused || set.getEffect(type)->getProperty() == old);
            return refused;
        });
    }
}

/// In every floating-point state: throwing leaves it as it was, too.
TEST_F(SetMemory, ListThatCannotGrow_ThrowsAndLeavesTheSetAsItWas) {
    for (const FloatState& state : floatStates()) {
        SCOPED_TRACE(state.name);
        for (const int type : kEveryType) {
            VFEffect set;
            const Bytes before = paintedBy(set);
            const long live = liveBlocks();
            bool thrown = false;
            FloatState after = {};
            {
                const RefusedObjects no;
                const InFloatState callers(state);
                try {
                    addEffect(set, type);
                } catch (const std::bad_alloc&) {
                    thrown = true;
                }
                after = currentFloatState();
            }
            EXPECT_TRUE(thrown) << nameOf(type);
            EXPECT_EQ(asThisCpuHasIt(state).control, after.control) << nameOf(type);
            EXPECT_EQ(live, liveBlocks()) << "blocks leak";
            EXPECT_EQ(set.getEffect(type), nullptr);
            EXPECT_TRUE(sameRun(before, paintedBy(set)));
            // Once there is a list it has room for all.
            addEffect(set, type);
            const RefusedObjects no;
            for (const int other : kEveryType)
                EXPECT_NO_THROW(addEffect(set, other));
        }
    }
}

TEST_F(SetMemory, CopyWhoseListCannotBeMade_ThrowsAndLeaksNothing) {
    VFEffect set;
    kLooks[0].describe(set);
    const Bytes before = paintedBy(set);
    const long live = liveBlocks();
    {
        const RefusedObjects no;
        EXPECT_THROW(VFEffect copy(set), std::bad_alloc);
    }
    EXPECT_EQ(live, liveBlocks()) << "blocks leak";
    EXPECT_TRUE(sameRun(before, paintedBy(set)));
}

TEST_F(SetMemory, RefusedWhileCopyingASet_LeavesOutWhatHasNoMemory) {
    for (const Look& look : kLooks) {
        VFEffect set;
        look.describe(set);
        char* const key = set.getMapKey();
        const std::string keyBefore = key;
        delete[] key;
        const auto missingIn = [](VFEffect& copy) {
            Types missing;
            for (const int type : kEveryType) {
                VFECore* const core = copy.getEffect(type);
                if (core == nullptr || core->getProperty() == nullptr) missing.insert(type);
            }
            return missing;
        };
        const long requests = refuseEach("copying, " + look.name, [&](long n, Refusal refusal) {
            std::unique_ptr<VFEffect> copy;
            bool refused = false;
            {
                const RefusedMemory no(n, refusal);
                copy = std::make_unique<VFEffect>(set);
                refused = RefusedMemory::refused();
            }
            const Types missing = missingIn(*copy);
            EXPECT_EQ(refused, !missing.empty());
            EXPECT_TRUE(refusal == Refusal::kFromThenOn || missing.size() <= 1);
            VFEffect expected(set);
            removeTypes(expected, missing);
            EXPECT_TRUE(sameRun(paintedBy(expected), paintedBy(*copy)));
            char* const keyNow = set.getMapKey();
            EXPECT_EQ(keyBefore, keyNow) << "the original must stay as it is";
            delete[] keyNow;
            return refused;
        });
        EXPECT_GE(requests, 2 * static_cast<long>(std::size(kEveryType)));
#ifdef __GLIBCXX__
        EXPECT_EQ(requests, 24) << "as docs/reliability.md says";
#endif
    }
}

TEST_F(SetMemory, RefusedKey_IsNullAndTheNextOneIsRight) {
    const auto keyOf = [](VFEffect& set) {
        char* const key = set.getMapKey(0x102030);
        const std::string text = key != nullptr ? key : "no key";
        delete[] key;
        return text;
    };
    VFEffect sound;
    addEffect(sound, kStroke);
    const std::string expected = keyOf(sound);
    const long requests = refuseEach("key with a colour", [&](long n, Refusal refusal) {
        VFEffect set;
        addEffect(set, kStroke);
        bool refused = false;
        std::string key;
        {
            const RefusedMemory no(n, refusal);
            key = keyOf(set);
            refused = RefusedMemory::refused();
        }
        // The core of the text, its record, the key: only the last is the key's own.
        EXPECT_EQ(n == 3 || (refused && refusal == Refusal::kFromThenOn), key == "no key");
        EXPECT_EQ(!refused, key == expected);
        EXPECT_EQ(expected, keyOf(set));
        return refused;
    });
    EXPECT_EQ(3, requests);
}

}  // namespace
