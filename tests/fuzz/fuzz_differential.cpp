/// One decoded scene is painted by the library and by the literal form of the same call; a single
/// differing byte ends the program with the scene and the first differing pixels.
#include <gtest/gtest.h>
#include <voreleffect/VFBlender.h>
#include <voreleffect/VFECore.h>
#include <voreleffect/VFEffect.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <initializer_list>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "decoder.h"
#include "level_of_input.h"
#include "paint_cost.h"
#include "pixels.h"
#include "state_of_input.h"
#include "tests/support/compare.h"
#include "tests/support/core_compare.h"
#include "tests/support/literal_blend.h"
#include "tests/support/literal_cores.h"
#include "tests/support/literal_engine.h"

namespace {

using namespace VFontEffect;
namespace literal = vorel_test::literal;
using literal::Mask;
using literal::Picture;
using literal::Stop;
using vorel_fuzz::asCaller;
using vorel_fuzz::Decoder;
using vorel_fuzz::Size;
using vorel_fuzz::WorkBudget;
using vorel_test::libraryStops;
using vorel_test::Scene;

/// Columns for two of the widest vectors and what lies around them.
constexpr int kLongestRow = 200;
constexpr Size kLargestMask = {160, 40};
constexpr double kMostSteps = 2e6;
constexpr double kMostLargeSteps = 4e6;

Size largestMask(const Decoder& in) {
    return in.isLarge() ? Size{vorel_fuzz::kLargeSide, vorel_fuzz::kLargeSide} : kLargestMask;
}

double mostSteps(const Decoder& in) {
    return in.isLarge() ? kMostLargeSteps : kMostSteps;
}

/// The name of the comparison, for the message of a failure.
void require(const testing::AssertionResult& same, const std::string& what) {
    if (same) return;
    std::fprintf(stderr, "%s differs from its literal form: %s\n", what.c_str(), same.message());
    std::abort();
}

/// The name of a core with the numbers that it paints from.
std::string named(const std::string& name, std::initializer_list<float> numbers) {
    std::ostringstream text;
    text.precision(9);
    text << name << " of";
    for (const float number : numbers)
        text << ' ' << number;
    return text.str();
}

template <class T>
void requireEqual(const T& expected, const T& actual, const std::string& what) {
    require(expected == actual ? testing::AssertionSuccess() : testing::AssertionFailure(), what);
}

// --- Operations
// ----------------------------------------------------------------------------------------

/// Runs one operation both ways on copies of one destination.
template <class Library, class Literal>
void compareOperation(const std::string& name, const vorel_test::Placement& p, int bytesPerPixel,
                      const std::vector<uint8_t>& target, Library library, Literal reference) {
    std::vector<uint8_t> expected = target;
    const VFBitmap actual(static_cast<unsigned>(p.dstWidth), static_cast<unsigned>(p.dstHeight),
                          expected.data(), static_cast<unsigned>(bytesPerPixel));
    reference(expected.data());
    library(&actual);
    auto same =
        vorel_test::sameBytes(expected.data(), actual.mData, p.dstWidth, p.dstHeight, bytesPerPixel);
    if (!same) same << "; " << testing::PrintToString(p);
    require(same, name);
}

vorel_test::Placement decodePlacement(Decoder& in) {
    vorel_test::Placement p{};
    p.dstWidth = in.between(1, kLongestRow);
    p.dstHeight = in.between(1, 6);
    p.width = in.between(0, kLongestRow);
    p.height = in.between(0, 6);
    p.x = in.wildInt(-p.width - 2, p.dstWidth + 2);
    p.y = in.wildInt(-p.height - 2, p.dstHeight + 2);
    return p;
}

void compareOperations(Decoder& in) {
    const vorel_test::Placement p = decodePlacement(in);
    const uint32_t color = in.word();
    const int padding = in.between(0, 5);
    VFBlender blender;
    const int operation = in.between(0, 4);
    if (operation == 0) {
        const auto target = vorel_fuzz::decodeCoverage(in, p.dstWidth, p.dstHeight);
        auto mask = vorel_fuzz::decodeCoverage(in, p.width, p.height);
        compareOperation(
            "drawBitmap8To8", p, 1, target,
            [&](const VFBitmap* dst) {
                blender.drawBitmap8To8(p.x, p.y, dst, mask.data(), p.width, p.height);
            },
            [&](uint8_t* dst) {
                literal::drawBitmap8To8(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask.data(), p.width,
                                        p.height);
            });
        return;
    }
    const auto target = vorel_fuzz::decodeColours(in, p.dstWidth, p.dstHeight, 3);
    if (operation == 1) {
        auto mask = vorel_fuzz::decodeCoverage(in, p.width, p.height);
        compareOperation(
            "drawBitmap8To32", p, 4, target,
            [&](const VFBitmap* dst) {
                blender.drawBitmap8To32(p.x, p.y, dst, mask.data(), p.width, p.height, color);
            },
            [&](uint8_t* dst) {
                literal::drawBitmap8To32(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask.data(), p.width,
                                         p.height, color);
            });
        return;
    }
    if (operation == 2) {
        const int mode = in.between(0, 8);
        const int stride = p.width + padding;
        auto mask = vorel_fuzz::decodeCoverage(in, stride, p.height);
        compareOperation(
            "drawBitmapBlend8, mode " + std::to_string(mode), p, 4, target,
            [&](const VFBitmap* dst) {
                blender.drawBitmapBlend8(p.x, p.y, dst, mask.data(), p.width, p.height, stride, color,
                                         mode);
            },
            [&](uint8_t* dst) {
                literal::drawBitmapBlend8(p.x, p.y, dst, p.dstWidth, p.dstHeight, mask.data(), p.width,
                                          p.height, stride, color, mode);
            });
        return;
    }
    if (operation == 3) {
        const int mode = in.between(0, 3);
        const int stride = p.width + padding;
        std::vector<uint32_t> words(static_cast<size_t>(stride) * static_cast<size_t>(p.height));
        vorel_fuzz::fillColours(in, reinterpret_cast<uint8_t*>(words.data()), words.size(), 3);
        compareOperation(
            "drawBitmapBlend32 from words, mode " + std::to_string(mode), p, 4, target,
            [&](const VFBitmap* dst) {
                blender.drawBitmapBlend32(p.x, p.y, dst, words.data(), p.width, p.height, stride, mode);
            },
            [&](uint8_t* dst) {
                literal::drawBitmapBlend32(p.x, p.y, dst, p.dstWidth, p.dstHeight, words.data(), p.width,
                                           p.height, stride, mode);
            });
        return;
    }
    const int order = in.between(0, 2);
    const int stride = p.width * 4 + padding;
    auto bytes = vorel_fuzz::decodeCoverage(in, stride, p.height);
    compareOperation(
        "drawBitmapBlend32 from bytes, order " + std::to_string(order), p, 4, target,
        [&](const VFBitmap* dst) {
            blender.drawBitmapBlend32(p.x, p.y, dst, bytes.data(), p.width, p.height, stride, order);
        },
        [&](uint8_t* dst) {
            literal::drawBitmapBlend32(p.x, p.y, dst, p.dstWidth, p.dstHeight, bytes.data(), p.width,
                                       p.height, stride, order);
        });
}

// --- Arguments of the cores -------------------------------------------------------------------------

/// With a box inside the mask, or anywhere.
Scene decodeScene(Decoder& in) {
    Scene scene;
    const auto [width, height] = vorel_fuzz::decodeSize(in, {1, 1}, largestMask(in));
    scene.mask = Mask{width, height, vorel_fuzz::decodeCoverage(in, width, height)};
    scene.dst = Picture{width, height, vorel_fuzz::decodeColours(in, width, height, 3)};
    if (in.oneIn(4)) {
        scene.sub = Picture{width, height, vorel_fuzz::decodeColours(in, width, height, 3)};
    }
    scene.useOuterLayer = in.flag();
    scene.text = vorel_test::wholeBox(scene.mask);
    if (in.flag()) {
        scene.text.left = in.between(0, width - 1);
        scene.text.top = in.between(0, height - 1);
        scene.text.right = in.between(scene.text.left + 1, width);
        scene.text.bottom = in.between(scene.text.top + 1, height);
    } else if (in.oneIn(4)) {
        scene.text = {in.wildInt(-1, width), in.wildInt(-1, height), in.wildInt(0, width + 1),
                      in.wildInt(0, height + 1)};
    }
    return scene;
}

std::vector<Stop> decodeStops(Decoder& in, int least) {
    const int count = in.oneIn(16) ? in.oneOf({256, 257}) : in.between(least, 6);
    std::vector<Stop> stops;
    for (int i = 0; i < count; ++i) {
        const uint32_t color = in.word();
        const float opacity = in.wildFloat(-0.2F, 1.2F);
        stops.push_back(Stop{color, opacity, in.wildFloat(-0.2F, 1.2F)});
    }
    if (in.flag()) {
        std::stable_sort(stops.begin(), stops.end(), [](const Stop& a, const Stop& b) {
            return !std::isnan(a.location) && (std::isnan(b.location) || a.location < b.location);
        });
    }
    return stops;
}

float decodeAngle(Decoder& in) {
    return in.wildFloat(-720.0F, 720.0F);
}
float decodeDistance(Decoder& in) {
    return in.wildFloat(-20.0F, 50.0F);
}
float decodeSize(Decoder& in) {
    return in.wildFloat(-2.0F, in.oneIn(8) ? 60.0F : 8.0F);
}
float decodeScale(Decoder& in) {
    return in.wildFloat(-0.2F, 3.0F);
}

// --- Cores ------------------------------------------------------------------------------------------

/// Gives the record to a new core and compares its picture, unless both forms would take too long.
/// `reference` is handed the scene and the record as the core holds it.
template <class Core, class Record, class Reference>
void compareCore(Decoder& in, const std::string& name, Record& record, Reference reference) {
    const Scene scene = decodeScene(in);
    Core core;
    asCaller([&] { core.setProperty(&record); });
    if (vorel_fuzz::paintCost(core, scene.mask.width, scene.mask.height) > mostSteps(in)) return;
    const Record& held = *static_cast<Record*>(core.getProperty());
    Scene expected = scene;
    reference(expected, held);
    require(vorel_test::samePaint(expected, asCaller([&] { return vorel_test::painted(core, scene); })),
            name);
}

/// Of a core or a set.
template <class Source>
literal::Margins marginsOf(Source& source) {
    return asCaller([&] {
        return literal::Margins{source.getLeftOffset(), source.getTopOffset(), source.getRightOffset(),
                                source.getBottomOffset()};
    });
}

void requireMargins(const literal::Margins& expected, const literal::Margins& actual,
                    const std::string& what) {
    requireEqual(expected.left, actual.left, what + ", left");
    requireEqual(expected.top, actual.top, what + ", top");
    requireEqual(expected.right, actual.right, what + ", right");
    requireEqual(expected.bottom, actual.bottom, what + ", bottom");
}

literal::Margins evenMargins(int offset) {
    return {offset, offset, offset, offset};
}

void compareStroke(Decoder& in) {
    const float size = decodeSize(in);
    const int position = in.wildInt(0, 3);
    VFStrokeProperty record(size, in.word(), 1.0F, 0, position);
    compareCore<VFStroke>(in, named("stroke", {size, static_cast<float>(position)}), record,
                          [&](Scene& s, const VFStrokeProperty& r) {
                              literal::paintStroke(s.dst, s.sub ? &*s.sub : nullptr, s.mask, s.text,
                                                   s.useOuterLayer, r.mSize, r.mColor, r.mPosition);
                          });
    VFStroke core;
    asCaller([&] { core.setProperty(&record); });
    requireMargins(evenMargins(literal::strokeOffset(size, position)), marginsOf(core),
                   "stroke margins");
}

void compareShadow(Decoder& in) {
    const float angle = decodeAngle(in);
    const float distance = decodeDistance(in);
    const float size = decodeSize(in);
    const uint32_t color = in.word();
    if (in.flag()) {
        VFInnerShadowProperty record(angle, distance, size, color, 1.0F);
        compareCore<VFInnerShadow>(in, named("inner shadow", {angle, distance, size}), record,
                                   [](Scene& s, const VFInnerShadowProperty& r) {
                                       literal::paintInnerShadow(s.dst, s.mask, s.text, r.mAngle,
                                                                 r.mDistance, r.mSize, r.mColor);
                                   });
        return;
    }
    VFOuterShadowProperty record(angle, distance, size, color, 1.0F);
    compareCore<VFOuterShadow>(in, named("outer shadow", {angle, distance, size}), record,
                               [](Scene& s, const VFOuterShadowProperty& r) {
                                   literal::paintOuterShadow(s.dst, s.mask, s.text, r.mAngle,
                                                             r.mDistance, r.mSize, r.mColor);
                               });
    VFOuterShadow core;
    asCaller([&] { core.setProperty(&record); });
    requireMargins(literal::outerShadowMargins(angle, distance, size), marginsOf(core),
                   "outer shadow margins");
}

template <class Core, class Record, class Paint>
void compareGlow(Decoder& in, const std::string& name, Paint paint) {
    const std::vector<Stop> stops = decodeStops(in, 0);
    std::vector<VFGradient> array = libraryStops(stops);
    const float size = decodeSize(in);
    Record record(size, in.word(), 1.0F, static_cast<int>(array.size()), array.data());
    compareCore<Core>(
        in, named(name, {size, static_cast<float>(array.size())}), record,
        [&](Scene& s, const Record& r) { paint(s.dst, s.mask, s.text, r.mSize, r.mColor, stops); });

    Core core;
    asCaller([&] { core.setProperty(&record); });
    requireMargins(evenMargins(literal::glowOffset(size)), marginsOf(core), name + " margins");
    std::vector<uint32_t> table(257);
    const float fade = in.wildFloat(-0.5F, 1.5F);
    const int curve = in.wildInt(0, 3);
    asCaller([&] { core.makeColorLUT(table.data(), fade, curve); });
    requireEqual(literal::glowColours(size, record.mColor, stops, fade, curve), table,
                 name + " colour table");
}

void compareGradient(Decoder& in) {
    const std::vector<Stop> stops = decodeStops(in, 0);
    std::vector<VFGradient> array = libraryStops(stops);
    const auto count = static_cast<int>(array.size());
    const float angle = decodeAngle(in);
    const float scale = decodeScale(in);
    if (in.flag()) {
        VFLinearGradientProperty record(angle, scale, 1.0F, count, array.data());
        compareCore<VFLinearGradient>(in, named("linear gradient", {angle, scale}), record,
                                      [&](Scene& s, const VFLinearGradientProperty& r) {
                                          literal::paintLinearGradient(s.dst, s.mask, s.text, r.mAngle,
                                                                       r.mScale, stops);
                                      });
    } else {
        VFRadialGradientProperty record(angle, scale, 1.0F, count, array.data());
        compareCore<VFRadialGradient>(in, named("radial gradient", {scale}), record,
                                      [&](Scene& s, const VFRadialGradientProperty& r) {
                                          literal::paintRadialGradient(s.dst, s.mask, s.text, r.mScale,
                                                                       stops);
                                      });
    }
}

literal::Tile decodeTile(Decoder& in) {
    literal::Tile tile{in.between(1, 9), in.between(1, 9), {}};
    tile.bytes = vorel_fuzz::decodeColours(in, tile.width, tile.height, 0);
    return tile;
}

VFBitmap bitmapOf(literal::Tile& tile) {
    return VFBitmap(static_cast<unsigned>(tile.width), static_cast<unsigned>(tile.height),
                    tile.bytes.data(), 4);
}

void comparePattern(Decoder& in) {
    literal::Tile tile = decodeTile(in);
    VFBitmap bitmap = bitmapOf(tile);
    const float scale = in.wildFloat(-0.5F, 11.0F);
    VFPatternProperty record(&bitmap, scale, in.wildFloat(-0.2F, 2.0F));
    compareCore<VFPattern>(in, named("pattern", {scale, record.mOpacity}), record,
                           [&](Scene& s, const VFPatternProperty& r) {
                               literal::paintPattern(s.dst, s.mask, s.text, r.mOpacity, r.mScale,
                                                     tile.width, tile.height, tile.bytes);
                           });
}

void comparePieces(Decoder& in) {
    const float radius = in.wildFloat(-1.0F, 30.0F);
    if (!(radius > 200.0F)) {
        unsigned char* weights = nullptr;
        const int side = makeCircleKernel(&weights, radius);
        const std::unique_ptr<unsigned char, void (*)(void*)> owned(weights, std::free);
        const literal::CircleKernel expected = literal::circleKernel(radius);
        requireEqual(expected.side, side, "side of the circle kernel");
        const size_t count =
            weights == nullptr ? 0 : static_cast<size_t>(side) * static_cast<size_t>(side);
        requireEqual(expected.weights, std::vector<uint8_t>(weights, weights + count), "circle kernel");
    }
    const auto [width, height] = vorel_fuzz::decodeSize(in, {0, 0}, largestMask(in));
    const int passes = in.between(0, 12);
    std::vector<uint8_t> expected = vorel_fuzz::decodeCoverage(in, width, height);
    std::vector<uint8_t> actual = expected;
    literal::boxFilter(expected, passes, width, height);
    VFOuterGlow().increaseByBoxFilter(actual.data(), passes, width, height);
    requireEqual(expected, actual, "box filter");
}

// --- Whole runs -------------------------------------------------------------------------------------

/// One look in both forms.
class Pair {
  public:
    explicit Pair(Decoder& in) : mIn(in), mBudget(mostSteps(in)) {}

    void run();

  private:
    void add();
    void changeLook();
    void paint(int width, int height);
    void compareKeys();
    bool affordable(int width, int height);

    Decoder& mIn;
    WorkBudget mBudget;
    VFEffect mReal;
    literal::Engine mLiteral;
};

void Pair::add() {
    const int kind = mIn.oneOf({literal::kOuterShadow, literal::kInnerShadow, literal::kOuterGlow,
                                literal::kInnerGlow, literal::kLinearGradient, literal::kRadialGradient,
                                literal::kStroke, literal::kPattern, literal::kText});
    const float opacity = mIn.wildFloat(-0.2F, 1.2F);
    const uint32_t color = mIn.word();
    unsigned real = 0;
    unsigned expected = 0;
    switch (kind) {
        case literal::kOuterShadow:
        case literal::kInnerShadow: {
            const bool outer = kind == literal::kOuterShadow;
            const float a = decodeAngle(mIn);
            const float d = decodeDistance(mIn);
            const float s = decodeSize(mIn);
            real = asCaller([&] {
                return outer ? mReal.addOuterShadowText(a, d, s, color, opacity)
                             : mReal.addInnerShadowText(a, d, s, color, opacity);
            });
            expected = outer ? mLiteral.addOuterShadowText(a, d, s, color, opacity)
                             : mLiteral.addInnerShadowText(a, d, s, color, opacity);
            break;
        }
        case literal::kOuterGlow:
        case literal::kInnerGlow: {
            const bool outer = kind == literal::kOuterGlow;
            const std::vector<Stop> stops = decodeStops(mIn, 0);
            std::vector<VFGradient> array = libraryStops(stops);
            const auto count = static_cast<int>(stops.size());
            const float s = decodeSize(mIn);
            real = asCaller([&] {
                return outer ? mReal.addOuterGlowText(s, color, opacity, count, array.data())
                             : mReal.addInnerGlowText(s, color, opacity, count, array.data());
            });
            expected = outer ? mLiteral.addOuterGlowText(s, color, opacity, count, stops.data())
                             : mLiteral.addInnerGlowText(s, color, opacity, count, stops.data());
            break;
        }
        case literal::kLinearGradient:
        case literal::kRadialGradient: {
            const bool linear = kind == literal::kLinearGradient;
            const std::vector<Stop> stops = decodeStops(mIn, 1);
            std::vector<VFGradient> array = libraryStops(stops);
            const auto count = static_cast<int>(stops.size());
            const float a = decodeAngle(mIn);
            const float s = decodeScale(mIn);
            real = asCaller([&] {
                return linear ? mReal.addLinearGradientText(a, s, opacity, count, array.data())
                              : mReal.addRadialGradientText(s, opacity, count, array.data());
            });
            expected = linear ? mLiteral.addLinearGradientText(a, s, opacity, count, stops.data())
                              : mLiteral.addRadialGradientText(s, opacity, count, stops.data());
            break;
        }
        case literal::kStroke: {
            const float s = decodeSize(mIn);
            const int style = mIn.wildInt(0, 9);
            const int position = mIn.wildInt(0, 3);
            real = asCaller([&] { return mReal.addStrokeText(s, color, opacity, style, position); });
            expected = mLiteral.addStrokeText(s, color, opacity, style, position);
            break;
        }
        case literal::kPattern: {
            literal::Tile tile = decodeTile(mIn);
            VFBitmap bitmap = bitmapOf(tile);
            const float s = mIn.wildFloat(-0.5F, 11.0F);
            const bool missing = mIn.oneIn(8);
            real =
                asCaller([&] { return mReal.addPatternText(missing ? nullptr : &bitmap, s, opacity); });
            expected = mLiteral.addPatternText(missing ? nullptr : &tile, s, opacity);
            break;
        }
        default:
            real = asCaller([&] { return mReal.addText(color, opacity); });
            expected = mLiteral.addText(color, opacity);
            break;
    }
    requireEqual(expected, real, "id of an effect");
}

void Pair::changeLook() {
    switch (mIn.between(0, 5)) {
        case 0: {
            const int id = mIn.between(-1, 9);
            requireEqual(mLiteral.removeEffect(id), mReal.removeEffect(id), "removing an effect");
            break;
        }
        case 1: {
            const float opacity = mIn.wildFloat(-0.2F, 1.2F);
            asCaller([&] { mReal.setTextOpacity(opacity); });
            mLiteral.setTextOpacity(opacity);
            requireEqual(mLiteral.getTextOpacity(), mReal.getTextOpacity(), "text opacity");
            break;
        }
        case 2:
            mReal.clearTextOpacity();
            mLiteral.clearTextOpacity();
            break;
        case 3:
            if (!mIn.oneIn(4)) break;
            mReal.releaseEffect();
            mLiteral.releaseEffect();
            break;
        case 4: {
            const uint32_t color = mIn.word();
            delete[] asCaller([&] { return mReal.getMapKey(color); });
            mLiteral.getMapKey(color);
            break;
        }
        default:
            add();
            break;
    }
}

void Pair::compareKeys() {
    const std::unique_ptr<char[]> key(asCaller([&] { return mReal.getMapKey(); }));
    requireEqual(mLiteral.getMapKey(), std::string(key.get()), "cache key");
    requireMargins(mLiteral.margins(), marginsOf(mReal), "margins of the set");
}

bool Pair::affordable(int width, int height) {
    double cost = 0.0;
    for (const int kind : vorel_fuzz::kCoreTypes) {
        if (VFECore* const core = mReal.getEffect(kind)) {
            cost += vorel_fuzz::paintCost(*core, width, height);
        }
    }
    return mBudget.spend(cost);
}

void Pair::paint(int width, int height) {
    Picture expected{width, height, vorel_fuzz::decodeColours(mIn, width, height, 3)};
    VFBitmap actual = vorel_test::bitmapOf(expected);
    const auto requireSamePicture = [&](const char* when) {
        require(vorel_test::sameBytes(expected.bytes.data(), actual.mData, width, height, 4), when);
    };
    asCaller([&] { mReal.initEffect(width, height); });
    mLiteral.initEffect(width, height);
    compareKeys();
    mReal.setDstBitmap(&actual);
    mLiteral.setDstBitmap(&expected);
    for (int left = mIn.between(0, 3); left > 0; --left) {
        const int longest = mIn.isLarge() ? 300 : 24;
        Mask glyph{mIn.between(0, longest), mIn.between(0, longest), {}};
        glyph.bytes = vorel_fuzz::decodeCoverage(mIn, glyph.width, glyph.height);
        VFGlyph real{glyph.bytes.data(), static_cast<unsigned short>(glyph.width),
                     static_cast<unsigned short>(glyph.height)};
        const int x = mIn.between(-30, width + 8);
        const int y = mIn.between(-30, height + 8);
        mReal.renderEffectLayer(x, y, &real);
        mLiteral.renderEffectLayer(x, y, &glyph);
    }
    if (mIn.oneIn(4)) changeLook();
    if (affordable(width, height)) {
        asCaller([&] { mReal.doEffectPostProcessing(); });
        mLiteral.doEffectPostProcessing();
        const VFRect& box = *mReal.getTextRect();
        const literal::Box expectedBox = mLiteral.textRect();
        requireEqual(expectedBox.left, box.mLeft, "left of the text box");
        requireEqual(expectedBox.top, box.mTop, "top of the text box");
        requireEqual(expectedBox.right, box.mRight, "right of the text box");
        requireEqual(expectedBox.bottom, box.mBottom, "bottom of the text box");
        requireSamePicture("the destination after post-processing");
    }
    asCaller([&] { mReal.compositeLayers(&actual); });
    mLiteral.compositeLayers(expected);
    requireSamePicture("the destination after the composite");
}

void Pair::run() {
    for (int runs = 0; runs < 4 && !mIn.atEnd(); ++runs) {
        for (int left = mIn.between(0, 5); left > 0; --left)
            changeLook();
        for (int left = mIn.between(0, 3); left > 0; --left)
            add();
        compareKeys();
        const Size size = vorel_fuzz::decodeSize(mIn, {1, 1}, largestMask(mIn));
        paint(size.width, size.height);
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    vorel_fuzz::useLevelOfInput(size);
    vorel_fuzz::useStateOfInput(size);
    // The shared comparisons report some differences as test failures: they end the program, too.
    GTEST_FLAG_SET(break_on_failure, true);
    Decoder in(data, size);
    switch (in.between(0, 15)) {
        case 0:
        case 1:
        case 2:
        case 3:
            compareOperations(in);
            break;
        case 4:
        case 5:
            compareStroke(in);
            break;
        case 6:
        case 7:
            compareShadow(in);
            break;
        case 8:
            compareGlow<VFOuterGlow, VFOuterGlowProperty>(in, "outer glow", literal::paintOuterGlow);
            break;
        case 9:
            compareGlow<VFInnerGlow, VFInnerGlowProperty>(in, "inner glow", literal::paintInnerGlow);
            break;
        case 10:
            compareGradient(in);
            break;
        case 11:
            comparePattern(in);
            break;
        case 12:
            comparePieces(in);
            break;
        default:
            Pair(in).run();
            break;
    }
    return 0;
}
