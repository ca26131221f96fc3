#include "core/float_state.h"
#include "property/sequential_writer.h"
#include "voreleffect/VFProperty.h"

namespace VFontEffect {

using internal::SequentialWriter;

// Deliberate: opacities of gradients, stops, bevel and emboss do not enter the key, and the small fields
// keep 7 bits, the scale of a gradient 8.

namespace {

constexpr int kLetter = SequentialWriter::kLetterChars;
constexpr int kWord = SequentialWriter::kWordChars;
constexpr int kSmall = SequentialWriter::kSmallChars;
constexpr int kAngle = SequentialWriter::kAngleChars;
constexpr int kBytePair = SequentialWriter::kBytePairChars;
constexpr int kQuad = SequentialWriter::kQuadChars;

constexpr int kTextChars = kLetter + kWord;
constexpr int kShadowChars = kLetter + kAngle + 2 * kSmall + kWord;
constexpr int kStrokeChars = kLetter + kSmall + kWord + 2 * kSmall;
constexpr int kGlowChars = kLetter + kSmall + kWord;
constexpr int kGradientChars = kLetter + kAngle + kBytePair;
constexpr int kReliefChars =  // of a bevel or an emboss
    kLetter + kSmall + kBytePair + kQuad + 3 * kSmall + kAngle + kSmall + 2 * kWord;
constexpr int kPatternChars = 17;

/// Characters that a record reserves when it has stops.
int withStops(int fixedChars, int count) {
    return fixedChars + SequentialWriter::kReservedStopChars * SequentialWriter::keptStops(count);
}

/// Lets `write` fill a fragment of whole numbers that starts with `letter`, and moves the cursor past
/// it.
template <class Write>
[[nodiscard]] bool writeWholeFragment(char** cursor, char letter, Write write) {
    if (cursor == nullptr || *cursor == nullptr) return false;
    SequentialWriter writer(*cursor, letter);
    write(writer);
    *cursor = writer.close();
    return true;
}

/// The same for numbers of any kind.
template <class Write>
[[nodiscard]] bool writeFragment(char** cursor, char letter, Write write) {
    const internal::OwnFloatState floatState;
    return writeWholeFragment(cursor, letter, write);
}

template <class Shadow>
[[nodiscard]] bool writeShadow(const Shadow& shadow, char letter, char** cursor) {
    return writeFragment(cursor, letter, [&](SequentialWriter& writer) {
        writer.angle(shadow.mAngle).small(shadow.mDistance).small(shadow.mSize).word(shadow.mColor);
    });
}

template <class Glow>
[[nodiscard]] bool writeGlow(const Glow& glow, char letter, char** cursor) {
    return writeFragment(cursor, letter, [&](SequentialWriter& writer) {
        writer.small(glow.mSize).word(glow.mColor).stops(glow.mGradient, glow.mGradientCount);
    });
}

template <class Gradient>
[[nodiscard]] bool writeGradient(const Gradient& gradient, char letter, char** cursor) {
    return writeFragment(cursor, letter, [&](SequentialWriter& writer) {
        writer.angle(gradient.mAngle)
            .bytePair(gradient.mScale * 100.0F)
            .stops(gradient.mGradient, gradient.mGradientCount);
    });
}

template <class Relief>
[[nodiscard]] bool writeRelief(const Relief& relief, char letter, char** cursor) {
    return writeFragment(cursor, letter, [&](SequentialWriter& writer) {
        writer.small(relief.mStyle)
            .bytePair(relief.mSize)
            .quad(relief.mDepth * 100.0F)
            .small(relief.mTechnique)
            .small(relief.mDirection)
            .small(relief.mSoften)
            .angle(relief.mAngle)
            .small(relief.mAltitude)
            .word(relief.mHighlightColor)
            .word(relief.mShadowColor);
    });
}

}  // namespace

int VFTextProperty::getSequentialCharLength() {
    return kTextChars;
}
bool VFTextProperty::toSequentialChar(char** cursor) {
    return writeWholeFragment(cursor, 'T', [&](SequentialWriter& writer) { writer.word(mColor); });
}

int VFOuterShadowProperty::getSequentialCharLength() {
    return kShadowChars;
}
bool VFOuterShadowProperty::toSequentialChar(char** cursor) {
    return writeShadow(*this, 'S', cursor);
}

int VFInnerShadowProperty::getSequentialCharLength() {
    return kShadowChars;
}
bool VFInnerShadowProperty::toSequentialChar(char** cursor) {
    return writeShadow(*this, 'I', cursor);
}

int VFStrokeProperty::getSequentialCharLength() {
    return kStrokeChars;
}
bool VFStrokeProperty::toSequentialChar(char** cursor) {
    return writeFragment(cursor, 'K', [&](SequentialWriter& writer) {
        writer.small(mSize).word(mColor).small(mStrokeStyle).small(mPosition);
    });
}

int VFOuterGlowProperty::getSequentialCharLength() {
    return withStops(kGlowChars, mGradientCount);
}
bool VFOuterGlowProperty::toSequentialChar(char** cursor) {
    return writeGlow(*this, 'G', cursor);
}

int VFInnerGlowProperty::getSequentialCharLength() {
    return withStops(kGlowChars, mGradientCount);
}
bool VFInnerGlowProperty::toSequentialChar(char** cursor) {
    return writeGlow(*this, 'N', cursor);
}

int VFLinearGradientProperty::getSequentialCharLength() {
    return withStops(kGradientChars, mGradientCount);
}
bool VFLinearGradientProperty::toSequentialChar(char** cursor) {
    return writeGradient(*this, 'L', cursor);
}

int VFRadialGradientProperty::getSequentialCharLength() {
    return withStops(kGradientChars, mGradientCount);
}
bool VFRadialGradientProperty::toSequentialChar(char** cursor) {
    return writeGradient(*this, 'D', cursor);
}

int VFBevelProperty::getSequentialCharLength() {
    return kReliefChars;
}
bool VFBevelProperty::toSequentialChar(char** cursor) {
    return writeRelief(*this, 'B', cursor);
}

int VFEmbossProperty::getSequentialCharLength() {
    return kReliefChars;
}
bool VFEmbossProperty::toSequentialChar(char** cursor) {
    return writeRelief(*this, 'E', cursor);
}

// Deliberate: the pattern reserves characters and writes none, not even the closing zero.
int VFPatternProperty::getSequentialCharLength() {
    return kPatternChars;
}
bool VFPatternProperty::toSequentialChar(char** cursor) {
    return cursor != nullptr && *cursor != nullptr;
}

}  // namespace VFontEffect
