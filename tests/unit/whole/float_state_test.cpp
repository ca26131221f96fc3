#include <gtest/gtest.h>
#include <voreleffect/voreleffect.h>

#include <array>
#include <cstdint>
#include <cstdlib>
#include <limits>
#include <optional>
#include <string>
#include <vector>

#include "tests/support/both_sets.h"
#include "tests/support/engine.h"
#include "tests/support/float_states.h"
#include "tests/support/mask_gallery.h"

// Whatever floating-point state the caller's thread is in: every public operation that takes or keeps a
// number gives the same bytes, and leaves the state as it was, sticky flags included.

using namespace VFontEffect;
using namespace vorel_test;

namespace {

using Bytes = std::vector<uint8_t>;

constexpr float kInfinity = std::numeric_limits<float>::infinity();
constexpr float kNan = std::numeric_limits<float>::quiet_NaN();

/// Where a state can make a difference: subnormal numbers, halves and their neighbours, numbers whose
/// arithmetic is not exact, limits and what lies beyond them, and those that are none.
const std::array<float, 24> kNumbers = {0.0F,        -0.0F,  1e-40F,     -1e-40F, 0.1F,       0.3333333F,
                                        0.49999997F, 0.5F,   0.75F,      1.0F,    1.4999999F, 2.5F,
                                        7.3F,        33.37F, 64.9999F,   99.99F,  100.0F,     -0.7F,
                                        -45.5F,      4e9F,   359.99997F, -1e30F,  kInfinity,  kNan};

/// What operations gave in one state, and whether they left it as it was.
class Findings {
  public:
    explicit Findings(const FloatState& state) : mState(state) {
        mState.flags = 5;  // two sticky ones that are none of the operation's
        mState = asThisCpuHasIt(mState);
    }

    /// Runs an operation in the state. It must not compute anything itself.
    template <class Operation>
    void of(const std::string& name, Operation operation) {
        FloatState after = {};
        {
            const InFloatState callers(mState);
            operation();
            after = currentFloatState();
        }
        if (!(after == mState)) mChanged += name + ' ';
    }

    template <class Number>
    void note(const Number& number) {
        const auto* const bytes = reinterpret_cast<const uint8_t*>(&number);
        mBytes.insert(mBytes.end(), bytes, bytes + sizeof number);
    }
    void note(const Bytes& bytes) { mBytes.insert(mBytes.end(), bytes.begin(), bytes.end()); }
    void noteText(const char* text) {
        mBytes.insert(mBytes.end(), text, text + std::string(text).size());
    }

    const Bytes& bytes() const { return mBytes; }
    const std::string& changed() const { return mChanged; }

  private:
    FloatState mState;
    Bytes mBytes;
    std::string mChanged;
};

/// Runs the operations in every state; the first one, as a process starts, is what the others must
/// equal.
void expectTheSameInEveryState(void (*operations)(Findings&)) {
    Bytes expected;
    for (const FloatState& state : floatStates()) {
        SCOPED_TRACE(state.name);
        Findings findings(state);
        operations(findings);
        if (expected.empty()) expected = findings.bytes();
        ASSERT_FALSE(expected.empty());
        EXPECT_EQ(findings.changed(), "") << "left another state behind";
        EXPECT_TRUE(expected == findings.bytes());
    }
}

void noteKey(Findings& findings, VFEffect& set) {
    char* key = nullptr;
    findings.of("getMapKey", [&] { key = set.getMapKey(); });
    findings.noteText(key);
    delete[] key;
}

/// The margins and the key of a set, and what a run of it paints.
void noteSet(Findings& findings, VFEffect& set, bool paints = true) {
    int margins[4] = {};
    bool some = false;
    float opacity = 0;
    findings.of("margins", [&] {
        margins[0] = set.getLeftOffset();
        margins[1] = set.getTopOffset();
        margins[2] = set.getRightOffset();
        margins[3] = set.getBottomOffset();
    });
    findings.of("opacity", [&] {
        some = set.hasEffects();
        opacity = set.getTextOpacity();
    });
    for (const int margin : margins)
        findings.note(margin);
    findings.note(some);
    findings.note(opacity);
    if (paints) {
        static literal::Mask mask = discMask(17, 13, 8.0F, 6.5F, 5.5F, true);
        VFBitmap picture(40, 36, 4);
        VFGlyph glyph = {mask.bytes.data(), 17, 13};
        findings.of("initEffect", [&] { set.initEffect(40, 36); });
        findings.of("renderEffectLayer", [&] {
            set.setDstBitmap(&picture);
            set.renderEffectLayer(11, 9, &glyph);
        });
        findings.of("doEffectPostProcessing", [&] { set.doEffectPostProcessing(); });
        findings.of("compositeLayers", [&] { set.compositeLayers(&picture); });
        findings.note(bytesOf(picture));
    }
    noteKey(findings, set);
}

TEST(FloatState, AddCalls) {
    expectTheSameInEveryState([](Findings& findings) {
        Kit<VFEffect> kit;
        kit.stops[0].mOpacity = 0.3333333F;
        kit.stops[1].mLocation = 0.29F;
        for (size_t i = 0; i < kNumbers.size(); ++i) {
            const float a = kNumbers[i];
            const float b = kNumbers[(i + 7) % kNumbers.size()];
            const float c = kNumbers[(i + 13) % kNumbers.size()];
            VFEffect set;
            findings.of("addOuterShadowText", [&] { set.addOuterShadowText(a, b, c, 0x445566, b); });
            findings.of("addInnerShadowText", [&] { set.addInnerShadowText(b, c, a, 0x102030, a); });
            findings.of("addOuterGlowText", [&] { set.addOuterGlowText(c, 0x80FF, a, 3, kit.stops); });
            findings.of("addInnerGlowText", [&] { set.addInnerGlowText(a, 0x80FF, c, 0, nullptr); });
            findings.of("addBevelText",
                        [&] { set.addBevelText(1, a, b, 0, 0, 5, c, a, b, 0x123456, c, 0x654321, a); });
            findings.of("addEmbossText",
                        [&] { set.addEmbossText(1, b, c, 0, 0, 5, a, b, c, 0x123456, a, 0x654321, b); });
            findings.of("addLinearGradientText",
                        [&] { set.addLinearGradientText(a, b, c, 3, kit.stops); });
            findings.of("addRadialGradientText", [&] { set.addRadialGradientText(b, a, 3, kit.stops); });
            findings.of("addStrokeText", [&] { set.addStrokeText(a, 0xE03020, b, 0, 0); });
            findings.of("addPatternText", [&] { set.addPatternText(&kit.tile, c, a); });
            findings.of("addText", [&] { set.addText(0x3060A0, b); });
            findings.of("setTextOpacity", [&] { set.setTextOpacity(c); });
            noteSet(findings, set);
            findings.of("copying", [&] {
                VFEffect copy(set);
                set.clearTextOpacity();
            });
        }
    });
}

/// A record with any numbers in any field, given to its core without an add-call.
template <class Property, class... Arguments>
void noteRecord(Findings& findings, int type, Arguments... arguments) {
    std::optional<Property> record;
    findings.of("constructor", [&] { record.emplace(arguments...); });
    char* cursor = nullptr;
    char text[512] = {};
    findings.of("toSequentialChar", [&] {
        cursor = text;
        record->toSequentialChar(&cursor);
    });
    findings.noteText(text);
    VFEffect set;
    findings.of("addEffect", [&] { set.addEffect(type, &*record); });
    noteSet(findings, set);
    if (VFECore* const core = set.getEffect(type)) {
        float opacity = 0;
        findings.of("core", [&] { opacity = core->getOpacity(); });
        findings.note(opacity);
    }
}

template <class Glow, class Property>
void noteTables(Findings& findings, Property record, float fadeStart) {
    Glow glow;
    findings.of("setProperty", [&] { glow.setProperty(&record); });
    for (int curve = 0; curve < 3; ++curve) {
        unsigned int table[257] = {};
        findings.of("makeColorLUT", [&] { glow.makeColorLUT(table, fadeStart, curve); });
        findings.note(table);
    }
}

TEST(FloatState, HandMadeRecords) {
    expectTheSameInEveryState([](Findings& findings) {
        Kit<VFEffect> kit;
        kit.stops[1].mLocation = 0.0F;  // equal to the one before: the step between them is divided by 0
        for (size_t i = 0; i < kNumbers.size(); ++i) {
            const float a = kNumbers[i];
            const float b = kNumbers[(i + 5) % kNumbers.size()];
            const float c = kNumbers[(i + 11) % kNumbers.size()];
            kit.stops[2].mLocation = b;
            noteRecord<VFOuterShadowProperty>(findings, 1, a, b, c, 0xC0402010, a);
            noteRecord<VFInnerShadowProperty>(findings, 2, b, c, a, 0xC0402010, b);
            noteRecord<VFOuterGlowProperty>(findings, 3, a, 0xC0402010, c, 3, kit.stops);
            noteRecord<VFInnerGlowProperty>(findings, 4, b, 0xC0402010, c, 3, kit.stops);
            noteRecord<VFBevelProperty>(findings, 5, 1, a, b, 0, 0, 3, c, a, b, 1U, c, 2U, a);
            noteRecord<VFEmbossProperty>(findings, 6, 1, b, c, 0, 0, 3, a, b, c, 1U, a, 2U, b);
            noteRecord<VFLinearGradientProperty>(findings, 7, a, b, c, 3, kit.stops);
            noteRecord<VFRadialGradientProperty>(findings, 8, b, a, c, 3, kit.stops);
            for (const int position : {0, 1, 2})
                noteRecord<VFStrokeProperty>(findings, 10, a, 0xC0402010, b, 0, position);
            noteRecord<VFPatternProperty>(findings, 11, &kit.tile, a, b);
            noteRecord<VFTextProperty>(findings, 12, 0xFF102030, a);
            noteTables<VFOuterGlow>(findings, VFOuterGlowProperty(c, 0, 1, 3, kit.stops), a);
            noteTables<VFInnerGlow>(findings, VFInnerGlowProperty(b, 0, 1, 3, kit.stops), a);
        }
    });
}

TEST(FloatState, FreeOperations) {
    expectTheSameInEveryState([](Findings& findings) {
        for (const float radius : kNumbers) {
            unsigned char* disc = nullptr;
            int side = 0;
            findings.of("makeCircleKernel", [&] { side = makeCircleKernel(&disc, radius); });
            findings.note(side);
            if (disc != nullptr) findings.note(Bytes(disc, disc + side * side));
            std::free(disc);
        }
        VFBitmap mask(40, 30, 1);
        fillBytes(mask, 100);
        VFOuterGlow glow;
        findings.of("increaseByBoxFilter", [&] { glow.increaseByBoxFilter(mask.mData, 3, 40, 30); });
        findings.note(bytesOf(mask));
        // The timing switch alone: the number is worked out, no line is printed.
        VFLog::setPrintLogLevel(VFLogTime);
        findings.of("printTime", [&] { VFLog::printTime("tag", "label", 1234567); });
        VFLog::setPrintLogLevel(0xFF);
    });
}

}  // namespace
