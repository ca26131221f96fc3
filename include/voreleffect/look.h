#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <memory>
#include <new>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "VFBitmap.h"
#include "VFECore.h"
#include "VFEffect.h"
#include "VFProperty.h"
#include "VFVersion.h"

/// Looks as values, painted with one call.
///
///     Look look;
///     look.fill(rgb(0x3366CC))
///         .add(OuterShadow(rgb(0)).angle(135).distance(6).size(8).opacity(0.6F))
///         .add(Stroke(4, rgb(0xFFFFFF)));
///     paint(look, glyphs, page, 40, 80);
///
/// It is C++17 over the classes of VFEffect.h and stands in this header alone; voreleffect.h leaves it
/// out. It takes neither exceptions nor run-time type information.
///
/// Conventions beside those of VFBitmap.h:
///  - Input is const and stays the caller's; views are looked at only during the call that they are
///    handed to.
///  - Numbers out of range become what VFEffect's add-calls make of them.
///  - std::bad_alloc comes from what makes or copies looks, painters and pictures, and from key() and
///    margins(), before anything is painted. A Painter that is made paints without throwing. In a
///    program without exceptions it ends the program, as it does in the standard library.
///  - One Look, Painter or Picture belongs to one thread at a time, but several may read a Look or a
///    Picture; copies are independent.
namespace VFontEffect {

/// \cond
// The version stands in all names: two libraries of one process that were compiled with different
// versions of this header would otherwise share its inline functions, and one of them would read the
// other's layout. So do sources without exceptions: a program that has some of either kind would take
// functions of one kind for both, and end, or leak, where it is to throw.
#ifdef __cpp_exceptions
#define VOREL_LOOK_JOINED(major, minor, patch) look_##major##_##minor##_##patch
#else
#define VOREL_LOOK_JOINED(major, minor, patch) look_##major##_##minor##_##patch##_aborting
#endif
#define VOREL_LOOK_OF(major, minor, patch) VOREL_LOOK_JOINED(major, minor, patch)
#define VOREL_LOOK VOREL_LOOK_OF(VOREL_VERSION_MAJOR, VOREL_VERSION_MINOR, VOREL_VERSION_PATCH)
// By this clang warns of a list that outlives what it points to.
#ifdef __has_cpp_attribute
#if __has_cpp_attribute(clang::lifetimebound)
#define VOREL_POINTED_TO [[clang::lifetimebound]]
#endif
#endif
#ifndef VOREL_POINTED_TO
#define VOREL_POINTED_TO
#endif
inline namespace VOREL_LOOK {
/// \endcond

/// A colour without an opacity: 0xRRGGBB.
struct Color {
    unsigned int value = 0;  ///< 0xRRGGBB
};

/// A colour from 0xRRGGBB; what lies above is ignored.
constexpr Color rgb(unsigned int value) {
    return {value & 0xFFFFFFU};
}

/// A colour from its channels, each brought into 0..255.
constexpr Color rgb(int red, int green, int blue) {
    return {static_cast<unsigned int>(std::clamp(red, 0, 255)) << 16 |
            static_cast<unsigned int>(std::clamp(green, 0, 255)) << 8 |
            static_cast<unsigned int>(std::clamp(blue, 0, 255))};
}

/// One colour of a ramp.
struct Stop {
    Color color;        ///< black at the start
    float opacity = 1;  ///< 0 to 1
    float place = 0;    ///< 0 to 1, ascending from stop to stop
};

/// Where a stroke lies on the edge of the glyphs.
enum class Position { centre, outside, inside };

/// How the four bytes of a premultiplied pixel stand in memory.
enum class PixelOrder { rgba, bgra };

/// Pixels that an effect needs, or a picture has, around the glyphs.
struct Margins {
    int left = 0;    ///< 0 or more
    int top = 0;     ///< 0 or more
    int right = 0;   ///< 0 or more
    int bottom = 0;  ///< 0 or more
};

/// Half-open, in whole pixels; empty at the start.
struct Box {
    int left = 0;    ///< first column
    int top = 0;     ///< first row
    int right = 0;   ///< one past the last column
    int bottom = 0;  ///< one past the last row

    /// Whether there is no pixel in it.
    bool isEmpty() const { return right <= left || bottom <= top; }
};

/// The coverage of one glyph, or of a whole line, and where it stands. One of no width or no height is
/// skipped, with or without coverage.
struct Glyph {
    int x = 0;                                ///< left edge, from the origin of the text
    int y = 0;                                ///< top edge
    const unsigned char* coverage = nullptr;  ///< 0 to 255, top row first
    int width = 0;                            ///< 0 to 65535
    int height = 0;                           ///< 0 to 65535
    std::ptrdiff_t stride = 0;  ///< bytes from row to row, at least the width; 0 for packed rows
};

/// A list of glyphs that lie elsewhere: to be handed to a call, not to be kept.
class Glyphs {
  public:
    /// One.
    Glyphs(const Glyph& only VOREL_POINTED_TO) : Glyphs(&only, 1) {}
    /// Those of a list.
    Glyphs(const std::vector<Glyph>& glyphs VOREL_POINTED_TO) : Glyphs(glyphs.data(), glyphs.size()) {}
    /// Those that are named.
    Glyphs(const std::initializer_list<Glyph>& glyphs VOREL_POINTED_TO)
        : Glyphs(glyphs.begin(), glyphs.size()) {}
    /// `count` of them from the first on; none when that is null.
    Glyphs(const Glyph* first, std::size_t count)
        : mFirst(first), mCount(first == nullptr ? 0 : count) {}

    const Glyph* begin() const { return mFirst; }         ///< the first
    const Glyph* end() const { return mFirst + mCount; }  ///< behind the last

  private:
    const Glyph* mFirst;
    std::size_t mCount;
};

/// A picture to paint on: premultiplied pixels of 4 bytes.
struct PictureView {
    unsigned char* data = nullptr;  ///< top row first
    int width = 0;                  ///< pixels of a row
    int height = 0;                 ///< rows
    std::ptrdiff_t stride = 0;      ///< bytes from row to row, at least 4 * width; 0 for packed rows
    PixelOrder order = PixelOrder::rgba;  ///< of its bytes
};

/// The pixels of a pattern: R, G, B, A, straight, that is not premultiplied.
struct PixelView {
    const unsigned char* data = nullptr;  ///< top row first
    int width = 0;                        ///< pixels of a row
    int height = 0;                       ///< rows
    std::ptrdiff_t stride = 0;  ///< bytes from row to row, at least 4 * width; 0 for packed rows
};

/// Why a painter painted nothing.
enum class Failure {
    none,
    badArgument,  ///< a view or a glyph without pixels, of a negative size, with too short a stride, or
                  ///< with rows farther apart than pointers span
    tooLarge,     ///< a glyph beyond 65535 pixels on a side, a layer of 2^31 bytes and more, or a
                  ///< picture whose left or top is below -2^31
    noMemory
};

namespace look_internal {

constexpr unsigned int kNoCore = 0xFFFFFFFFU;
constexpr std::int64_t kMostBytes = 0x7FFFFFFF;
constexpr int kLargestGlyph = 65535;

/// Ends what cannot go on without memory, as the containers of the standard library do.
[[noreturn]] inline void throwBadAlloc() {
#ifdef __cpp_exceptions
    throw std::bad_alloc();
#else
    std::abort();
#endif
}

inline std::uint32_t bitsOf(float value) {
    std::uint32_t bits = 0;
    static_assert(sizeof bits == sizeof value);
    std::memcpy(&bits, &value, sizeof bits);
    return bits;
}

/// 0 to 1; what is no number is 0, and so is what a caller's state may flush to 0. Asked of the bits,
/// which raise no exception of floating-point arithmetic.
inline float unit(float value) {
    constexpr std::uint32_t kSmallest = 0x00800000U;
    constexpr std::uint32_t kOne = 0x3F800000U;
    constexpr std::uint32_t kInfinity = 0x7F800000U;
    const std::uint32_t bits = bitsOf(value);
    if (bits < kSmallest || bits > kInfinity) return 0.0F;
    return bits < kOne ? value : 1.0F;
}

/// The product of two such numbers, rounded to nearest, ties to even: by their bits, as the caller's
/// rounding mode and traps must not matter.
inline float product(float a, float b) {
    if (bitsOf(a) == 0 || bitsOf(b) == 0) return 0.0F;
    const auto mantissa = [](float x) { return std::uint64_t{(bitsOf(x) & 0x007FFFFFU) | 0x00800000U}; };
    const std::uint64_t whole = mantissa(a) * mantissa(b);  // 2^46 to 2^48
    const unsigned int cut = whole >> 47 == 0 ? 23 : 24;
    const std::uint64_t half = std::uint64_t{1} << (cut - 1);
    const std::uint64_t kept = (whole + half - 1 + (whole >> cut & 1U)) >> cut;
    const int exponent = static_cast<int>((bitsOf(a) >> 23) + (bitsOf(b) >> 23) + cut) - 127 - 23;
    if (exponent < 1) return 0.0F;
    // The leading bit of what is kept is not stored; a carry beyond it belongs to the exponent.
    const auto bits =
        static_cast<std::uint32_t>((static_cast<std::uint64_t>(exponent - 1) << 23) + kept);
    float rounded = 0;
    std::memcpy(&rounded, &bits, sizeof rounded);
    return rounded;
}

/// Whether so many rows of `width` pixels, one at least, can be read or written: `stride` is in bytes.
/// Where addresses have 32 bits some are farther apart than pointers span.
inline bool areRows(const unsigned char* data, int width, int height, int bytesPerPixel,
                    std::ptrdiff_t stride) {
    constexpr std::int64_t kMost = PTRDIFF_MAX;
    const std::int64_t rowBytes = std::int64_t{width} * bytesPerPixel;
    const std::int64_t step = stride == 0 ? rowBytes : stride;
    if (data == nullptr || step < rowBytes || rowBytes > kMost) return false;
    return height <= 1 || height - 1 <= (kMost - rowBytes) / step;
}

/// The bytes from row to row.
inline std::ptrdiff_t strideOf(int width, int bytesPerPixel, std::ptrdiff_t stride) {
    return stride == 0 ? static_cast<std::ptrdiff_t>(width) * bytesPerPixel : stride;
}

/// Pixels of a pattern as the classes take them, and what tells them from others.
struct Tile {
    int width = 0;
    int height = 0;
    std::vector<unsigned char> argb;
    std::uint64_t hash[2] = {0, 0};
};

/// Mixes a word into a hash. Where only one of both differs, so does the result.
inline std::uint64_t mixed(std::uint64_t hash, std::uint64_t word) {
    hash = (hash ^ word) * 0xFF51AFD7ED558CCDU;
    hash = (hash ^ hash >> 33) * 0xC4CEB9FE1A85EC53U;
    return hash ^ hash >> 29;
}

inline void takePixel(Tile& tile, const unsigned char* rgba) {
    tile.argb.insert(tile.argb.end(), {rgba[3], rgba[0], rgba[1], rgba[2]});
    const std::uint64_t word = std::uint64_t{rgba[0]} << 24 | std::uint64_t{rgba[1]} << 16 |
                               std::uint64_t{rgba[2]} << 8 | rgba[3];
    tile.hash[0] = mixed(tile.hash[0], word);
    tile.hash[1] = mixed(tile.hash[1] + 0x9E3779B97F4A7C15U, word << 32);
}

/// A tile without pixels for a view that has none, or more than fit.
inline std::shared_ptr<const Tile> tileOf(const PixelView& pixels) {
    auto tile = std::make_shared<Tile>();
    if (pixels.width <= 0 || pixels.height <= 0) return tile;
    if (!areRows(pixels.data, pixels.width, pixels.height, 4, pixels.stride)) return tile;
    if (std::int64_t{pixels.width} * pixels.height > kMostBytes / 4) return tile;
    tile->width = pixels.width;
    tile->height = pixels.height;
    tile->argb.reserve(static_cast<std::size_t>(pixels.width) * static_cast<std::size_t>(pixels.height) *
                       4);
    for (int y = 0; y < pixels.height; ++y) {
        const unsigned char* row = pixels.data + y * strideOf(pixels.width, 4, pixels.stride);
        for (int x = 0; x < pixels.width; ++x, row += 4)
            takePixel(*tile, row);
    }
    return tile;
}

/// The numbers by which VFEffect knows the kinds.
enum Kind {
    kOuterShadow = 1,
    kInnerShadow = 2,
    kOuterGlow = 3,
    kInnerGlow = 4,
    kLinearGradient = 7,
    kRadialGradient = 8,
    kStroke = 10,
    kPattern = 11,
    kText = 12
};

/// An effect of any kind; which of the fields count depends on it.
struct EffectData {
    explicit EffectData(Kind ofKind, Color ofColor = {}) : kind(ofKind), color(ofColor) {}

    Kind kind;
    Color color;
    float opacity = 1;
    float angle = 0;
    float distance = 0;
    float size = 0;
    float scale = 1;
    Position position = Position::outside;
    std::vector<Stop> stops;
    std::shared_ptr<const Tile> tile;
};

}  // namespace look_internal

/// One effect of any kind: one of those below. Their calls return a changed copy.
class Effect {
  public:
    /// Moves are copies, too: what is moved from stays as it was.
    Effect(const Effect&) = default;
    /// A copy; where memory runs out the effect stays as it was.
    Effect& operator=(const Effect& other) {
        mData = Data(other.mData);
        return *this;
    }
    ~Effect() = default;

  protected:
    friend class Look;

    using Data = look_internal::EffectData;                 ///< what it holds
    explicit Effect(Data data) : mData(std::move(data)) {}  ///< made by its kind alone

    Data mData;  ///< the numbers as they were told
};

/// What all effects are.
template <class Self>
class EffectOf : public Effect {
  public:
    /// 0 to 1, at the start 1; multiplied with that of each stop.
    [[nodiscard]] Self opacity(float value) const { return changed(&Data::opacity, value); }

  protected:
    using Effect::Effect;

    /// A copy in which one field is another.
    template <class Value>
    Self changed(Value Data::*field, Value value) const {
        Self copy = static_cast<const Self&>(*this);
        copy.mData.*field = std::move(value);
        return copy;
    }
};

/// What both shadows are.
template <class Self, look_internal::Kind kind>
class ShadowOf : public EffectOf<Self> {
  public:
    /// Angle 135, distance 4, size 4, opacity 1.
    explicit ShadowOf(Color color) : EffectOf<Self>(look_internal::EffectData(kind, color)) {
        this->mData.angle = 135;
        this->mData.distance = 4;
        this->mData.size = 4;
    }

    /// Where the light comes from, in degrees: 0 the right, 90 above.
    [[nodiscard]] Self angle(float degrees) const {
        return this->changed(&look_internal::EffectData::angle, degrees);
    }
    /// How far it is moved, away from the light: 0 to 100 pixels.
    [[nodiscard]] Self distance(float pixels) const {
        return this->changed(&look_internal::EffectData::distance, pixels);
    }
    /// Radius of the blur: 0 to 100 pixels.
    [[nodiscard]] Self size(float pixels) const {
        return this->changed(&look_internal::EffectData::size, pixels);
    }
};

/// What both glows are.
template <class Self, look_internal::Kind kind>
class GlowOf : public EffectOf<Self> {
  public:
    /// 0 to 100 pixels wide, in one colour.
    GlowOf(float size, Color color) : EffectOf<Self>(look_internal::EffectData(kind, color)) {
        this->mData.size = size;
    }

    /// The colours from the edge of the glyphs onwards instead of the one colour; 256 at most.
    [[nodiscard]] Self stops(std::vector<Stop> list) const {
        return this->changed(&look_internal::EffectData::stops, std::move(list));
    }
};

/// What both gradients are.
template <class Self, look_internal::Kind kind>
class GradientOf : public EffectOf<Self> {
  public:
    /// 1 to 256 stops; none paint nothing.
    explicit GradientOf(const std::vector<Stop>& stops)
        : EffectOf<Self>(look_internal::EffectData(kind)) {
        this->mData.stops = stops;
    }

    /// The length of the ramp, 0.1 to 2, at the start 1; less paints nothing. In lengths of the box, of
    /// a radial one in half widths.
    [[nodiscard]] Self scale(float lengths) const {
        return this->changed(&look_internal::EffectData::scale, lengths);
    }
};

/// A shadow behind the glyphs.
class OuterShadow : public ShadowOf<OuterShadow, look_internal::kOuterShadow> {
    using ShadowOf::ShadowOf;
};

/// A shadow that falls into the glyphs.
class InnerShadow : public ShadowOf<InnerShadow, look_internal::kInnerShadow> {
    using ShadowOf::ShadowOf;
};

/// A halo around the glyphs.
class OuterGlow : public GlowOf<OuterGlow, look_internal::kOuterGlow> {
    using GlowOf::GlowOf;
};

/// A glow from the edges of the glyphs inwards.
class InnerGlow : public GlowOf<InnerGlow, look_internal::kInnerGlow> {
    using GlowOf::GlowOf;
};

/// A ramp across the box of the glyphs.
class LinearGradient : public GradientOf<LinearGradient, look_internal::kLinearGradient> {
  public:
    using GradientOf::GradientOf;

    /// In degrees: 0, as at the start, runs to the right, 90 upwards.
    [[nodiscard]] LinearGradient angle(float degrees) const { return changed(&Data::angle, degrees); }
};

/// A ramp from the centre of the box of the glyphs.
class RadialGradient : public GradientOf<RadialGradient, look_internal::kRadialGradient> {
    using GradientOf::GradientOf;
};

/// An outline.
class Stroke : public EffectOf<Stroke> {
  public:
    /// 0 to 100 pixels wide, outside.
    Stroke(float size, Color color) : EffectOf(Data(look_internal::kStroke, color)) {
        mData.size = size;
    }

    /// Where it lies.
    [[nodiscard]] Stroke position(Position where) const { return changed(&Data::position, where); }
};

/// A picture tiled over the glyphs from the top left corner of their box.
class Pattern : public EffectOf<Pattern> {
  public:
    /// Copies the pixels. Of a view that cannot be read there are none, and nothing is painted.
    explicit Pattern(const PixelView& pixels) : EffectOf(Data(look_internal::kPattern)) {
        mData.tile = look_internal::tileOf(pixels);
    }

    /// Pixels of the picture painted on for one of the pattern: 0.1 to 10, at the start 1; less paints
    /// nothing.
    [[nodiscard]] Pattern scale(float value) const { return changed(&Data::scale, value); }
};

/// What text looks like: a fill and effects. At the start the fill is black and there are no effects.
///
/// Effects lie in three groups, from the top: those inside the glyphs, the fill, those beneath the text.
/// Within a group the one that was added last lies on top. A look has one effect of a kind; for more of
/// them paint several looks, one over the other.
class Look {
  public:
    Look() = default;             ///< filled in black
    Look(const Look&) = default;  ///< an independent copy
    Look(Look&&) = default;       ///< the other one has no effects then
    /// A copy; where memory runs out the look stays as it was.
    Look& operator=(const Look& other) { return *this = Look(other); }
    Look& operator=(Look&&) = default;  ///< the other one has no effects then
    ~Look() = default;

    /// Fills the glyphs. Through a fill whose own opacity (0 to 1) is below 1 what lies beneath the text
    /// is seen.
    Look& fill(Color color, float opacity = 1) & {
        mFill = color;
        mFillOpacity = look_internal::unit(opacity);
        mIsFilled = true;
        return *this;
    }
    /// The same for one that is being made.
    Look fill(Color color, float opacity = 1) && { return std::move(fill(color, opacity)); }

    /// Leaves out the fill. What lies beneath the text is cut out of the glyphs; what lies inside them
    /// is painted.
    Look& noFill() & {
        mIsFilled = false;
        return *this;
    }
    /// The same for one that is being made.
    Look noFill() && { return std::move(noFill()); }

    /// The opacity of the text, 0 to 1, which the fill's is multiplied with. Below 1 what lies beneath
    /// the text is cut out of the glyphs, and so is not seen through them. It may be told before or
    /// after the fill.
    Look& textOpacity(float opacity) & {
        mTextOpacity = look_internal::unit(opacity);
        return *this;
    }
    /// The same for one that is being made.
    Look textOpacity(float opacity) && { return std::move(textOpacity(opacity)); }

    /// Adds an effect. One of its kind that is there already is replaced, at its place in the order.
    Look& add(const Effect& effect) & {
        const auto same = std::find_if(mEffects.begin(), mEffects.end(), [&](const Data& other) {
            return other.kind == effect.mData.kind;
        });
        if (same == mEffects.end()) {
            mEffects.push_back(effect.mData);
        } else {
            *same = Data(effect.mData);
        }
        return *this;
    }
    /// The same for one that is being made.
    Look add(const Effect& effect) && { return std::move(add(effect)); }

    /// How far the look paints beyond the glyphs; nothing is cut off. At least what the four offsets of
    /// VFEffect tell: an outer glow has its faint end in addition.
    Margins margins() const;

    /// The look as bytes, none of them zero, for a cache: always the same for looks to which the same
    /// was added in the same order, at any time and in every process. Looks of the same key paint the
    /// same pictures.
    ///
    /// It begins with VFEffect's key. Behind it stands what that one leaves out or cuts: whether what is
    /// beneath is cut out, scales and places of stops in full, and of a pattern its place in the order,
    /// size, scale, opacity and a hash of its pixels of 128 bits.
    std::string key() const;

    /// Looks are equal when their keys are.
    friend bool operator==(const Look& a, const Look& b) { return a.key() == b.key(); }
    /// Not equal.
    friend bool operator!=(const Look& a, const Look& b) { return !(a == b); }

  private:
    friend class Painter;
    using Data = look_internal::EffectData;

    float shownTextOpacity() const { return mIsFilled ? mTextOpacity : 0.0F; }
    /// Makes the add-calls in an empty set.
    void describe(VFEffect& set) const;

    Color mFill;
    float mFillOpacity = 1;
    float mTextOpacity = 1;
    bool mIsFilled = true;
    std::vector<Data> mEffects;
};

namespace look_internal {

/// Makes the add-calls in a set. Memory that runs out leaves a core missing, or without its record.
class AddCalls {
  public:
    explicit AddCalls(VFEffect& set) : mSet(set) {}

    void add(const EffectData& effect) const {
        const unsigned int id = added(effect);
        check(id, effect.kind);
    }
    void fill(Color color, float opacity) const { check(mSet.addText(color.value, opacity), kText); }

  private:
    unsigned int added(const EffectData& e) const {
        std::vector<VFGradient> stops = stopsOf(e);
        const auto count = static_cast<int>(stops.size());
        const unsigned int color = e.color.value;
        switch (e.kind) {
            case kOuterShadow:
                return mSet.addOuterShadowText(e.angle, e.distance, e.size, color, e.opacity);
            case kInnerShadow:
                return mSet.addInnerShadowText(e.angle, e.distance, e.size, color, e.opacity);
            case kOuterGlow:
                return mSet.addOuterGlowText(e.size, color, e.opacity, count, stops.data());
            case kInnerGlow:
                return mSet.addInnerGlowText(e.size, color, e.opacity, count, stops.data());
            case kLinearGradient:
                return mSet.addLinearGradientText(e.angle, e.scale, e.opacity, count, stops.data());
            case kRadialGradient:
                return mSet.addRadialGradientText(e.scale, e.opacity, count, stops.data());
            case kStroke:
                return mSet.addStrokeText(e.size, color, e.opacity, 0, static_cast<int>(e.position));
            case kPattern:
                return addPattern(e);
            default:
                return kNoCore;
        }
    }
    unsigned int addPattern(const EffectData& e) const {
        const Tile& tile = *e.tile;
        // The bitmap copies the bytes without changing them, but takes a pointer to mutable ones.
        VFBitmap bitmap(static_cast<unsigned int>(tile.width), static_cast<unsigned int>(tile.height),
                        const_cast<unsigned char*>(tile.argb.data()), 4);
        if (bitmap.mData == nullptr && !tile.argb.empty()) throwBadAlloc();
        return mSet.addPatternText(&bitmap, e.scale, e.opacity);
    }
    static std::vector<VFGradient> stopsOf(const EffectData& effect) {
        constexpr std::size_t kMostStops = 256;
        std::vector<VFGradient> stops;
        stops.reserve(std::min(effect.stops.size(), kMostStops));
        for (const Stop& stop : effect.stops) {
            if (stops.size() == kMostStops) break;
            stops.push_back({stop.color.value, stop.opacity, stop.place});
        }
        return stops;
    }
    void check(unsigned int id, Kind kind) const {
        if (id == kNoCore || mSet.getEffect(kind)->getProperty() == nullptr) throwBadAlloc();
    }

    VFEffect& mSet;
};

/// Writes the fragments of a key that are a look's own: a small letter, then numbers of 7 bits a byte,
/// each byte with its top bit set. The numbers are those of the records, as the effects are painted.
class KeyWriter {
  public:
    KeyWriter(std::string& key, VFEffect& set) : mKey(key), mSet(set) {}

    void add(const EffectData& effect) {
        switch (effect.kind) {
            case kOuterGlow:
                writeStops(recordOf<VFOuterGlowProperty>(kOuterGlow));
                break;
            case kInnerGlow:
                writeStops(recordOf<VFInnerGlowProperty>(kInnerGlow));
                break;
            case kLinearGradient:
                writeGradient(recordOf<VFLinearGradientProperty>(kLinearGradient));
                break;
            case kRadialGradient:
                writeGradient(recordOf<VFRadialGradientProperty>(kRadialGradient));
                break;
            case kPattern:
                writePattern(recordOf<VFPatternProperty>(kPattern), *effect.tile);
                break;
            default:
                break;
        }
        ++mPlace;
    }
    void cutOut() { mKey += 'o'; }

  private:
    template <class Record>
    const Record& recordOf(Kind kind) const {
        return *static_cast<const Record*>(mSet.getEffect(kind)->getProperty());
    }
    template <class Record>
    void writeStops(const Record& record) {
        if (record.mGradientCount == 0) return;
        letter('s');
        for (int i = 0; i < record.mGradientCount; ++i)
            number(bitsOf(record.mGradient[i].mLocation), 32);
    }
    template <class Record>
    void writeGradient(const Record& record) {
        letter('g');
        number(bitsOf(record.mScale), 32);
        writeStops(record);
    }
    void writePattern(const VFPatternProperty& record, const Tile& tile) {
        letter('p');
        number(static_cast<std::uint64_t>(tile.width), 32);
        number(static_cast<std::uint64_t>(tile.height), 32);
        number(bitsOf(record.mScale), 32);
        number(bitsOf(record.mOpacity), 32);
        number(tile.hash[0], 64);
        number(tile.hash[1], 64);
    }
    /// With the place of the effect in the order.
    void letter(char letter) {
        mKey += letter;
        number(static_cast<std::uint64_t>(mPlace), 7);
    }
    void number(std::uint64_t value, int bits) {
        for (int shift = 0; shift < bits; shift += 7)
            mKey += static_cast<char>(0x80U | (value >> shift & 0x7FU));
    }

    std::string& mKey;
    VFEffect& mSet;
    int mPlace = 0;
};

/// An outer glow ends twice its size and one pixel from the glyphs.
inline Margins marginsOf(VFEffect& set) {
    VFECore* const glow = set.getEffect(kOuterGlow);
    const int faintEnd = glow == nullptr ? 0 : 2 * (glow->getOffset() + 1);
    return {std::max(set.getLeftOffset(), faintEnd), std::max(set.getTopOffset(), faintEnd),
            std::max(set.getRightOffset(), faintEnd), std::max(set.getBottomOffset(), faintEnd)};
}

/// A box whose numbers may lie beyond those of a picture.
struct WideBox {
    std::int64_t left = 0;
    std::int64_t top = 0;
    std::int64_t right = 0;
    std::int64_t bottom = 0;

    std::int64_t width() const { return right - left; }
    std::int64_t height() const { return bottom - top; }
    bool isEmpty() const { return width() <= 0 || height() <= 0; }
    bool fitsALayer() const {
        return width() <= kMostBytes / 4 && height() <= kMostBytes / 4 &&
               width() * height() <= kMostBytes / 4;
    }
    /// Makes it hold the other box as well, which is not empty.
    void grow(const WideBox& other) {
        *this = isEmpty() ? other
                          : WideBox{std::min(left, other.left), std::min(top, other.top),
                                    std::max(right, other.right), std::max(bottom, other.bottom)};
    }
    WideBox grownBy(const Margins& margins) const {
        return {left - margins.left, top - margins.top, right + margins.right, bottom + margins.bottom};
    }
    WideBox moved(std::int64_t x, std::int64_t y) const {
        return {left + x, top + y, right + x, bottom + y};
    }
    /// What of it lies within a view; an empty box when nothing does.
    WideBox within(const PictureView& view) const {
        const std::int64_t l = std::clamp<std::int64_t>(left, 0, view.width);
        const std::int64_t t = std::clamp<std::int64_t>(top, 0, view.height);
        return {l, t, std::clamp<std::int64_t>(right, l, view.width),
                std::clamp<std::int64_t>(bottom, t, view.height)};
    }
    Box narrow() const {
        if (isEmpty()) return {};
        return {static_cast<int>(left), static_cast<int>(top), static_cast<int>(right),
                static_cast<int>(bottom)};
    }
};

/// The four bytes of a pixel as a word; which of them stands where in it is left open.
inline std::uint32_t wordAt(const unsigned char* bytes) {
    std::uint32_t word = 0;
    std::memcpy(&word, bytes, 4);
    return word;
}

/// The four bytes of a word, each with 8 bits of room above it.
inline std::uint64_t spread(std::uint32_t word) {
    return (word & 0x00FF00FFU) | std::uint64_t{word >> 8 & 0x00FF00FFU} << 32;
}

/// A premultiplied pixel over another one, all channels at a time: over + round(under * rest / 255), at
/// most 255, where `rest` is 255 less the alpha of the upper one. For x up to 255 * 255 and t = x + 128,
/// x / 255 rounded to nearest is (t + (t >> 8)) >> 8; t and the sum fit in 16 bits.
inline std::uint32_t pixelOver(std::uint32_t over, std::uint32_t under, std::uint32_t rest) {
    constexpr std::uint64_t kBytes = 0x00FF00FF00FF00FFU;
    const std::uint64_t t = spread(under) * rest + 0x0080008000800080U;
    const std::uint64_t sum = spread(over) + ((t + (t >> 8 & kBytes)) >> 8 & kBytes);
    const std::uint64_t carry = sum >> 8 & 0x0001000100010001U;
    const std::uint64_t bytes = (sum | ((carry << 8) - carry)) & kBytes;
    return static_cast<std::uint32_t>(bytes) | static_cast<std::uint32_t>(bytes >> 32) << 8;
}

/// The pixel in the order of the destination.
template <PixelOrder order>
std::uint32_t ordered(const unsigned char* rgba) {
    if constexpr (order == PixelOrder::rgba) return wordAt(rgba);
    const unsigned char bgra[] = {rgba[2], rgba[1], rgba[0], rgba[3]};
    return wordAt(bgra);
}

/// Where one of both is clear, or the upper one opaque, the rule gives one of both as it is.
template <PixelOrder order>
void layRowOver(unsigned char* to, const unsigned char* from, std::int64_t count) {
    for (; count > 0; --count, to += 4, from += 4) {
        if (wordAt(from) == 0) continue;
        const std::uint32_t over = ordered<order>(from);
        const std::uint32_t under = wordAt(to);
        const bool isCopy = from[3] == 255 || under == 0;
        const std::uint32_t result = isCopy ? over : pixelOver(over, under, 255U - from[3]);
        std::memcpy(to, &result, 4);
    }
}

/// Premultiplied R, G, B, A pixels in packed rows with their place on a destination.
struct Placed {
    const unsigned char* pixels;
    WideBox box;

    /// Lays them over the view; returns what they touched.
    WideBox layOver(const PictureView& view) const {
        const WideBox seen = box.within(view);
        if (seen.isEmpty()) return {};
        const std::ptrdiff_t stride = strideOf(view.width, 4, view.stride);
        const auto layRow =
            view.order == PixelOrder::bgra ? layRowOver<PixelOrder::bgra> : layRowOver<PixelOrder::rgba>;
        for (std::int64_t y = seen.top; y < seen.bottom; ++y) {
            const std::int64_t at = (y - box.top) * box.width() + (seen.left - box.left);
            layRow(view.data + static_cast<std::ptrdiff_t>(y) * stride + seen.left * 4, pixels + at * 4,
                   seen.width());
        }
        return seen;
    }
};

/// Whether the view can be painted on. One without width or height can, to no effect.
inline bool isUsable(const PictureView& view) {
    if (view.width < 0 || view.height < 0) return false;
    return view.width == 0 || view.height == 0 ||
           areRows(view.data, view.width, view.height, 4, view.stride);
}

/// One look: its set, planned by the first run and not changed after that, and its layer.
struct Stage {
    VFEffect set;
    Margins margins;
    VFBitmap layer;
    std::size_t capacity = 0;  ///< bytes that the layer has room for
    WideBox box;               ///< of the layer, from the origin of the text
    bool isPainted = false;
};

/// Pixels from malloc.
using Pixels = std::unique_ptr<unsigned char, void (*)(void*)>;

}  // namespace look_internal

/// A picture that owns its pixels: premultiplied R, G, B, A in packed rows.
///
/// One look laid over a view as a picture gives the same bytes as painted onto the view. A stack does so
/// where the view is clear; elsewhere it may differ by roundings, since its looks were laid over each
/// other before: by 2 values of a channel at most when there are two looks.
class Picture {
  public:
    Picture() = default;  ///< empty
    /// Takes the pixels; the other one is empty then.
    Picture(Picture&& other) noexcept { swap(other); }
    /// Copies the pixels.
    Picture(const Picture& other) : mWidth(other.mWidth), mHeight(other.mHeight) {
        mLeft = other.mLeft;
        mTop = other.mTop;
        if (other.isEmpty()) return;
        mPixels.reset(static_cast<unsigned char*>(std::malloc(other.bytes())));
        if (mPixels == nullptr) look_internal::throwBadAlloc();
        std::memcpy(mPixels.get(), other.data(), bytes());
    }
    /// As they are made.
    Picture& operator=(Picture other) noexcept {
        swap(other);
        return *this;
    }
    ~Picture() = default;

    int width() const { return mWidth; }                 ///< pixels of a row
    int height() const { return mHeight; }               ///< rows
    int stride() const { return 4 * mWidth; }            ///< bytes from row to row
    bool isEmpty() const { return mPixels == nullptr; }  ///< without pixels

    int left() const { return mLeft; }  ///< of the left column, from the origin of the text
    int top() const { return mTop; }    ///< of the top row, from the origin of the text

    const unsigned char* data() const { return mPixels.get(); }  ///< null when it is empty
    unsigned char* data() { return mPixels.get(); }              ///< the same, to change them
    PictureView view() { return {data(), mWidth, mHeight}; }     ///< to paint on

    /// Lays it over the view, clipped, so that the origin of the text stands at (x, y): each channel
    /// becomes over + under * (255 - alpha) / 255, rounded to nearest, at most 255. Returns the box that
    /// was touched; nothing for a view that cannot be painted on. The view must not show this picture's
    /// own pixels: they would be changed while they are read.
    std::optional<Box> layOver(const PictureView& view, int x, int y) const {
        if (!look_internal::isUsable(view)) return std::nullopt;
        const look_internal::WideBox box{0, 0, mWidth, mHeight};
        return look_internal::Placed{data(), box.moved(std::int64_t{x} + mLeft, std::int64_t{y} + mTop)}
            .layOver(view)
            .narrow();
    }

  private:
    friend class Painter;

    std::size_t bytes() const {
        return std::size_t{4} * static_cast<unsigned>(mWidth) * static_cast<unsigned>(mHeight);
    }
    void swap(Picture& other) noexcept {
        mPixels.swap(other.mPixels);
        std::swap(mWidth, other.mWidth);
        std::swap(mHeight, other.mHeight);
        std::swap(mLeft, other.mLeft);
        std::swap(mTop, other.mTop);
    }
    /// Clear pixels; false when there is no memory for them.
    bool clear(const look_internal::WideBox& box) {
        mWidth = static_cast<int>(box.width());
        mHeight = static_cast<int>(box.height());
        mLeft = static_cast<int>(box.left);
        mTop = static_cast<int>(box.top);
        mPixels.reset(static_cast<unsigned char*>(std::calloc(bytes(), 1)));
        return mPixels != nullptr;
    }

    look_internal::Pixels mPixels{nullptr, std::free};
    int mWidth = 0;
    int mHeight = 0;
    int mLeft = 0;
    int mTop = 0;
};

/// Paints in a look, or in a stack of looks, again and again: every time the same picture for the same
/// glyphs. It keeps its layers for the next time, as large as the largest so far. One that was moved
/// from paints nothing.
///
/// Gradients, patterns and what lies inside follow the box around all glyphs of a call.
class Painter {
  public:
    /// Of one look.
    explicit Painter(const Look& look) { addStage(look); }
    /// Of a stack of looks, the last on top; of none it paints nothing.
    explicit Painter(const std::vector<Look>& looks) {
        for (const Look& look : looks)
            addStage(look);
    }

    /// How far the looks paint beyond the glyphs, all of them together.
    Margins margins() const;

    /// Lays the painted glyphs over the view, clipped, so that the origin of the text stands at (x, y).
    /// The looks are painted one after the other, each laid over what is there: each channel becomes
    /// over + under * (255 - alpha) / 255, rounded to nearest, at most 255.
    ///
    /// Returns the box that holds all that was touched; an empty one when there is nothing to paint, or
    /// none of it lies within the view. Returns nothing, with the view as it was, where failure() tells
    /// why. An effect that memory runs out for while it paints is missing, the others are there.
    std::optional<Box> paint(Glyphs glyphs, const PictureView& view, int x = 0, int y = 0);

    /// Paints a picture of its own, just large enough for the box of the glyphs and the margins. It is
    /// empty when there is nothing to paint. Returns nothing where failure() tells why.
    std::optional<Picture> paint(Glyphs glyphs);

    /// Why the last call painted nothing.
    Failure failure() const { return mFailure; }

  private:
    using Stage = look_internal::Stage;
    using WideBox = look_internal::WideBox;

    void addStage(const Look& look);
    std::nullopt_t fail(Failure why) {
        mFailure = why;
        return std::nullopt;
    }
    Failure measure(Glyphs glyphs);
    static Failure grow(WideBox& ink, const Glyph& glyph);
    static void size(VFBitmap& layer, const WideBox& box);
    static bool clearLayer(Stage& stage);
    static bool paintRun(Stage& stage, Glyphs glyphs, VFBitmap& layer);
    static bool paintLayer(Stage& stage, Glyphs glyphs);
    bool paintLowest(Picture& picture, Glyphs glyphs, const WideBox& box);
    static void draw(VFEffect& set, const Glyph& glyph, const WideBox& box);
    WideBox layOver(const PictureView& view, std::int64_t x, std::int64_t y) const;

    std::vector<std::unique_ptr<Stage>> mStages;
    WideBox mInk;  ///< the box around the glyphs of a call
    Failure mFailure = Failure::none;
};

/// Paints once; see Painter.
inline std::optional<Box> paint(const Look& look, Glyphs glyphs, const PictureView& view, int x = 0,
                                int y = 0) {
    return Painter(look).paint(glyphs, view, x, y);
}

/// Paints a stack of looks once, the last on top; see Painter.
inline std::optional<Box> paint(const std::vector<Look>& looks, Glyphs glyphs, const PictureView& view,
                                int x = 0, int y = 0) {
    return Painter(looks).paint(glyphs, view, x, y);
}

/// Paints a picture of its own once; see Painter.
inline std::optional<Picture> paint(const Look& look, Glyphs glyphs) {
    return Painter(look).paint(glyphs);
}

/// Paints a stack of looks, the last on top, into a picture of its own once; see Painter.
inline std::optional<Picture> paint(const std::vector<Look>& looks, Glyphs glyphs) {
    return Painter(looks).paint(glyphs);
}

inline void Look::describe(VFEffect& set) const {
    const look_internal::AddCalls calls(set);
    set.setTextOpacity(shownTextOpacity());
    for (const Data& effect : mEffects)
        calls.add(effect);
    calls.fill(mFill, look_internal::product(mFillOpacity, shownTextOpacity()));
}

inline Margins Look::margins() const {
    VFEffect set;
    describe(set);
    return look_internal::marginsOf(set);
}

inline std::string Look::key() const {
    VFEffect set;
    describe(set);
    const std::unique_ptr<char[]> designed(set.getMapKey());
    if (designed == nullptr) look_internal::throwBadAlloc();
    std::string key(designed.get());
    look_internal::KeyWriter writer(key, set);
    for (const Data& effect : mEffects)
        writer.add(effect);
    if (shownTextOpacity() < 1.0F) writer.cutOut();
    return key;
}

inline void Painter::addStage(const Look& look) {
    mStages.push_back(std::make_unique<Stage>());
    look.describe(mStages.back()->set);
    mStages.back()->margins = look_internal::marginsOf(mStages.back()->set);
}

inline Margins Painter::margins() const {
    Margins most;
    for (const std::unique_ptr<Stage>& stage : mStages) {
        const Margins& own = stage->margins;
        most = {std::max(most.left, own.left), std::max(most.top, own.top),
                std::max(most.right, own.right), std::max(most.bottom, own.bottom)};
    }
    return most;
}

inline Failure Painter::grow(WideBox& ink, const Glyph& glyph) {
    if (glyph.width < 0 || glyph.height < 0) return Failure::badArgument;
    if (glyph.width == 0 || glyph.height == 0) return Failure::none;
    if (!look_internal::areRows(glyph.coverage, glyph.width, glyph.height, 1, glyph.stride))
        return Failure::badArgument;
    if (std::max(glyph.width, glyph.height) > look_internal::kLargestGlyph) return Failure::tooLarge;
    ink.grow(WideBox{0, 0, glyph.width, glyph.height}.moved(glyph.x, glyph.y));
    return Failure::none;
}

inline Failure Painter::measure(Glyphs glyphs) {
    mInk = {};
    for (const Glyph& glyph : glyphs) {
        const Failure failure = grow(mInk, glyph);
        if (failure != Failure::none) return failure;
    }
    for (const std::unique_ptr<Stage>& stage : mStages) {
        stage->isPainted = false;
        stage->box = mInk.grownBy(stage->margins);
        if (!stage->box.fitsALayer()) return Failure::tooLarge;
    }
    return Failure::none;
}

inline void Painter::size(VFBitmap& layer, const WideBox& box) {
    layer.mWidth = static_cast<unsigned int>(box.width());
    layer.mHeight = static_cast<unsigned int>(box.height());
    layer.mBytesPerPixel = 4;
}

inline bool Painter::clearLayer(Stage& stage) {
    VFBitmap& layer = stage.layer;
    size(layer, stage.box);
    const std::size_t bytes = std::size_t{4} * layer.mWidth * layer.mHeight;
    if (bytes <= stage.capacity) {
        std::memset(layer.mData, 0, bytes);
        return true;
    }
    std::free(layer.mData);
    layer.mData = static_cast<unsigned char*>(std::calloc(bytes, 1));
    stage.capacity = layer.mData == nullptr ? 0 : bytes;
    return layer.mData != nullptr;
}

/// Rows that do not stand back to back are drawn one by one: the library takes packed ones.
inline void Painter::draw(VFEffect& set, const Glyph& glyph, const WideBox& box) {
    if (glyph.width == 0 || glyph.height == 0) return;
    const auto x = static_cast<int>(glyph.x - box.left);
    const auto y = static_cast<int>(glyph.y - box.top);
    const auto width = static_cast<unsigned short>(glyph.width);
    // The library reads the coverage without changing it, but takes a pointer to mutable bytes.
    auto* const coverage = const_cast<unsigned char*>(glyph.coverage);
    const std::ptrdiff_t stride = look_internal::strideOf(glyph.width, 1, glyph.stride);
    if (stride == glyph.width) {
        VFGlyph whole = {coverage, width, static_cast<unsigned short>(glyph.height)};
        set.renderEffectLayer(x, y, &whole);
        return;
    }
    for (int row = 0; row < glyph.height; ++row) {
        VFGlyph line = {coverage + row * stride, width, 1};
        set.renderEffectLayer(x, y + row, &line);
    }
}

inline bool Painter::paintRun(Stage& stage, Glyphs glyphs, VFBitmap& layer) {
    VFEffect& set = stage.set;
    set.initEffect(static_cast<int>(layer.mWidth), static_cast<int>(layer.mHeight));
    const VFBitmap* const mask = set.getSrcBitmap();
    if (mask == nullptr || mask->mData == nullptr) {
        set.releaseBitmap();
        return false;
    }
    set.setDstBitmap(&layer);
    for (const Glyph& glyph : glyphs)
        draw(set, glyph, stage.box);
    set.doEffectPostProcessing();
    set.compositeLayers(&layer);
    return true;
}

inline bool Painter::paintLayer(Stage& stage, Glyphs glyphs) {
    stage.isPainted = clearLayer(stage) && paintRun(stage, glyphs, stage.layer);
    return stage.isPainted;
}

/// The lowest look paints right into the picture.
inline bool Painter::paintLowest(Picture& picture, Glyphs glyphs, const WideBox& box) {
    Stage& lowest = *mStages.front();
    lowest.box = box;
    VFBitmap layer;
    size(layer, box);
    layer.mData = picture.data();
    const bool isPainted = paintRun(lowest, glyphs, layer);
    layer.mData = nullptr;  // the picture's
    return isPainted;
}

inline look_internal::WideBox Painter::layOver(const PictureView& view, std::int64_t x,
                                               std::int64_t y) const {
    WideBox touched;
    for (const std::unique_ptr<Stage>& stage : mStages) {
        if (!stage->isPainted) continue;
        const WideBox seen =
            look_internal::Placed{stage->layer.mData, stage->box.moved(x, y)}.layOver(view);
        if (!seen.isEmpty()) touched.grow(seen);
    }
    return touched;
}

/// All layers are painted before the first is laid: the view is as it was where one of them fails.
inline std::optional<Box> Painter::paint(Glyphs glyphs, const PictureView& view, int x, int y) {
    if (!look_internal::isUsable(view)) return fail(Failure::badArgument);
    mFailure = measure(glyphs);
    if (mFailure != Failure::none) return std::nullopt;
    if (mInk.isEmpty()) return Box{};
    for (const std::unique_ptr<Stage>& stage : mStages) {
        if (stage->box.moved(x, y).within(view).isEmpty()) continue;
        if (!paintLayer(*stage, glyphs)) return fail(Failure::noMemory);
    }
    return layOver(view, x, y).narrow();
}

inline std::optional<Picture> Painter::paint(Glyphs glyphs) {
    mFailure = measure(glyphs);
    if (mFailure != Failure::none) return std::nullopt;
    Picture picture;
    if (mInk.isEmpty() || mStages.empty()) return picture;
    const WideBox box = mInk.grownBy(margins());
    constexpr std::int64_t kLowest = -look_internal::kMostBytes - 1;
    if (!box.fitsALayer() || box.left < kLowest || box.top < kLowest) return fail(Failure::tooLarge);
    if (!picture.clear(box) || !paintLowest(picture, glyphs, box)) return fail(Failure::noMemory);
    for (std::size_t i = 1; i < mStages.size(); ++i)
        if (!paintLayer(*mStages[i], glyphs)) return fail(Failure::noMemory);
    layOver(picture.view(), -box.left, -box.top);
    return picture;
}

/// \cond
}  // namespace VOREL_LOOK
#undef VOREL_LOOK
#undef VOREL_LOOK_OF
#undef VOREL_LOOK_JOINED
#undef VOREL_POINTED_TO
/// \endcond

}  // namespace VFontEffect
