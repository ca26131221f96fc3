#include "tests/support/lanes_check.h"

#include "simd/lanes.h"

// Nothing of the standard library here: the linker keeps one copy of an inline function, which might be
// the one with instructions that the CPU lacks.
namespace VFontEffect::internal::VOREL_LEVEL {
namespace {

constexpr int kU16Lanes = kBytes / 2;
/// Interleaving is done in so many bytes by themselves.
constexpr int kGroupBytes = kBytes < 16 ? kBytes : 16;

class Lanes {
  public:
    explicit Lanes(uint64_t seed) : mState(seed * 2685821657736338717ULL + 88172645463325252ULL) {}

    uint32_t next() {
        mState ^= mState >> 12;
        mState ^= mState << 25;
        mState ^= mState >> 27;
        return static_cast<uint32_t>((mState * 2685821657736338717ULL) >> 32);
    }
    /// 0 to `most`, often one of the two.
    uint32_t upTo(uint32_t most) {
        const uint32_t kind = next() % 8;
        return kind == 0 ? 0 : kind == 1 ? most : static_cast<uint32_t>(next() % (uint64_t{most} + 1));
    }
    template <class V, class T>
    V vector(T (&lanes)[sizeof(V) / sizeof(T)], uint32_t most) {
        for (T& lane : lanes)
            lane = static_cast<T>(upTo(most));
        return load<V>(lanes);
    }

  private:
    uint64_t mState;
};

float bitsAsFloat(uint32_t bits) {
    float value = 0.0F;
    std::memcpy(&value, &bits, sizeof value);
    return value;
}

template <class V, class T>
bool same(V vector, const T (&expected)[sizeof(V) / sizeof(T)]) {
    return std::memcmp(&vector, expected, sizeof vector) == 0;
}

/// Lane i of two vectors in turn, from the lower or the upper ends of each group.
template <class T>
T interleaved(const T* a, const T* b, int i, bool high) {
    constexpr int kGroup = kGroupBytes / static_cast<int>(sizeof(T));
    const int from = i / kGroup * kGroup + (high ? kGroup / 2 : 0) + i % kGroup / 2;
    return i % 2 == 0 ? a[from] : b[from];
}

const char* wrongOfBytes(Lanes& random) {
    uint8_t a[kBytes];
    uint8_t b[kBytes];
    uint8_t expected[kBytes];
    uint16_t wide[kU16Lanes];
    const U8s x = random.vector<U8s>(a, 255);
    const U8s y = random.vector<U8s>(b, 255);
    const auto each = [&](auto lane) {
        for (int i = 0; i < kBytes; ++i)
            expected[i] = static_cast<uint8_t>(lane(i));
    };
    each([&](int i) { return a[i] + b[i] > 255 ? 255 : a[i] + b[i]; });
    if (!same(addSaturated(x, y), expected)) return "addSaturated";
    each([&](int i) { return a[i] < b[i] ? 0 : a[i] - b[i]; });
    if (!same(subSaturated(x, y), expected)) return "subSaturated";
    each([&](int i) { return interleaved(a, b, i, false); });
    if (!same(interleaveLow(x, y), expected)) return "interleaveLow of bytes";
    each([&](int i) { return interleaved(a, b, i, true); });
    if (!same(interleaveHigh(x, y), expected)) return "interleaveHigh of bytes";
    if (!same(narrow(widenLow(x), widenHigh(x)), a)) return "narrow";
    if (!same(pack(bitCast<U16s>(interleaveLow(x, U8s{})), bitCast<U16s>(interleaveHigh(x, U8s{}))), a))
        return "pack of 16-bit lanes";
    for (int i = 0; i < kU16Lanes; ++i)
        wide[i] = a[i];
    if (!same(widenLow(x), wide)) return "widenLow";
    for (int i = 0; i < kU16Lanes; ++i)
        wide[i] = a[kU16Lanes + i];
    if (!same(widenHigh(x), wide)) return "widenHigh";
    for (int i = 0; i < kU16Lanes; ++i)
        wide[i] = static_cast<uint16_t>(a[2 * i] + a[2 * i + 1]);
    if (!same(pairSums(x), wide)) return "pairSums";
#if defined(VOREL_PAIR_PRODUCTS)
    const auto product = [&](int i) { return a[i] / 2 * static_cast<int8_t>(b[i]); };
    for (int i = 0; i < kU16Lanes; ++i)
        wide[i] = static_cast<uint16_t>(product(2 * i) + product(2 * i + 1));
    if (!same(pairProducts(x >> 1, y), wide)) return "pairProducts";
#endif

    uint64_t lanes = 0;
    bool zero = true;
    for (int i = 0; i < kBytes; ++i) {
        zero = zero && a[i] == 0;
        if (a[i] != 0) lanes |= (~uint64_t{0} >> (64 - kLaneBits)) << (i * kLaneBits % 64);
    }
    if (nonZeroLanes(x) != lanes) return "nonZeroLanes";
    if (allZero(x) != zero || !allZero(U8s{})) return "allZero";
    const auto count = static_cast<int64_t>(1 + random.next() % kBytes);
    each([&](int i) { return i < count ? a[i] : 0; });
    if (!same(loadFirst(a, count), expected)) return "loadFirst";
    return nullptr;
}

const char* wrongOfU16s(Lanes& random) {
    uint16_t a[kU16Lanes];
    uint16_t b[kU16Lanes];
    uint16_t expected[kU16Lanes];
    const U16s x = random.vector<U16s>(a, 0xFFFF);
    const U16s y = random.vector<U16s>(b, 0xFFFF);
    for (int i = 0; i < kU16Lanes; ++i)
        expected[i] = static_cast<uint16_t>(uint32_t{a[i]} * b[i] >> 16);
    if (!same(multiplyHigh(x, y), expected)) return "multiplyHigh";
    for (int i = 0; i < kU16Lanes; ++i)
        expected[i] =
            static_cast<uint16_t>((uint32_t{a[i]} * (b[i] >> 1) + uint32_t{b[i]} * (a[i] >> 1)) >> 16);
    if (!same(multiplyHighSum(x, y >> 1, y, x >> 1), expected)) return "multiplyHighSum";
    for (int i = 0; i < kU16Lanes; ++i)
        expected[i] = interleaved(a, b, i, false);
    if (!same(interleaveLow(x, y), expected)) return "interleaveLow of 16-bit lanes";
    for (int i = 0; i < kU16Lanes; ++i)
        expected[i] = interleaved(a, b, i, true);
    if (!same(interleaveHigh(x, y), expected)) return "interleaveHigh of 16-bit lanes";

    uint8_t bytes[kBytes];
    for (int i = 0; i < kU16Lanes; ++i) {
        bytes[i] = static_cast<uint8_t>(a[i] >> 8);
        bytes[kU16Lanes + i] = static_cast<uint8_t>(b[i] >> 8);
    }
    if (!same(upperBytes(x, y), bytes)) return "upperBytes";
    for (int i = 0; i < kBytes; ++i)
        bytes[i] = static_cast<uint8_t>((i % 2 == 0 ? a : b)[i / 2] >> 8);
    if (!same(upperBytesInTurn(x, y), bytes)) return "upperBytesInTurn";
    for (int i = 0; i < kU16Lanes; ++i)
        expected[i] = a[i / 2 * 2];
    if (!same(inBothHalves(bitCast<U32s>(x) & 0xFFFFU), expected)) return "inBothHalves";

    const U16s small = random.vector<U16s>(a, 255);
    const U32s low = bitCast<U32s>(interleaveLow(small, U16s{}));
    if (!same(pack(low, bitCast<U32s>(interleaveHigh(small, U16s{}))), a)) return "pack of words";
    // Sums of nine bytes.
    const U16s even = random.vector<U16s>(a, 9 * 255);
    const U16s odd = random.vector<U16s>(b, 9 * 255);
    uint8_t quarter[kBytes];
    for (int i = 0; i < kBytes; ++i) {
        const int sum = (i % 2 == 0 ? a : b)[i / 2];
        quarter[i] = static_cast<uint8_t>(sum / 4 > 255 ? 255 : sum / 4);
    }
    return same(quarters(even, odd), quarter) ? nullptr : "quarters";
}

const char* wrongOfU32s(Lanes& random) {
    uint8_t bytes[kBytes];
    const auto words = bitCast<U32s>(random.vector<U8s>(bytes, 255));
    const auto byteAt = [words](int i) { return words >> (8 * i) & 0xFFU; };
    return same(joinedBytes(byteAt(0), byteAt(1), byteAt(2), byteAt(3)), bytes) ? nullptr
                                                                                : "joinedBytes";
}

const char* wrongOfFloats(Lanes& random) {
    constexpr float kEnds[] = {0.0F,
                               -0.0F,
                               0.999999F,
                               -0.999999F,
                               2147483520.0F,
                               2147483648.0F,
                               -2147483648.0F,
                               1e30F,
                               -1e30F,
                               __builtin_inff(),
                               1.5F,
                               -1.5F,
                               16777216.0F,
                               255.99998F,
                               -__builtin_inff(),
                               __builtin_nanf("")};
    float values[kU32Lanes];
    int32_t whole[kU32Lanes];
    float expected[kU32Lanes];
    for (int i = 0; i < kU32Lanes; ++i) {
        const uint32_t bits = random.next();
        values[i] = random.next() % 2 == 0 ? kEnds[bits % 16] : bitsAsFloat(bits);
        whole[i] = internal::toInt(values[i]);
    }
    if (!same(toInt(load<F32s>(values)), whole)) return "toInt";
    for (int32_t& number : whole)
        number = number < 0 ? 0 : number > 255 ? 255 : number;
    if (!same(toIntUpTo<255>(load<F32s>(values)), whole)) return "toIntUpTo";
    for (int i = 0; i < kU32Lanes; ++i) {
        values[i] = static_cast<float>(random.upTo(0x7FFFFFFF)) / 977.0F;
        expected[i] = __builtin_sqrtf(values[i]);
    }
    if (!same(squareRoot(load<F32s>(values)), expected)) return "squareRoot";

    uint32_t numbers[kU32Lanes];
    const U32s biased = random.vector<U32s>(numbers, (1U << 23) - 1) + kNumberBias;
    const float factor = 1.0F / static_cast<float>(1 + random.upTo(25999));
    for (int i = 0; i < kU32Lanes; ++i)
        expected[i] = static_cast<float>(numbers[i]) * factor;
    return same(timesFactor(biased, splat<F32s>(factor)), expected) ? nullptr : "timesFactor";
}

const char* wrongOfTables(Lanes& random) {
    constexpr int32_t kSize = 256;
    uint32_t table[kSize];
    for (uint32_t& word : table)
        word = random.next();
    uint8_t bytes[kU32Lanes];
    int32_t indices[kU32Lanes];
    uint32_t expected[kU32Lanes];
    // Far apart, or a few places from each other, up or down.
    const bool far = random.next() % 3 == 0;
    const auto first = static_cast<int32_t>(random.upTo(kSize - 1));
    const int32_t step = static_cast<int32_t>(random.next() % 5) - 2;
    for (int32_t i = 0; i < kU32Lanes; ++i) {
        const int32_t near = first + i * step < 0        ? 0
                             : first + i * step >= kSize ? kSize - 1
                                                         : first + i * step;
        indices[i] = far ? static_cast<int32_t>(random.upTo(kSize - 1)) : near;
        bytes[i] = static_cast<uint8_t>(indices[i]);
        expected[i] = table[indices[i]];
    }
    if (!same(gather(table, load<I32s>(indices)), expected)) return "gather";
    if (!same(gather(table, bytes), expected)) return "gather by bytes";
    return same(gatherNear(table, kSize, load<I32s>(indices)), expected) ? nullptr : "gatherNear";
}

template <int64_t kFour>
bool addsDots(Lanes& random, const uint8_t* weights, const WeightCell* cells) {
    uint8_t taps[kBytes];
    uint32_t sums[kU32Lanes];
    const U8s stored = random.vector<U8s>(taps, 255) ^ kTapBias;
    const U32s before = random.vector<U32s>(sums, 0xFFFFFF);
    for (int i = 0; i < kBytes; ++i) {
        const uint32_t weight = weights[4 * kFour + i % 4];
        sums[i / 4] += (taps[i] - uint32_t{kTapBias}) * weight;
    }
    return same(addDots<kFour>(before, tapsOf(stored), weightsAt(cells)), sums);
}

const char* wrongOfDots(Lanes& random) {
    constexpr int kCells = 16;
    uint8_t weights[kCells + 2] = {};
    WeightCell cells[kCells];
    for (int i = 0; i < kCells; ++i)
        weights[i] = static_cast<uint8_t>(random.upTo(128));
    for (int i = 0; i < kCells; ++i)
        cells[i] = cellOf(weights + i);
    return addsDots<0>(random, weights, cells) && addsDots<1>(random, weights, cells) &&
                   addsDots<2>(random, weights, cells) && addsDots<3>(random, weights, cells)
               ? nullptr
               : "addDots";
}

const char* wrongOperation(uint64_t seed) {
    Lanes random(seed);
    const char* wrong = wrongOfBytes(random);
    if (wrong == nullptr) wrong = wrongOfU16s(random);
    if (wrong == nullptr) wrong = wrongOfU32s(random);
    if (wrong == nullptr) wrong = wrongOfFloats(random);
    if (wrong == nullptr) wrong = wrongOfTables(random);
    return wrong == nullptr ? wrongOfDots(random) : wrong;
}

}  // namespace

extern const LanesCheck kLanesCheck = {wrongOperation};

}  // namespace VFontEffect::internal::VOREL_LEVEL
