#pragma once

#include <climits>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <initializer_list>
#include <limits>

/// How the bytes of one fuzzing input become the arguments of calls.
namespace vorel_fuzz {

/// Reads numbers from an input. Past its end every byte is 0, so that any bytes are a whole sequence of
/// choices and a cut input still means what it meant up to the cut.
///
/// An input must mean the same under every compiler: of several numbers for one call each has its own
/// statement, or they stand in braces, for the arguments of a call may be evaluated in any order.
class Decoder {
  public:
    Decoder(const uint8_t* data, size_t size)
        : mAt(data), mEnd(data + size), mIsLarge(size > 0 && *data >= kLarge) {}

    bool atEnd() const { return mAt == mEnd; }

    /// Whether the input is one in eight that may have long sides. Its first byte tells, which is read
    /// for something else too.
    bool isLarge() const { return mIsLarge; }

    uint8_t byte() { return atEnd() ? uint8_t{0} : *mAt++; }

    /// `count` bytes of the input, the lowest first.
    uint32_t number(int count) {
        uint32_t value = 0;
        for (int i = 0; i < count; ++i)
            value |= uint32_t{byte()} << (8 * i);
        return value;
    }
    uint32_t word() { return number(4); }

    bool flag() { return (byte() & 1) != 0; }

    /// True for one byte in `n`; false past the end.
    bool oneIn(int n) { return byte() % n == n - 1; }

    /// From `low` to `high`, both included, read from as few bytes as the range needs.
    int between(int low, int high) {
        const auto span = static_cast<uint64_t>(int64_t{high} - low) + 1;
        const int bytes = span <= 0x100 ? 1 : span <= 0x10000 ? 2 : 4;
        return static_cast<int>(low + static_cast<int64_t>(number(bytes) % span));
    }

    template <class T>
    T oneOf(std::initializer_list<T> choices) {
        return choices.begin()[between(0, static_cast<int>(choices.size()) - 1)];
    }

    /// Mostly from `low` to `high`; now and then an end of the range of an int, or any int.
    int wildInt(int low, int high) {
        const uint8_t kind = byte();
        if (kind < kWild) return between(low, high);
        if (kind < kAnything) {
            return oneOf({INT_MIN, INT_MIN + 1, -65536, -1, 0, 1, 255, 256, 257, 32768, 65535, 65536,
                          0x40000000, INT_MAX - 1, INT_MAX});
        }
        return static_cast<int>(word());
    }

    /// From `low` to `high` in 65,536 steps.
    float real(float low, float high) {
        return low + (high - low) * (static_cast<float>(number(2)) / 65535.0F);
    }

    /// Mostly from `low` to `high`; now and then a value where arithmetic or a conversion turns, NaN
    /// and the infinities among them, or any float.
    float wildFloat(float low, float high) {
        using Limits = std::numeric_limits<float>;
        const uint8_t kind = byte();
        if (kind < kWild / 2) return static_cast<float>(static_cast<int>(real(low, high)));
        if (kind < kWild) return real(low, high);
        if (kind < kAnything) {
            return oneOf({0.0F,
                          -0.0F,
                          0.1F,
                          0.5F,
                          1.0F,
                          -1.0F,
                          2.0F,
                          10.0F,
                          100.0F,
                          101.0F,
                          360.0F,
                          256.0F,
                          256.5F,
                          2147483520.0F,
                          2147483648.0F,
                          -2147483648.0F,
                          4294967296.0F,
                          Limits::denorm_min(),
                          -Limits::denorm_min(),
                          Limits::min(),
                          Limits::epsilon(),
                          Limits::max(),
                          Limits::lowest(),
                          Limits::infinity(),
                          -Limits::infinity(),
                          Limits::quiet_NaN(),
                          -Limits::quiet_NaN()});
        }
        const uint32_t bits = word();
        float value = 0.0F;
        std::memcpy(&value, &bits, sizeof value);
        return value;
    }

    /// Bytes as they stand in the input.
    void copy(uint8_t* to, size_t size) {
        for (size_t i = 0; i < size; ++i)
            to[i] = byte();
    }

  private:
    /// First bytes from which an input is large, a number is wild, and it is any bit pattern.
    static constexpr uint8_t kLarge = 0xE0;
    static constexpr uint8_t kWild = 0xD0;
    static constexpr uint8_t kAnything = 0xF0;

    const uint8_t* mAt;
    const uint8_t* mEnd;
    bool mIsLarge;
};

struct Size {
    int width, height;
};

/// Sides from `least` to `most`.
inline Size decodeSize(Decoder& in, Size least, Size most) {
    return Size{in.between(least.width, most.width), in.between(least.height, most.height)};
}

}  // namespace vorel_fuzz
