/// Any sequence of public calls on up to three effect sets, with arguments far outside their ranges,
/// some of them while memory runs out. A finding is whatever a sanitizer reports, or an input that takes
/// seconds.
#include <voreleffect/VFBlender.h>
#include <voreleffect/VFECore.h>
#include <voreleffect/VFEffect.h>
#include <voreleffect/VFLog.h>
#include <voreleffect/VFProperty.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdarg>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "decoder.h"
#include "level_of_input.h"
#include "paint_cost.h"
#include "pixels.h"
#include "tests/reliability/allocation_watch.h"
#include "tests/support/fake_core.h"
#include "tests/support/literal_engine.h"

namespace {

using namespace VFontEffect;
namespace literal = vorel_test::literal;
using vorel_fuzz::decodeBitmap;
using vorel_fuzz::Decoder;
using vorel_fuzz::decodeSize;
using vorel_fuzz::kLongestSide;
using vorel_fuzz::paintCost;
using vorel_fuzz::Size;
using vorel_fuzz::WorkBudget;

// The types that have a record and no core, and the one that is placed by a stroke's record.
constexpr int kBevel = 5;
constexpr int kEmboss = 6;
constexpr int kReservedStroke = 9;

constexpr Size kLargestPattern = {9, 9};
constexpr int kMostCalls = 80;
constexpr double kMostSteps = 8e6;
constexpr double kMostLargeSteps = 4e7;
constexpr int kMostKeyBytes = 1 << 20;
constexpr size_t kMostCores = 24;
constexpr size_t kLongestTag = 256;

/// Lines of the log since the last call that may print one.
int gLogged = 0;

/// A record made by hand with the array or bitmap that it points to.
struct Record {
    std::vector<VFGradient> stops;
    std::unique_ptr<VFBitmap> pattern;
    std::unique_ptr<VFProperty> property;
};

/// A core of the caller's own, of any type, that keeps its record and paints nothing.
class ForeignCore : public VFECoreBase {
  public:
    ForeignCore(int type, Record record) : mRecord(std::move(record)) { mEffectType = type; }

    void setProperty(VFProperty* /*property*/) override {}
    VFProperty* getProperty() override { return mRecord.property.get(); }

  private:
    Record mRecord;
};

class Caller {
  public:
    Caller(const uint8_t* data, size_t size)
        : mIn(data, size),
          mBudget(mIn.isLarge() ? kMostLargeSteps : kMostSteps),
          mLongestSide(mIn.isLarge() ? vorel_fuzz::kLargeSide : kLongestSide) {
        for (auto& set : mSets)
            set = std::make_unique<VFEffect>();
    }

    void run();

  private:
    using Call = void (Caller::*)();

    // --- Arguments ------------------------------------------------------------------------------

    VFEffect& set() { return *mSets[mCurrent]; }
    Size largestLayer() const { return {mLongestSide, mLongestSide}; }
    float angle() { return mIn.wildFloat(-720.0F, 720.0F); }
    float distance() { return mIn.wildFloat(-20.0F, 40.0F); }
    float size() { return mIn.wildFloat(-2.0F, mIn.oneIn(8) ? 110.0F : 9.0F); }
    float opacity() { return mIn.wildFloat(-0.25F, 1.25F); }
    float scale() { return mIn.wildFloat(-0.5F, 3.0F); }
    int id() { return mIn.wildInt(-1, 12); }
    int type() { return mIn.wildInt(-1, 15); }

    std::vector<VFGradient> stops() {
        const int count = mIn.oneIn(16) ? mIn.oneOf({255, 256, 257, 300}) : mIn.between(0, 6);
        std::vector<VFGradient> all;
        for (int i = 0; i < count; ++i) {
            all.push_back(VFGradient{mIn.word(), opacity(), mIn.wildFloat(-0.2F, 1.2F)});
        }
        return all;
    }

    /// A count that the array, or its absence, can answer for.
    int countOf(const std::vector<VFGradient>& stops, bool hasArray) {
        if (!hasArray) return mIn.wildInt(-3, 300);
        if (mIn.oneIn(16)) return mIn.oneOf({-1, 0, INT_MIN});
        return mIn.oneIn(8) ? mIn.between(0, static_cast<int>(stops.size()))
                            : static_cast<int>(stops.size());
    }

    /// The same for an add-call, which reads 256 stops at most.
    int callCountOf(const std::vector<VFGradient>& stops, bool hasArray) {
        if (stops.size() >= 256 && mIn.flag()) return INT_MAX;
        return countOf(stops, hasArray);
    }

    Record record(int type);
    VFBitmap* keep(std::unique_ptr<VFBitmap> bitmap);
    VFBitmap* destination();

    // --- Calls ----------------------------------------------------------------------------------

    void addShadow();
    void addGlow();
    void addRelief();
    void addGradient();
    void addStroke();
    void addPattern();
    void addFill();
    void addRecord();
    void remove();
    void copySet();
    void freshSet();
    void changeOpacity();
    void plan();
    void giveMask();
    void giveDestination();
    void drawGlyph();
    void postProcess();
    void composite();
    void takeKey();
    void query();
    void driveCore();
    void looseCore();
    void glowPieces();
    void strokePieces();
    void bitmapPieces();
    void wholeRun();
    void pairedRun();
    void foreignCore();
    void refusedCall();
    void log();

    Decoder mIn;
    WorkBudget mBudget;
    int mLongestSide;
    std::array<std::unique_ptr<VFEffect>, 3> mSets;
    size_t mCurrent = 0;
    // Destinations must live until their run has ended; some runs never end.
    std::vector<std::unique_ptr<VFBitmap>> mBitmaps;
};

// --- Arguments --------------------------------------------------------------------------------------

/// The record class that belongs to the type; text for a type without one.
Record Caller::record(int type) {
    Record r;
    const float opacityValue = opacity();
    const uint32_t color = mIn.word();
    switch (type) {
        case literal::kOuterShadow:
            r.property.reset(
                new VFOuterShadowProperty{angle(), distance(), size(), color, opacityValue});
            return r;
        case literal::kInnerShadow:
            r.property.reset(
                new VFInnerShadowProperty{angle(), distance(), size(), color, opacityValue});
            return r;
        case literal::kStroke:
            r.property.reset(
                new VFStrokeProperty{size(), color, opacityValue, mIn.wildInt(0, 9), mIn.wildInt(0, 3)});
            return r;
        case kBevel:
            r.property.reset(new VFBevelProperty{mIn.wildInt(0, 3), size(), scale(), mIn.wildInt(0, 3),
                                                 mIn.wildInt(0, 3), mIn.wildInt(0, 20), opacityValue,
                                                 angle(), angle(), color, opacity(), color, opacity()});
            return r;
        case kEmboss:
            r.property.reset(new VFEmbossProperty{mIn.wildInt(0, 3), size(), scale(), mIn.wildInt(0, 3),
                                                  mIn.wildInt(0, 3), mIn.wildInt(0, 20), opacityValue,
                                                  angle(), angle(), color, opacity(), color, opacity()});
            return r;
        case literal::kPattern:
            r.pattern = decodeBitmap(mIn, decodeSize(mIn, {1, 1}, kLargestPattern), 4);
            r.property.reset(new VFPatternProperty{r.pattern.get(), scale(), opacityValue});
            return r;
        default:
            break;
    }
    const bool hasArray = !mIn.oneIn(8);
    if (hasArray) r.stops = stops();
    // An array of no stops is an array nevertheless.
    static VFGradient none{0, 0.0F, 0.0F};
    VFGradient* array = r.stops.empty() ? &none : r.stops.data();
    if (!hasArray) array = nullptr;
    const int count = countOf(r.stops, hasArray);
    switch (type) {
        case literal::kOuterGlow:
            r.property.reset(new VFOuterGlowProperty{size(), color, opacityValue, count, array});
            break;
        case literal::kInnerGlow:
            r.property.reset(new VFInnerGlowProperty{size(), color, opacityValue, count, array});
            break;
        case literal::kLinearGradient:
            r.property.reset(new VFLinearGradientProperty{angle(), scale(), opacityValue, count, array});
            break;
        case literal::kRadialGradient:
            r.property.reset(new VFRadialGradientProperty{angle(), scale(), opacityValue, count, array});
            break;
        default:
            r.property.reset(new VFTextProperty{color, opacityValue});
            break;
    }
    return r;
}

VFBitmap* Caller::keep(std::unique_ptr<VFBitmap> bitmap) {
    mBitmaps.push_back(std::move(bitmap));
    return mBitmaps.back().get();
}

/// A destination, mostly of the size of the layers; now and then one that an earlier call has used.
VFBitmap* Caller::destination() {
    if (!mBitmaps.empty() && mIn.flag()) {
        return mBitmaps[static_cast<size_t>(mIn.between(0, static_cast<int>(mBitmaps.size()) - 1))]
            .get();
    }
    Size size = decodeSize(mIn, {0, 0}, largestLayer());
    const VFBitmap* const mask = set().getSrcBitmap();
    const auto longest = static_cast<unsigned>(mLongestSide);
    if (mask != nullptr && mask->mWidth <= longest && mask->mHeight <= longest) {
        size = {static_cast<int>(mask->mWidth), static_cast<int>(mask->mHeight)};
    }
    return keep(decodeBitmap(mIn, size, 4));
}

// --- Add-calls --------------------------------------------------------------------------------------

void Caller::addShadow() {
    const bool outer = mIn.flag();
    const float a = angle();
    const float d = distance();
    const float s = size();
    const uint32_t color = mIn.word();
    if (outer) {
        set().addOuterShadowText(a, d, s, color, opacity());
    } else {
        set().addInnerShadowText(a, d, s, color, opacity());
    }
}

void Caller::addGlow() {
    const bool outer = mIn.flag();
    const bool hasArray = !mIn.oneIn(8);
    std::vector<VFGradient> all;
    if (hasArray) all = stops();
    const int count = callCountOf(all, hasArray);
    const float s = size();
    const uint32_t color = mIn.word();
    if (outer) {
        set().addOuterGlowText(s, color, opacity(), count, all.data());
    } else {
        set().addInnerGlowText(s, color, opacity(), count, all.data());
    }
}

void Caller::addRelief() {
    const bool bevel = mIn.flag();
    const int style = mIn.wildInt(0, 3);
    const float s = size();
    const int soften = mIn.wildInt(-1, 20);
    const float a = angle();
    const float depth = scale();
    const float o = opacity();
    const uint32_t highlight = mIn.word();
    const float highlightOpacity = opacity();
    const uint32_t shadow = mIn.word();
    const float shadowOpacity = opacity();
    if (bevel) {
        set().addBevelText(style, s, depth, style, soften, soften, o, a, a, highlight, highlightOpacity,
                           shadow, shadowOpacity);
    } else {
        set().addEmbossText(style, s, depth, style, soften, soften, o, a, a, highlight, highlightOpacity,
                            shadow, shadowOpacity);
    }
}

void Caller::addGradient() {
    const bool linear = mIn.flag();
    const bool hasArray = !mIn.oneIn(8);
    std::vector<VFGradient> all;
    if (hasArray) all = stops();
    const int count = callCountOf(all, hasArray);
    const float ramp = scale();
    if (linear) {
        const float a = angle();
        set().addLinearGradientText(a, ramp, opacity(), count, all.data());
    } else {
        set().addRadialGradientText(ramp, opacity(), count, all.data());
    }
}

void Caller::addStroke() {
    const float s = size();
    const uint32_t color = mIn.word();
    const float o = opacity();
    const int style = mIn.wildInt(0, 9);
    set().addStrokeText(s, color, o, style, mIn.wildInt(0, 3));
}

void Caller::addPattern() {
    const auto pattern = decodeBitmap(mIn, decodeSize(mIn, {1, 1}, kLargestPattern), 4);
    const float s = mIn.wildFloat(-0.5F, 11.0F);
    set().addPatternText(pattern.get(), s, opacity());
}

void Caller::addFill() {
    const uint32_t color = mIn.word();
    set().addText(color, opacity());
}

// --- Registry ---------------------------------------------------------------------------------------

void Caller::addRecord() {
    const int kind = type();
    Record r = record(kind);
    VFProperty* const property = mIn.oneIn(8) ? nullptr : r.property.get();
    if (mIn.flag()) {
        set().addEffect(kind, property);
    } else {
        set().addEffect(id(), kind, property);
    }
}

void Caller::remove() {
    switch (mIn.between(0, 7)) {
        case 0:
            set().releaseEffect();
            break;
        case 1:
            set().cleanAllEffect();
            break;
        case 2:
            set().releaseBitmap();
            break;
        case 3:
            set().cleanLayers();
            break;
        default:
            set().removeEffect(id());
            break;
    }
}

void Caller::copySet() {
    const auto to = static_cast<size_t>(mIn.between(0, 2));
    mSets[to] = std::make_unique<VFEffect>(set());
    mCurrent = to;
}

void Caller::freshSet() {
    mSets[mCurrent] = mIn.flag() ? std::make_unique<VFEffect>() : std::make_unique<VFEffect>(&mIn);
}

void Caller::changeOpacity() {
    if (mIn.oneIn(4)) {
        set().clearTextOpacity();
    } else {
        set().setTextOpacity(opacity());
    }
}

// --- Runs -------------------------------------------------------------------------------------------

void Caller::plan() {
    const int width = mIn.wildInt(0, mLongestSide);
    set().initEffect(width, mIn.wildInt(0, mLongestSide));
}

void Caller::giveMask() {
    auto mask = decodeBitmap(mIn, decodeSize(mIn, {0, 0}, largestLayer()), 1);
    const std::unique_ptr<VFBitmap> previous(set().getSrcBitmap());
    set().setSrcBitmap(mask.release());
}

void Caller::giveDestination() {
    set().setDstBitmap(destination());
}

void Caller::drawGlyph() {
    const int x = mIn.wildInt(-mLongestSide, mLongestSide);
    const int y = mIn.wildInt(-mLongestSide, mLongestSide);
    if (mIn.oneIn(16)) return set().renderEffectLayer(x, y, nullptr);
    const int longest = mIn.isLarge() ? mLongestSide : 40;
    const int width = mIn.oneIn(16) ? 65535 : mIn.between(0, longest);
    const int height =
        mIn.oneIn(16) && width < 2 ? 65535 : mIn.between(0, width > longest ? 1 : longest);
    std::vector<uint8_t> pixels = vorel_fuzz::decodeCoverage(mIn, width, height);
    VFGlyph glyph{mIn.oneIn(16) ? nullptr : pixels.data(), static_cast<unsigned short>(width),
                  static_cast<unsigned short>(height)};
    set().renderEffectLayer(x, y, &glyph);
}

/// Skipped when the effects are too large for the glyphs to be painted in milliseconds.
void Caller::postProcess() {
    double cost = 1.0;
    if (const VFBitmap* const mask = set().getSrcBitmap()) {
        const VFRect box = *set().getTextRect();
        const auto length = [](int from, int to, unsigned room) {
            const double first = std::clamp<double>(from, 0.0, room);
            return std::max(0.0, std::clamp<double>(to, 0.0, room) - first);
        };
        const double width = length(box.mLeft, box.mRight, mask->mWidth);
        const double height = length(box.mTop, box.mBottom, mask->mHeight);
        for (const int kind : vorel_fuzz::kCoreTypes) {
            VFECore* const core = set().getEffect(kind);
            if (core != nullptr && width * height > 0) cost += paintCost(*core, width, height);
        }
    }
    if (!mBudget.spend(cost)) return;
    set().doEffectPostProcessing();
}

void Caller::composite() {
    VFBitmap* const target = mIn.flag() ? set().getDstBitmap() : destination();
    set().compositeLayers(target);
}

/// Skipped when the records reserve more than a key can use.
void Caller::takeKey() {
    double reserved = 0.0;
    for (const int kind : vorel_fuzz::kCoreTypes) {
        VFECore* const core = set().getEffect(kind);
        if (core == nullptr || core->getProperty() == nullptr) continue;
        reserved += core->getProperty()->getSequentialCharLength();
    }
    if (reserved > kMostKeyBytes) return;
    char* const key = mIn.flag() ? set().getMapKey() : set().getMapKey(mIn.word());
    if (key == nullptr && !vorel_test::RefusedMemory::refused()) std::abort();
    if (key != nullptr && std::strlen(key) > size_t{kMostKeyBytes}) std::abort();
    delete[] key;
}

void Caller::query() {
    set().getLeftOffset();
    set().getRightOffset();
    set().getTopOffset();
    set().getBottomOffset();
    set().hasEffects();
    set().getTextOpacity();
    set().getNewEffectId();
    set().getDstBitmap();
    if (set().getTextRect() == nullptr) std::abort();
    set().isUnderEffect(nullptr);
    VFECore* const core = set().getEffect(type());
    if (core == nullptr) return;
    set().isUnderEffect(core);
    core->getOpacity();
    core->getOffset();
    core->setId(id());
    core->setProperty(mIn.flag() ? core->getProperty() : nullptr);
}

// --- Cores by hand ----------------------------------------------------------------------------------

/// A core of the set paints from parameters that the set would never make.
void Caller::driveCore() {
    VFECore* const core = set().getEffect(mIn.between(1, 12));
    if (core == nullptr) return;
    const Size size = decodeSize(mIn, {0, 0}, largestLayer());
    const auto mask = decodeBitmap(mIn, size, 1);
    const auto target = decodeBitmap(mIn, size, 4);
    const auto second = decodeBitmap(mIn, size, 4);
    VFRect box(0, 0, size.width, size.height);
    if (mIn.flag()) {
        box = VFRect{mIn.wildInt(-1, size.width), mIn.wildInt(-1, size.height),
                     mIn.wildInt(0, size.width + 1), mIn.wildInt(0, size.height + 1)};
    }
    VFECore::ParamPostProcessing params = {target.get(), mask.get(), mIn.oneIn(16) ? nullptr : &box,
                                           mIn.wildInt(0, 1), second.get()};
    VFECore::ParamInit init = {size.width, size.height, params.useOuterLayer};
    VFECore::ParamRender draw = {box.mLeft, box.mTop, nullptr, target.get()};
    core->initEffect(mIn.flag() ? &init : nullptr);
    core->render(mIn.flag() ? &draw : nullptr);
    // A bitmap of another size has sides of kLongestSide at most.
    if (!mBudget.spend(
            paintCost(*core, std::max(size.width, kLongestSide), std::max(size.height, kLongestSide)))) {
        return;
    }
    core->doPostProcessing(mIn.oneIn(16) ? nullptr : &params);
}

/// A core in no list, and the text of a record, whether its kind has a core or not.
void Caller::looseCore() {
    const int kind = type();
    const Record r = record(kind);
    const int reserved = std::min(r.property->getSequentialCharLength(), kMostKeyBytes);
    std::vector<char> text(static_cast<size_t>(reserved) + 1);
    char* cursor = text.data();
    r.property->toSequentialChar(mIn.oneIn(8) ? nullptr : &cursor);
    if (cursor > &text.back()) std::abort();

    VFECore* const core = set().createEffect(id(), kind, nullptr);
    if (core != nullptr) {
        core->setProperty(r.property.get());
        set().isUnderEffect(core);
    }
    set().releaseEffect(core);
}

void Caller::glowPieces() {
    VFOuterGlow outer;
    VFInnerGlow inner;
    Record r = record(literal::kOuterGlow);
    outer.setProperty(r.property.get());
    std::vector<unsigned int> table(257);
    const float fade = mIn.wildFloat(-0.5F, 1.5F);
    const int curve = mIn.wildInt(0, 3);
    outer.makeColorLUT(table.data(), fade, curve);
    outer.makeColorLUT(nullptr, fade, curve);
    inner.makeColorLUT(table.data(), fade, curve);

    const int width = mIn.between(0, mLongestSide);
    const int height = mIn.between(0, mLongestSide);
    std::vector<uint8_t> mask = vorel_fuzz::decodeCoverage(mIn, width, height);
    const int passes = mIn.oneIn(8) ? mIn.oneOf({-1, 0, INT_MIN}) : mIn.between(0, 9);
    outer.increaseByBoxFilter(mask.data(), passes, width, height);
    inner.increaseByBoxFilter(mIn.oneIn(8) ? nullptr : mask.data(), passes, width, height);
}

/// The dilation routines with exactly the memory that the numbers ask for; then one number is changed
/// to another that asks for no more.
void Caller::strokePieces() {
    const float size = mIn.wildFloat(-1.0F, 12.0F);
    const double side = 2.0 * static_cast<double>(std::fabs(size)) + 3.0;
    unsigned char* kernel = nullptr;
    // Weights beyond these would take seconds, or are refused.
    if (side < 1e3 || !(side < 1e5)) {
        makeCircleKernel(nullptr, size);
        makeCircleKernel(&kernel, size);
    }
    const std::unique_ptr<unsigned char, void (*)(void*)> owned(kernel, std::free);
    if (kernel == nullptr || side > 32.0) return;

    const int radius = makeCircleKernel(nullptr, size) / 2;
    const int width = mIn.between(1, 24);
    const int height = mIn.between(0, 24);
    if (!mBudget.spend(2.0 * width * height * side * side)) return;
    std::vector<uint8_t> source = vorel_fuzz::decodeCoverage(mIn, width, height);
    const int planeWidth = width + 2 * radius + mIn.between(0, 3);
    const int planeHeight = height + 2 * radius + mIn.between(0, 3);
    std::vector<uint8_t> planes(static_cast<size_t>(planeWidth) * static_cast<size_t>(planeHeight) * 2);
    VFStroke::DilationWork work = {planes.data(), source.data(),  kernel, width,  height, planeWidth,
                                   planeHeight,   2 * radius + 1, 0,      height, radius};
    switch (mIn.between(0, 7)) {
        case 0:
            work.plane = nullptr;
            break;
        case 1:
            work.kernel = nullptr;
            break;
        case 2:
            work.radius = mIn.oneOf({radius + 1, radius - 1, -1, INT_MIN, INT_MAX});
            break;
        case 3:
            work.kernelSide = mIn.wildInt(-1, 2 * radius);
            if (work.kernelSide == 2 * radius + 1) work.kernelSide = 0;
            break;
        case 4:
            work.sourceWidth = std::min(mIn.wildInt(-1, width), width);
            break;
        case 5:
            work.sourceHeight = std::min(mIn.wildInt(-1, height), height);
            break;
        default:
            work.firstRow = mIn.wildInt(-1, height);
            work.endRow = mIn.wildInt(-1, height + 1);
            break;
    }
    VFStroke::partalDTStrokeCenter(&work);
    VFStroke::partalDTStrokeOutside(&work);
    VFStroke::partalDTStrokeInside(mIn.oneIn(8) ? nullptr : &work);
}

void Caller::bitmapPieces() {
    const Size size = decodeSize(mIn, {0, 0}, largestLayer());
    const auto source = decodeBitmap(mIn, size, mIn.oneOf({1, 4}));
    if (source == nullptr) return;
    VFRect box{mIn.wildInt(-1, size.width), mIn.wildInt(-1, size.height), mIn.wildInt(0, size.width + 1),
               mIn.wildInt(0, size.height + 1)};
    const VFBitmap crop(*source, mIn.oneIn(8) ? nullptr : &box);
    const VFBitmap copy(*source);
    VFBitmap assigned(3, 3, 4);
    assigned = copy;
    const VFBitmap& itself = assigned;
    assigned = itself;
    const VFBitmap fromData(copy.mWidth, copy.mHeight, copy.mData, copy.mBytesPerPixel);
    if (copy.mData == nullptr && fromData.mData != nullptr) std::abort();
    const int x = mIn.wildInt(-2, size.width);
    const int y = mIn.wildInt(-2, size.height);
    VFBlender().drawBitmap(x, y, &crop, &assigned, mIn.word());
}

/// What a caller does for one run, so that few bytes already paint.
void Caller::wholeRun() {
    addFill();
    const Size size = decodeSize(mIn, {1, 1}, largestLayer());
    set().initEffect(size.width, size.height);
    set().setDstBitmap(destination());
    for (int left = mIn.between(1, 3); left > 0; --left)
        drawGlyph();
    postProcess();
    set().compositeLayers(set().getDstBitmap());
}

/// The runs of two sets that paint into one picture, and perhaps through one mask.
void Caller::pairedRun() {
    VFEffect& first = set();
    const size_t other = (mCurrent + 1) % mSets.size();
    VFEffect& second = *mSets[other];
    const Size size = decodeSize(mIn, {1, 1}, largestLayer());
    VFBitmap* const picture = destination();
    for (VFEffect* const each : {&first, &second}) {
        each->initEffect(size.width, size.height);
        each->setDstBitmap(picture);
    }
    for (int left = mIn.between(1, 3); left > 0; --left) {
        if (mIn.flag()) mCurrent = other;
        drawGlyph();
    }
    VFBitmap* const own = second.getSrcBitmap();
    if (mIn.flag()) second.setSrcBitmap(first.getSrcBitmap());
    postProcess();
    mCurrent = (mCurrent + 1) % mSets.size();
    postProcess();
    second.setSrcBitmap(own);
    first.compositeLayers(picture);
    second.compositeLayers(picture);
}

/// Puts a core of the caller's own into the list, with a record of its type, or asks about it only.
void Caller::foreignCore() {
    const int kind = type();
    const bool hasRecord = !mIn.oneIn(8);
    auto core = std::make_unique<ForeignCore>(
        kind, hasRecord ? record(kind == kReservedStroke ? int{literal::kStroke} : kind) : Record());
    core->setId(id());
    set().isUnderEffect(core.get());
    if (mIn.flag()) return;
    // Else a set of thousands of cores would take longer than its input is worth.
    std::vector<VFECore*>& list = vorel_test::effectsOf(set());
    if (list.size() < kMostCores) list.push_back(core.release());
}

/// A call to which one request for memory is refused, or that one and all that follow.
void Caller::refusedCall() {
    constexpr Call kCalls[] = {&Caller::addRecord,   &Caller::addRecord,   &Caller::addGlow,
                               &Caller::addPattern,  &Caller::copySet,     &Caller::plan,
                               &Caller::wholeRun,    &Caller::wholeRun,    &Caller::postProcess,
                               &Caller::takeKey,     &Caller::driveCore,   &Caller::looseCore,
                               &Caller::glowPieces,  &Caller::pairedRun,   &Caller::bitmapPieces,
                               &Caller::addGradient, &Caller::strokePieces};
    constexpr int kLastCall = static_cast<int>(sizeof kCalls / sizeof kCalls[0]) - 1;
    const Call call = kCalls[mIn.between(0, kLastCall)];
    const int first = mIn.between(1, 48);
    const vorel_test::RefusedMemory refused(
        first, mIn.flag() ? vorel_test::Refusal::kFromThenOn : vorel_test::Refusal::kOnce);
    (this->*call)();
}

/// Texts of any length at any level, through every format of the log.
void Caller::log() {
    const auto text = [this] {
        return std::string(
            static_cast<size_t>(mIn.oneIn(4) ? mIn.between(250, 1100) : mIn.between(0, 9)),
            static_cast<char>(mIn.between(' ', '~')));
    };
    const std::string tagText = text();
    const std::string message = text();
    const char* const tag = mIn.oneIn(8) ? nullptr : tagText.c_str();
    const char* const format = mIn.oneIn(8) ? nullptr : "%s";
    const auto microseconds = static_cast<long>(mIn.wildInt(0, 1000000));
    VFLog();
    VFLog::setPrintLogLevel(mIn.byte());
    gLogged = 0;
    switch (mIn.between(0, 2)) {
        case 0:
            VFLog::printLog(static_cast<VFLogLevel>(mIn.wildInt(0, 31)), tag, format, message.c_str());
            break;
        case 1:
            VFLog::printTime(tag, mIn.oneIn(8) ? nullptr : message.c_str(), microseconds);
            break;
        default:
            VFLog::printTime(tag, mIn.oneIn(8) ? nullptr : tagText.c_str(), microseconds, format,
                             message.c_str());
            break;
    }
    // One line a call at most; a tag that is too long prints none.
    if (gLogged > (tag != nullptr && tagText.size() >= kLongestTag ? 0 : 1)) std::abort();
    VFLog::setPrintLogLevel(0xFF);
}

void Caller::run() {
    constexpr Call kCalls[] = {
        &Caller::addShadow,     &Caller::addGlow,     &Caller::addRelief,    &Caller::addGradient,
        &Caller::addStroke,     &Caller::addPattern,  &Caller::addFill,      &Caller::addRecord,
        &Caller::addRecord,     &Caller::remove,      &Caller::copySet,      &Caller::freshSet,
        &Caller::changeOpacity, &Caller::plan,        &Caller::giveMask,     &Caller::giveDestination,
        &Caller::drawGlyph,     &Caller::drawGlyph,   &Caller::postProcess,  &Caller::composite,
        &Caller::takeKey,       &Caller::query,       &Caller::driveCore,    &Caller::driveCore,
        &Caller::looseCore,     &Caller::glowPieces,  &Caller::strokePieces, &Caller::bitmapPieces,
        &Caller::wholeRun,      &Caller::wholeRun,    &Caller::pairedRun,    &Caller::foreignCore,
        &Caller::refusedCall,   &Caller::refusedCall, &Caller::log};
    constexpr int kLastCall = static_cast<int>(sizeof kCalls / sizeof kCalls[0]) - 1;
    for (int calls = 0; calls < kMostCalls && !mIn.atEnd(); ++calls) {
        if (mIn.oneIn(16)) mCurrent = (mCurrent + 1) % mSets.size();
        (this->*kCalls[mIn.between(0, kLastCall)])();
    }
}

}  // namespace

// In the place of Android's function: the library finds it in the running program.
extern "C" __attribute__((visibility("default"), format(printf, 3, 4))) int __android_log_print(
    int priority, const char* tag, const char* format, ...);

extern "C" int __android_log_print(int priority, const char* tag, const char* format, ...) {
    char text[4096];
    va_list arguments;
    va_start(arguments, format);
    const int length = std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    ++gLogged;
    // "[tag] message \n": a tag of less than 256 characters, a message of less than 1024.
    const bool complete = length > 0 && length < 256 + 1024 + 5 && text[length - 1] == '\n';
    if (!complete || priority < 3 || priority > 6 || std::strcmp(tag, "vfeffect") != 0) std::abort();
    return length;
}

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    vorel_fuzz::useLevelOfInput(size);
    Caller(data, size).run();
    return 0;
}
