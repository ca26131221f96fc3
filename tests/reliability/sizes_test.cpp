#include <gtest/gtest.h>

#include <algorithm>
#include <cfloat>
#include <climits>
#include <cstdint>
#include <cstring>
#include <ctime>
#include <functional>
#include <iterator>
#include <limits>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "build_kind.h"
#include "tests/support/compare.h"
#include "tests/support/core_compare.h"
#include "tests/support/guarded.h"
#include "tests/support/literal_cores.h"
#include "tests/support/literal_engine.h"
#include "tests/support/mask_gallery.h"
#include "tests/support/pixel_cases.h"
#include "voreleffect/voreleffect.h"

/// Sizes that lie: numbers that do not fit their buffers, boxes and glyphs at the ends of an int,
/// destinations of another size, numbers that are none. Every mask and every destination ends, and
/// then starts, at an inaccessible page, and every case has a limit of processor time.
namespace {

using namespace vorel_test;
using namespace VFontEffect;
using literal::Box;
using literal::Picture;
using literal::Stop;

constexpr float kNan = std::numeric_limits<float>::quiet_NaN();
constexpr float kInfinite = std::numeric_limits<float>::infinity();
constexpr float kDenormal = std::numeric_limits<float>::denorm_min();

/// Fails when the code of its scope used more processor time than any of these cases may need.
class TimeLimit {
  public:
    TimeLimit() : mStart(std::clock()) {}
    ~TimeLimit() {
        const double seconds = static_cast<double>(std::clock() - mStart) / CLOCKS_PER_SEC;
        EXPECT_LT(seconds, kSanitized || kEmulated ? 30.0 : 2.0) << "seconds of processor time";
    }
    TimeLimit(const TimeLimit&) = delete;
    TimeLimit& operator=(const TimeLimit&) = delete;

  private:
    std::clock_t mStart;
};

// --- Cores with their literal forms -----------------------------------------------------------------

using Stops = std::vector<Stop>;

const Stops kStops = {{0xFFFF0000, 1, 0}, {0x8000FF00, 1, 0.4F}, {0xFF0000FF, 1, 1}};

/// A core with a record, and what it must paint.
struct Painter {
    std::string name;
    std::unique_ptr<VFECore> core;
    std::function<void(Scene&)> literalForm;
};

/// The core of `record`; the literal form is handed the record as the core stored it.
template <class Core, class Record, class LiteralForm>
Painter painter(std::string name, Record record, LiteralForm form) {
    auto core = std::make_unique<Core>();
    core->setProperty(&record);
    const Record stored = *static_cast<Record*>(core->getProperty());
    return {std::move(name), std::move(core), [=](Scene& scene) { form(scene, stored); }};
}

Picture* secondOf(Scene& scene) {
    return scene.sub ? &*scene.sub : nullptr;
}

Painter text() {
    return painter<VFText>("text", VFTextProperty(0x80402010, 0.5F), [](Scene& s, const auto& r) {
        literal::paintText(s.dst, s.mask, s.useOuterLayer, r.mColor);
    });
}

Painter stroke(float size, int position) {
    return painter<VFStroke>("stroke " + std::to_string(position),
                             VFStrokeProperty(size, 0x80402010, 0.5F, 0, position),
                             [](Scene& s, const auto& r) {
                                 literal::paintStroke(s.dst, secondOf(s), s.mask, s.text,
                                                      s.useOuterLayer, r.mSize, r.mColor, r.mPosition);
                             });
}

Painter outerShadow(float angle, float distance, float size) {
    return painter<VFOuterShadow>(
        "outer shadow", VFOuterShadowProperty(angle, distance, size, 0x80402010, 0.5F),
        [](Scene& s, const auto& r) {
            literal::paintOuterShadow(s.dst, s.mask, s.text, r.mAngle, r.mDistance, r.mSize, r.mColor);
        });
}

Painter innerShadow(float angle, float distance, float size) {
    return painter<VFInnerShadow>(
        "inner shadow", VFInnerShadowProperty(angle, distance, size, 0x80402010, 0.5F),
        [](Scene& s, const auto& r) {
            literal::paintInnerShadow(s.dst, s.mask, s.text, r.mAngle, r.mDistance, r.mSize, r.mColor);
        });
}

Painter outerGlow(float size, int count, std::vector<VFGradient> given, const Stops& stops) {
    return painter<VFOuterGlow>(
        "outer glow",
        VFOuterGlowProperty(size, 0xC0FF8000, 0.7F, count, given.empty() ? nullptr : given.data()),
        [stops](Scene& s, const auto& r) {
            literal::paintOuterGlow(s.dst, s.mask, s.text, r.mSize, r.mColor, stops);
        });
}

Painter innerGlow(float size, int count, std::vector<VFGradient> given, const Stops& stops) {
    return painter<VFInnerGlow>(
        "inner glow",
        VFInnerGlowProperty(size, 0xC0FF8000, 0.7F, count, given.empty() ? nullptr : given.data()),
        [stops](Scene& s, const auto& r) {
            literal::paintInnerGlow(s.dst, s.mask, s.text, r.mSize, r.mColor, stops);
        });
}

Painter linearGradient(float angle, float scale, int count, std::vector<VFGradient> given,
                       const Stops& stops) {
    return painter<VFLinearGradient>(
        "linear gradient",
        VFLinearGradientProperty(angle, scale, 1, count, given.empty() ? nullptr : given.data()),
        [stops](Scene& s, const auto& r) {
            literal::paintLinearGradient(s.dst, s.mask, s.text, r.mAngle, r.mScale, stops);
        });
}

Painter radialGradient(float scale, int count, std::vector<VFGradient> given, const Stops& stops) {
    return painter<VFRadialGradient>(
        "radial gradient",
        VFRadialGradientProperty(0, scale, 1, count, given.empty() ? nullptr : given.data()),
        [stops](Scene& s, const auto& r) {
            literal::paintRadialGradient(s.dst, s.mask, s.text, r.mScale, stops);
        });
}

VFBitmap tile() {
    VFBitmap pixels(5, 4, 4);
    for (unsigned char i = 0; i < 80; ++i)
        pixels.mData[i] = static_cast<unsigned char>(255 - 3 * i);
    return pixels;
}

Painter pattern(float scale, float opacity) {
    VFBitmap given = tile();
    const std::vector<uint8_t> bytes = bytesOf(given);
    return painter<VFPattern>(
        "pattern", VFPatternProperty(&given, scale, opacity), [bytes](Scene& s, const auto& r) {
            literal::paintPattern(s.dst, s.mask, s.text, r.mOpacity, r.mScale, 5, 4, bytes);
        });
}

/// One painter of every kind, the stroke in its three positions, with everyday numbers.
std::vector<Painter> everyPainter() {
    std::vector<Painter> all;
    all.push_back(text());
    for (const int position : {0, 1, 2})
        all.push_back(stroke(3, position));
    all.push_back(outerShadow(120, 4, 3));
    all.push_back(innerShadow(120, 4, 3));
    all.push_back(outerGlow(3, 3, libraryStops(kStops), kStops));
    all.push_back(innerGlow(3, 0, {}, {}));
    all.push_back(linearGradient(30, 1, 3, libraryStops(kStops), kStops));
    all.push_back(radialGradient(1, 3, libraryStops(kStops), kStops));
    all.push_back(pattern(1.5F, 0.5F));
    return all;
}

Scene everydayScene() {
    Scene scene = sceneOf(discMask(30, 24, 14.0F, 11.0F, 8.0F, true), {3, 2, 27, 22});
    scene.dst = filledPicture(30, 24, 0x40302010);
    scene.sub = filledPicture(30, 24, 0x20100800);
    return scene;
}

// --- Guarded painting -------------------------------------------------------------------------------

void fill(GuardedBitmap& bitmap, const std::vector<uint8_t>& bytes) {
    std::copy(bytes.begin(), bytes.end(), bitmap.pixels().begin());
}

::testing::AssertionResult holds(GuardedBitmap& bitmap, const Picture& picture) {
    return sameBytes(picture.bytes.data(), bitmap.pixels().data(), picture.width, picture.height, 4);
}

/// Paints the scene between inaccessible pages: the mask and the destinations must hold what the
/// literal form says.
void expectLiteralPaint(Painter& painter, const Scene& scene) {
    SCOPED_TRACE(painter.name + ", " + describe(scene));
    Scene expected = scene;
    painter.literalForm(expected);
    for (const Edge edge : {Edge::kEnd, Edge::kStart}) {
        GuardedBitmap mask(scene.mask.width, scene.mask.height, 1, edge);
        GuardedBitmap dst(scene.dst.width, scene.dst.height, 4, edge);
        const Picture second = scene.sub.value_or(Picture{});
        GuardedBitmap sub(second.width, second.height, 4, edge);
        fill(mask, scene.mask.bytes);
        fill(dst, scene.dst.bytes);
        fill(sub, second.bytes);
        VFRect box(scene.text.left, scene.text.top, scene.text.right, scene.text.bottom);
        VFECore::ParamPostProcessing params{dst.bitmap(), mask.bitmap(), &box,
                                            scene.useOuterLayer ? 1 : 0,
                                            scene.sub ? sub.bitmap() : nullptr};
        {
            const TimeLimit limit;
            painter.core->doPostProcessing(&params);
        }
        EXPECT_EQ(scene.mask.bytes, bytesOf(mask.pixels()));
        EXPECT_TRUE(holds(dst, expected.dst));
        EXPECT_TRUE(holds(sub, expected.sub.value_or(Picture{})));
    }
}

TEST(LyingSizes, TextBoxes_ThatOverflowWhenWidened) {
    constexpr int kLeast = INT_MIN;
    constexpr int kMost = INT_MAX;
    const Box boxes[] = {{kLeast, kLeast, kMost, kMost},
                         {kMost, kMost, kLeast, kLeast},
                         {kLeast, 0, kMost, 24},
                         {0, kLeast, 30, kMost},
                         {0, 0, kMost, kMost},
                         {0, 0, kMost, 24},
                         {0, 0, 30, kMost},
                         {1, 1, kMost, kMost},
                         {-1, -1, kMost, kMost},
                         {kMost - 5, 0, kMost, 5},
                         {0, kMost - 5, 5, kMost},
                         {kMost, kMost, kMost, kMost},
                         {kLeast, kLeast, kLeast, kLeast},
                         {kLeast, 0, kLeast + 5, 5},
                         {kLeast + 5, 0, kLeast, 5},
                         {-5, -5, 0, 0},
                         {29, 23, kMost, kMost},
                         {30, 24, kMost, kMost},
                         {kMost - 29, 0, kMost, 24},
                         {65536, 65536, 131072, 131072}};
    for (Painter& each : everyPainter()) {
        for (const Box& box : boxes) {
            Scene scene = everydayScene();
            scene.text = box;
            expectLiteralPaint(each, scene);
        }
    }
}

TEST(LyingSizes, DestinationsOfAnotherSizeThanTheMask_AreClipped) {
    const std::pair<int, int> sizes[] = {{0, 0},   {1, 1},   {1, 24}, {30, 1},  {29, 24}, {31, 24},
                                         {30, 23}, {30, 25}, {7, 90}, {100, 3}, {64, 64}};
    for (Painter& each : everyPainter()) {
        for (const auto& [width, height] : sizes) {
            for (const bool layered : {false, true}) {
                Scene scene = everydayScene();
                scene.dst = filledPicture(width, height, 0x40302010);
                scene.sub = filledPicture(height, width, 0x20100800);
                scene.useOuterLayer = layered;
                expectLiteralPaint(each, scene);
            }
        }
    }
}

TEST(LyingSizes, MasksOfOneLine_ReachTheirEdges) {
    for (Painter& each : everyPainter()) {
        for (const auto& [width, height] : {std::pair(1, 1), std::pair(300, 1), std::pair(1, 300)}) {
            expectLiteralPaint(each, sceneOf(filledMask(width, height, 200)));
        }
    }
}

TEST(LyingSizes, TargetsThatAreNoColourImages_AreLeftAlone) {
    for (Painter& each : everyPainter()) {
        SCOPED_TRACE(each.name);
        for (const int bytesPerPixel : {0, 1, 2, 3, 5, 8}) {
            const Scene scene = everydayScene();
            GuardedBitmap mask(30, 24, 1);
            fill(mask, scene.mask.bytes);
            GuardedBitmap dst(30, 24, bytesPerPixel);
            std::fill(dst.pixels().begin(), dst.pixels().end(), uint8_t{77});
            VFRect box(3, 2, 27, 22);
            VFECore::ParamPostProcessing params{dst.bitmap(), mask.bitmap(), &box, 0, dst.bitmap()};
            const TimeLimit limit;
            each.core->doPostProcessing(&params);
            EXPECT_EQ(std::vector<uint8_t>(dst.pixels().size(), 77), bytesOf(dst.pixels()))
                << bytesPerPixel << " bytes per pixel";
        }
    }
}

TEST(LyingSizes, BitmapsWhoseByteCountWraps_AreNeitherReadNorWritten) {
    for (Painter& each : everyPainter()) {
        SCOPED_TRACE(each.name);
        GuardedBitmap mask(30, 24, 1);
        GuardedBitmap dst(30, 24, 4);
        std::fill(mask.pixels().begin(), mask.pixels().end(), uint8_t{255});
        VFRect box(3, 2, 27, 22);
        const TimeLimit limit;
        for (const Numbers& numbers : wrappingNumbers(4)) {
            GuardedBitmap lying(1, 1, 4);
            claim(lying.bitmap(), numbers);
            VFECore::ParamPostProcessing params{lying.bitmap(), mask.bitmap(), &box, 1, lying.bitmap()};
            each.core->doPostProcessing(&params);
            EXPECT_EQ(std::vector<uint8_t>(4, 0), bytesOf(lying.pixels()))
                << numbers.width << " x " << numbers.height;
        }
        for (const Numbers& numbers : wrappingNumbers(1)) {
            GuardedBitmap lying(1, 1, 1);
            lying.pixels().data()[0] = 255;
            claim(lying.bitmap(), numbers);
            VFRect wide(0, 0, INT_MAX, INT_MAX);
            for (VFRect* const rect : {&box, &wide}) {
                VFECore::ParamPostProcessing params{dst.bitmap(), lying.bitmap(), rect, 0, nullptr};
                each.core->doPostProcessing(&params);
            }
            EXPECT_EQ(std::vector<uint8_t>(30 * 24 * 4, 0), bytesOf(dst.pixels()))
                << numbers.width << " x " << numbers.height;
        }
    }
}

TEST(LyingSizes, BitmapsBeyondWhatPointersSpan_AreNeitherReadNorWritten) {
    if (sizeof(void*) > 4) GTEST_SKIP() << "pointers span more than a bitmap can count";
    const Numbers colours = {32768, 16384, 4};  // 2^31 bytes
    const Numbers coverage = {65536, 32768, 1};
    for (Painter& each : everyPainter()) {
        SCOPED_TRACE(each.name);
        GuardedBitmap mask(30, 24, 1);
        GuardedBitmap dst(30, 24, 4);
        std::fill(mask.pixels().begin(), mask.pixels().end(), uint8_t{255});
        std::vector<uint8_t> one(4, 255);
        VFBitmap lying(1, 1, 4);
        unsigned char* const own = std::exchange(lying.mData, one.data());
        VFRect box(3, 2, 27, 22);
        claim(&lying, colours);
        VFECore::ParamPostProcessing onto{&lying, mask.bitmap(), &box, 1, &lying};
        each.core->doPostProcessing(&onto);
        EXPECT_EQ(one, std::vector<uint8_t>(4, 255));
        claim(&lying, coverage);
        VFECore::ParamPostProcessing from{dst.bitmap(), &lying, &box, 0, nullptr};
        each.core->doPostProcessing(&from);
        EXPECT_EQ(std::vector<uint8_t>(30 * 24 * 4, 0), bytesOf(dst.pixels()));
        lying.mData = own;
    }
}

TEST(LyingSizes, PatternsWhoseByteCountWraps_PaintNothing) {
    // The numbers whose buffer, of the wrapped count, stays small.
    for (const auto& [width, height] :
         {std::pair(65536U, 65536U), std::pair(65537U, 65537U), std::pair(0x40000000U, 1U),
          std::pair(0x40000001U, 1U), std::pair(1U, 0x40000004U), std::pair(32768U, 32768U)}) {
        SCOPED_TRACE(std::to_string(width) + " x " + std::to_string(height));
        GuardedBuffer pixels(width * height * 4U);
        std::fill(pixels.begin(), pixels.end(), uint8_t{255});
        VFBitmap lying(1, 1, 4);
        unsigned char* const own = std::exchange(lying.mData, pixels.data());
        claim(&lying, {width, height, 4});
        const TimeLimit limit;
        VFPattern core;
        VFPatternProperty record(&lying, 1, 1);
        core.setProperty(&record);
        VFEffect look;
        look.addPatternText(&lying, 1, 1);
        const Scene scene = everydayScene();
        EXPECT_TRUE(paintsNothing(core, scene));
        EXPECT_TRUE(paintsNothing(*look.getEffect(11), scene));
        lying.mData = own;
    }
}

// --- Numbers that are none ---------------------------------------------------------------------------

/// Sizes between the add-calls' limit of 100 and the cores' of 256 pixels are honest, and slow.
const float kOddNumbers[] = {
    kNan,       kInfinite, -kInfinite, FLT_MAX,       -FLT_MAX,       FLT_MIN,       -FLT_MIN, kDenormal,
    -kDenormal, 0.0F,      -0.0F,      0.49999997F,   -0.49999997F,   -0.5F,         -1.0F,    -1.5F,
    257.0F,     1e9F,      -1e9F,      2147483648.0F, -2147483648.0F, 4294967296.0F, 1e20F};

TEST(OddNumbers, InRecords_PaintLikeTheLiteralForm) {
    const Scene scene = everydayScene();
    for (const float odd : kOddNumbers) {
        SCOPED_TRACE(::testing::Message() << odd);
        std::vector<Painter> painters;
        for (const int position : {0, 1, 2, INT_MIN, INT_MAX})
            painters.push_back(stroke(odd, position));
        for (const auto make : {outerShadow, innerShadow}) {
            painters.push_back(make(odd, 4, 3));
            painters.push_back(make(120, odd, 3));
            painters.push_back(make(120, 4, odd));
            painters.push_back(make(odd, odd, odd));
        }
        for (const auto make : {outerGlow, innerGlow}) {
            painters.push_back(make(odd, 0, {}, {}));
            painters.push_back(make(odd, 3, libraryStops(kStops), kStops));
        }
        for (const auto& [angle, scale] : {std::pair(odd, 1.0F), std::pair(30.0F, odd)})
            painters.push_back(linearGradient(angle, scale, 3, libraryStops(kStops), kStops));
        painters.push_back(radialGradient(odd, 3, libraryStops(kStops), kStops));
        painters.push_back(pattern(odd, 1));
        painters.push_back(pattern(1.5F, odd));
        for (Painter& each : painters)
            expectLiteralPaint(each, scene);
    }
}

TEST(OddNumbers, InStops_PaintLikeTheLiteralForm) {
    const Scene scene = everydayScene();
    for (const float odd : kOddNumbers) {
        for (const size_t place : {0U, 1U, 2U}) {
            SCOPED_TRACE(::testing::Message() << odd << " in stop " << place);
            Stops stops = kStops;
            stops[place].location = odd;
            stops[place].opacity = odd;
            for (const auto make : {outerGlow, innerGlow}) {
                Painter glow = make(3, 3, libraryStops(stops), stops);
                expectLiteralPaint(glow, scene);
            }
            Painter linear = linearGradient(30, 1, 3, libraryStops(stops), stops);
            Painter radial = radialGradient(1, 3, libraryStops(stops), stops);
            expectLiteralPaint(linear, scene);
            expectLiteralPaint(radial, scene);
        }
    }
}

TEST(OddNumbers, CountsWithoutStops_CountAsNone) {
    const Scene scene = everydayScene();
    const std::vector<VFGradient> given = libraryStops(kStops);
    struct Lie {
        int count;
        std::vector<VFGradient> stops;
    };
    for (const Lie& lie : {Lie{3, {}}, Lie{INT_MAX, {}}, Lie{-1, {}}, Lie{INT_MIN, {}}, Lie{0, given},
                           Lie{-1, given}, Lie{INT_MIN, given}}) {
        SCOPED_TRACE(std::to_string(lie.count) + " stops of " + std::to_string(lie.stops.size()));
        Painter painters[] = {outerGlow(3, lie.count, lie.stops, {}),
                              innerGlow(3, lie.count, lie.stops, {}),
                              linearGradient(30, 1, lie.count, lie.stops, {}),
                              radialGradient(1, lie.count, lie.stops, {})};
        for (Painter& each : painters)
            expectLiteralPaint(each, scene);
    }
}

TEST(OddNumbers, CountsThatLie_StayInsideTheKey) {
    for (const int count : {3, 100000, -1, INT_MIN}) {
        const TimeLimit limit;
        VFEffect look;
        VFOuterGlowProperty glow(3, 0x11223344, 1, count, nullptr);
        VFLinearGradientProperty gradient(30, 1, 1, count, nullptr);
        look.addEffect(3, &glow);
        look.addEffect(7, &gradient);
        char* const key = look.getMapKey();
        ASSERT_NE(nullptr, key);
        // Letter, size and colour; letter, angle and scale; no stops.
        EXPECT_EQ(1U + 1U + 8U + 1U + 2U + 2U, std::strlen(key)) << count;
        delete[] key;
    }
}

TEST(OddNumbers, AddCalls_ReadNoMoreThan256Stops) {
    GuardedBuffer bytes(256 * sizeof(VFGradient));
    std::vector<VFGradient> stops(256, VFGradient{0xFFFFFF, 1, 0.5F});
    std::memcpy(bytes.data(), stops.data(), bytes.size());
    auto* const given = reinterpret_cast<VFGradient*>(bytes.data());
    for (const int count : {256, 257, INT_MAX}) {
        VFEffect look;
        look.addOuterGlowText(3, 0, 1, count, given);
        look.addInnerGlowText(3, 0, 1, count, given);
        look.addLinearGradientText(0, 1, 1, count, given);
        look.addRadialGradientText(1, 1, count, given);
        const auto* const glow = static_cast<VFOuterGlowProperty*>(look.getEffect(3)->getProperty());
        EXPECT_EQ(256, glow->mGradientCount);
    }
}

// --- Runs -------------------------------------------------------------------------------------------

constexpr int kWidth = 40;
constexpr int kHeight = 32;
constexpr uint32_t kBackground = 0x40302010;

/// One look with every effect in both forms.
class Looks {
  public:
    explicit Looks(float size, float textOpacity = 1, int strokePosition = 1) {
        const auto describe = [&](auto& look, auto* stops, auto* tile) {
            look.addOuterShadowText(120, size, size, 0x203040, 0.7F);
            look.addInnerShadowText(300, 2, size, 0x400000, 0.5F);
            look.addOuterGlowText(size, 0xFFAA00, 0.8F, 3, stops);
            look.addInnerGlowText(size, 0xFFFFFF, 0.4F, 3, stops);
            look.addLinearGradientText(30, 1, 0.5F, 3, stops);
            look.addRadialGradientText(1, 0.3F, 3, stops);
            look.addStrokeText(size, 0x00FF00, 0.6F, 0, strokePosition);
            look.addPatternText(tile, 1.5F, 0.5F);
            look.addText(0x3366CC, 1);
            look.setTextOpacity(textOpacity);
        };
        std::vector<VFGradient> stops = libraryStops(kStops);
        VFBitmap pixels = tile();
        const literal::Tile literalTile{5, 4, bytesOf(pixels)};
        describe(set, stops.data(), &pixels);
        describe(engine, kStops.data(), &literalTile);
    }

    VFEffect set;
    literal::Engine engine;
};

/// Calls `check` with every mode's looks: plain, translucent text, centred stroke.
template <class Check>
void withLooks(float size, Check check) {
    for (const auto& [opacity, position] :
         {std::pair(1.0F, 1), std::pair(0.5F, 2), std::pair(1.0F, 0)}) {
        SCOPED_TRACE("opacity " + std::to_string(opacity) + ", stroke " + std::to_string(position));
        Looks looks(size, opacity, position);
        check(looks);
    }
}

/// A glyph whose coverage ends at an inaccessible page.
class GuardedGlyph {
  public:
    GuardedGlyph(int width, int height)
        : mPixels(static_cast<size_t>(width) * static_cast<size_t>(height)),
          mGlyph{mPixels.data(), static_cast<unsigned short>(width),
                 static_cast<unsigned short>(height)} {
        for (size_t i = 0; i < mPixels.size(); ++i)
            mPixels.data()[i] = static_cast<uint8_t>(255 - i % 97);
    }
    VFGlyph* glyph() { return &mGlyph; }
    literal::Mask mask() const { return {mGlyph.mWidth, mGlyph.mHeight, bytesOf(mPixels)}; }

  private:
    GuardedBuffer mPixels;
    VFGlyph mGlyph;
};

struct Place {
    int x, y;
};

/// A run in both forms, the real one with a guarded mask and destination. A `near` glyph stands in the
/// layer and `far` at `place`; the literal form gets it at `literalPlace`.
void compareRuns(Looks& looks, GuardedGlyph& far, Place place, Place literalPlace) {
    SCOPED_TRACE("glyph at " + std::to_string(place.x) + ", " + std::to_string(place.y));
    GuardedGlyph near(9, 7);
    literal::Mask nearMask = near.mask();
    literal::Mask farMask = far.mask();
    Picture expected = filledPicture(kWidth, kHeight, kBackground);
    GuardedBitmap dst(kWidth, kHeight, 4);
    fill(dst, expected.bytes);

    looks.engine.initEffect(kWidth, kHeight);
    looks.engine.setDstBitmap(&expected);
    looks.engine.renderEffectLayer(12, 10, &nearMask);
    looks.engine.renderEffectLayer(literalPlace.x, literalPlace.y, &farMask);
    looks.engine.doEffectPostProcessing();
    looks.engine.compositeLayers(expected);

    const TimeLimit limit;
    looks.set.initEffect(kWidth, kHeight);
    looks.set.setDstBitmap(dst.bitmap());
    VFBitmap* const ownMask = looks.set.getSrcBitmap();
    GuardedBitmap mask(kWidth, kHeight, 1);
    looks.set.setSrcBitmap(mask.bitmap());
    looks.set.renderEffectLayer(12, 10, near.glyph());
    looks.set.renderEffectLayer(place.x, place.y, far.glyph());
    looks.set.doEffectPostProcessing();
    std::copy(mask.pixels().begin(), mask.pixels().end(), ownMask->mData);
    looks.set.setSrcBitmap(ownMask);
    looks.set.compositeLayers(dst.bitmap());
    EXPECT_TRUE(holds(dst, expected));
}

TEST(LyingRuns, GlyphsAtTheEndsOfAnInt_OnlyWidenTheBox) {
    constexpr int kBeyond = 100000;  // as good as the end of an int, for layers of this size
    GuardedGlyph far(3, 3);
    withLooks(3, [&](Looks& looks) {
        for (const int x : {INT_MIN, INT_MIN + 1, -3, 12, INT_MAX - 3, INT_MAX}) {
            for (const int y : {INT_MIN, INT_MIN + 1, -3, 10, INT_MAX - 3, INT_MAX}) {
                compareRuns(looks, far, {x, y},
                            {std::clamp(x, -kBeyond, kBeyond), std::clamp(y, -kBeyond, kBeyond)});
            }
        }
    });
}

TEST(LyingRuns, GlyphsOfTheLargestSizes_AreClipped) {
    GuardedGlyph wide(USHRT_MAX, 1);
    GuardedGlyph tall(1, USHRT_MAX);
    GuardedGlyph noWidth(0, USHRT_MAX);
    GuardedGlyph noHeight(USHRT_MAX, 0);
    withLooks(3, [&](Looks& looks) {
        for (GuardedGlyph* const each : {&wide, &tall, &noWidth, &noHeight}) {
            for (const Place place : {Place{0, 0}, Place{5, 5}, Place{-USHRT_MAX + 6, 4},
                                      Place{3, -USHRT_MAX + 6}, Place{-USHRT_MAX, -USHRT_MAX}}) {
                compareRuns(looks, *each, place, place);
            }
        }
    });
}

TEST(LyingRuns, LayersThatCannotBeMade_LeaveTheDestination) {
    const Place sizes[] = {{0, 0},         {-1, 10},           {10, -1},     {INT_MIN, INT_MIN},
                           {INT_MIN, 10},  {INT_MAX, INT_MAX}, {INT_MAX, 3}, {3, INT_MAX},
                           {65536, 65536}, {65537, 65537},     {0, INT_MAX}, {INT_MAX, 0}};
    withLooks(3, [&](Looks& looks) {
        for (const auto& [width, height] : sizes) {
            SCOPED_TRACE(std::to_string(width) + " x " + std::to_string(height));
            const TimeLimit limit;
            GuardedBitmap dst(kWidth, kHeight, 4);
            GuardedGlyph glyph(9, 7);
            looks.set.initEffect(width, height);
            looks.set.setDstBitmap(dst.bitmap());
            looks.set.renderEffectLayer(4, 5, glyph.glyph());
            looks.set.doEffectPostProcessing();
            looks.set.compositeLayers(dst.bitmap());
            EXPECT_EQ(std::vector<uint8_t>(kWidth * kHeight * 4, 0), bytesOf(dst.pixels()));
        }
    });
}

TEST(LyingRuns, MasksHandedInWithWrappedNumbers_LeaveTheDestination) {
    withLooks(3, [&](Looks& looks) {
        for (const auto& [width, height] : {std::pair(65536U, 65536U), std::pair(65537U, 65537U)}) {
            const TimeLimit limit;
            GuardedBitmap dst(kWidth, kHeight, 4);
            GuardedGlyph glyph(9, 7);
            looks.set.initEffect(kWidth, kHeight);
            looks.set.setDstBitmap(dst.bitmap());
            delete looks.set.getSrcBitmap();
            looks.set.setSrcBitmap(new VFBitmap(width, height, 1));
            looks.set.renderEffectLayer(4, 5, glyph.glyph());
            looks.set.doEffectPostProcessing();
            looks.set.compositeLayers(dst.bitmap());
            EXPECT_EQ(std::vector<uint8_t>(kWidth * kHeight * 4, 0), bytesOf(dst.pixels()));
        }
    });
}

TEST(LyingRuns, DestinationsOfAnotherSize_AreClippedAndNotMerged) {
    const std::pair<int, int> sizes[] = {
        {0, 0},   {1, 1},   {kWidth - 1, kHeight}, {kWidth, kHeight - 1},
        {90, 70}, {400, 3}, {kHeight, kWidth},     {kWidth / 2, 2 * kHeight}};
    withLooks(3, [&](Looks& looks) {
        for (const auto& [width, height] : sizes) {
            SCOPED_TRACE(std::to_string(width) + " x " + std::to_string(height));
            const TimeLimit limit;
            GuardedGlyph glyph(9, 7);
            literal::Mask mask = glyph.mask();
            Picture expected = filledPicture(width, height, kBackground);
            GuardedBitmap dst(width, height, 4);
            fill(dst, expected.bytes);

            looks.engine.initEffect(kWidth, kHeight);
            looks.engine.setDstBitmap(&expected);
            looks.engine.renderEffectLayer(12, 10, &mask);
            looks.engine.doEffectPostProcessing();
            looks.set.initEffect(kWidth, kHeight);
            looks.set.setDstBitmap(dst.bitmap());
            looks.set.renderEffectLayer(12, 10, glyph.glyph());
            looks.set.doEffectPostProcessing();
            EXPECT_TRUE(holds(dst, expected));
            looks.set.compositeLayers(dst.bitmap());
            EXPECT_TRUE(holds(dst, expected)) << "another size must not be merged";
        }
    });
}

TEST(LyingRuns, DestinationsOfOneBytePerPixel_AreLeftAlone) {
    withLooks(3, [&](Looks& looks) {
        GuardedBitmap dst(kWidth, kHeight, 1);
        GuardedGlyph glyph(9, 7);
        looks.set.initEffect(kWidth, kHeight);
        looks.set.setDstBitmap(dst.bitmap());
        looks.set.renderEffectLayer(4, 5, glyph.glyph());
        looks.set.doEffectPostProcessing();
        looks.set.compositeLayers(dst.bitmap());
        EXPECT_EQ(std::vector<uint8_t>(kWidth * kHeight, 0), bytesOf(dst.pixels()));
    });
}

TEST(LyingRuns, LargestSizesOfTheAddCalls_StayInTime) {
    constexpr float kLargest = kEmulated ? 30.0F : 100.0F;
    GuardedGlyph far(30, 20);
    withLooks(kLargest, [&](Looks& looks) { compareRuns(looks, far, {6, 8}, {6, 8}); });
}

}  // namespace
