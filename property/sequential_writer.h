#pragma once

#include <algorithm>
#include <cstdint>
#include <limits>

#include "core/numeric.h"
#include "property/limits.h"
#include "voreleffect/VFBitmap.h"

namespace VFontEffect::internal {

/// Writes one fragment of the cache key. Every field but the type letter carries its bits in the low
/// bits of characters whose top bit is set, so no character is zero. Closing the fragment stores a
/// zero byte behind it, which the next fragment overwrites.
class SequentialWriter {
  public:
    static constexpr int kLetterChars = 1;
    static constexpr int kWordChars = 8;
    static constexpr int kSmallChars = 1;
    static constexpr int kAngleChars = 2;
    static constexpr int kBytePairChars = 2;
    static constexpr int kQuadChars = 4;

    /// Deliberate: a stop reserves one character more than it writes.
    static constexpr int kReservedStopChars = kWordChars + kSmallChars + 1;

    /// The stop count cut to what a fragment can reserve characters for: its length must fit in an int.
    static int keptStops(int count) {
        constexpr int kMostStops = std::numeric_limits<int>::max() / kReservedStopChars - 10;
        return std::clamp(count, 0, kMostStops);
    }

    SequentialWriter(char* start, char letter) : mAt(start) { *mAt++ = letter; }

    /// A 32-bit word as eight nibbles, the highest first.
    SequentialWriter& word(uint32_t value) { return nibbles(value, kWordChars); }

    /// The low 7 bits.
    SequentialWriter& small(int32_t value) { return marked(static_cast<uint32_t>(value) & 0x7FU); }
    SequentialWriter& small(float value) { return small(toInt(value)); }

    /// Whole degrees in 0..359 as 2 + 7 bits.
    SequentialWriter& angle(float degrees) {
        const int32_t whole = wholeDegrees(degrees, kTurn);
        return small(whole >> 7).small(whole);
    }

    /// The low 8 bits as two nibbles.
    SequentialWriter& bytePair(float value) {
        return nibbles(static_cast<uint32_t>(toInt(value)), kBytePairChars);
    }

    /// The low 16 bits as four nibbles.
    SequentialWriter& quad(float value) {
        return nibbles(static_cast<uint32_t>(toInt(value)), kQuadChars);
    }

    /// Each stop is its colour and its position in hundredths. No array counts as no stops.
    SequentialWriter& stops(const VFGradient* gradient, int count) {
        const int kept = gradient != nullptr ? keptStops(count) : 0;
        for (int i = 0; i < kept; ++i) {
            word(gradient[i].mColor).small(gradient[i].mLocation * 100.0F);
        }
        return *this;
    }

    /// Where the next fragment starts.
    char* close() {
        *mAt = 0;
        return mAt;
    }

  private:
    SequentialWriter& marked(uint32_t bits) {
        *mAt++ = static_cast<char>(0x80U | bits);
        return *this;
    }

    SequentialWriter& nibbles(uint32_t value, int count) {
        for (int i = count - 1; i >= 0; --i)
            marked((value >> (4 * i)) & 0xFU);
        return *this;
    }

    char* mAt;
};

}  // namespace VFontEffect::internal
