#pragma once

#include <voreleffect/look.h>

#include <algorithm>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/random.h"

/// Looks described twice, in the modern face and by the classes, and what the classes make of them when
/// they are called by hand.
namespace vorel_test {

using VFontEffect::Box;
using VFontEffect::Glyph;
using VFontEffect::Look;
using VFontEffect::PictureView;
using VFontEffect::PixelOrder;
using VFontEffect::Position;
using VFontEffect::rgb;
using VFontEffect::VFBitmap;
using VFontEffect::VFEffect;
using VFontEffect::VFGlyph;
using VFontEffect::VFGradient;

/// Pixels with their size: a page to paint on, or a pattern.
struct Page {
    Page(int w, int h)
        : width(w), height(h), bytes(static_cast<size_t>(w) * static_cast<size_t>(h) * 4) {}

    unsigned char* at(int x, int y) {
        return &bytes[(static_cast<size_t>(y) * static_cast<size_t>(width) + static_cast<size_t>(x)) *
                      4];
    }
    const unsigned char* at(int x, int y) const { return const_cast<Page*>(this)->at(x, y); }
    PictureView view() { return {bytes.data(), width, height}; }
    bool holds(int64_t x, int64_t y) const { return x >= 0 && x < width && y >= 0 && y < height; }

    int width;
    int height;
    std::vector<unsigned char> bytes;
};

inline Page randomPage(Random& random, int width, int height) {
    Page page(width, height);
    for (unsigned char& byte : page.bytes)
        byte = random.byte();
    return page;
}

/// A look in both ways of describing it. The set is never planned; its fill is added last.
struct TwoLooks {
    Look look;
    VFEffect set;
};

/// Owns the coverage of its glyphs.
class Text {
  public:
    void add(int x, int y, int width, int height, std::vector<unsigned char> coverage, int stride = 0) {
        mCoverage.push_back(std::move(coverage));
        mGlyphs.push_back({x, y, mCoverage.back().data(), width, height, stride});
    }
    const std::vector<Glyph>& glyphs() const { return mGlyphs; }

  private:
    std::vector<std::vector<unsigned char>> mCoverage;
    std::vector<Glyph> mGlyphs;
};

/// Soft-edged blots with stretches of nothing and of full coverage; some with rows that lie apart.
inline Text randomText(Random& random, int most = 3) {
    Text text;
    for (int glyphs = random.between(1, most); glyphs > 0; --glyphs) {
        const int width = random.between(1, 14);
        const int height = random.between(1, 14);
        const int stride = random.chance(40) ? width + random.between(0, 5) : 0;
        const auto bytes = static_cast<size_t>(std::max(stride, width)) * static_cast<size_t>(height);
        std::vector<unsigned char> coverage(bytes);
        for (unsigned char& cell : coverage)
            cell = random.chance(30) ? random.byte() : random.chance(60) ? 255 : 0;
        text.add(random.between(-6, 30), random.between(-6, 20), width, height, std::move(coverage),
                 stride);
    }
    return text;
}

inline Box boxOf(const std::vector<Glyph>& glyphs) {
    Box box{glyphs[0].x, glyphs[0].y, glyphs[0].x, glyphs[0].y};
    for (const Glyph& glyph : glyphs) {
        box.left = std::min(box.left, glyph.x);
        box.top = std::min(box.top, glyph.y);
        box.right = std::max(box.right, glyph.x + glyph.width);
        box.bottom = std::max(box.bottom, glyph.y + glyph.height);
    }
    return box;
}

/// The glyph's rows without gaps.
inline std::vector<unsigned char> packed(const Glyph& glyph) {
    const std::ptrdiff_t stride = glyph.stride == 0 ? glyph.width : glyph.stride;
    std::vector<unsigned char> rows;
    for (int y = 0; y < glyph.height; ++y)
        rows.insert(rows.end(), glyph.coverage + y * stride, glyph.coverage + y * stride + glyph.width);
    return rows;
}

/// What the classes paint with `room` pixels around the glyphs, called one after the other on a copy.
inline Page paintedByHand(const VFEffect& look, const std::vector<Glyph>& glyphs, int room) {
    const Box box = boxOf(glyphs);
    Page page(box.right - box.left + 2 * room, box.bottom - box.top + 2 * room);
    VFEffect set(look);
    VFBitmap picture(static_cast<unsigned>(page.width), static_cast<unsigned>(page.height), 4);
    set.initEffect(page.width, page.height);
    set.setDstBitmap(&picture);
    for (const Glyph& glyph : glyphs) {
        std::vector<unsigned char> rows = packed(glyph);
        VFGlyph record = {rows.data(), static_cast<unsigned short>(glyph.width),
                          static_cast<unsigned short>(glyph.height)};
        set.renderEffectLayer(glyph.x - box.left + room, glyph.y - box.top + room, &record);
    }
    set.doEffectPostProcessing();
    set.compositeLayers(&picture);
    std::copy_n(picture.mData, page.bytes.size(), page.bytes.begin());
    return page;
}

/// The rule as it is told, one channel at a time.
inline unsigned char channelOver(unsigned over, unsigned under, unsigned alpha) {
    return static_cast<unsigned char>(std::min(255U, over + (under * (255 - alpha) + 127) / 255));
}

/// Lays R, G, B, A pixels over a page of either order with their top left corner at (left, top).
inline void layByHand(Page& page, const Page& over, int64_t left, int64_t top,
                      PixelOrder order = PixelOrder::rgba) {
    for (int y = 0; y < over.height; ++y) {
        for (int x = 0; x < over.width; ++x) {
            if (!page.holds(left + x, top + y)) continue;
            unsigned char* to = page.at(static_cast<int>(left + x), static_cast<int>(top + y));
            const unsigned char* from = over.at(x, y);
            for (int c = 0; c < 4; ++c) {
                const int source = order == PixelOrder::bgra && c < 3 ? 2 - c : c;
                to[c] = channelOver(from[source], to[c], from[3]);
            }
        }
    }
}

/// More than any effect of randomLook reaches.
constexpr int kRoomOfRandomLooks = 40;

/// A stack painted by the classes and laid over the page.
inline void paintByHand(const std::vector<const VFEffect*>& looks, const std::vector<Glyph>& glyphs,
                        Page& page, int x, int y, PixelOrder order = PixelOrder::rgba,
                        int room = kRoomOfRandomLooks) {
    const Box box = boxOf(glyphs);
    for (const VFEffect* look : looks)
        layByHand(page, paintedByHand(*look, glyphs, room), int64_t{x} + box.left - room,
                  int64_t{y} + box.top - room, order);
}

/// Random arguments of one effect, handed to both faces.
class RandomEffect {
  public:
    explicit RandomEffect(Random& random) : mRandom(random) {}

    void add(TwoLooks& looks) {
        switch (mRandom.between(0, 7)) {
            case 0:
                return addShadow<VFontEffect::OuterShadow>(looks, &VFEffect::addOuterShadowText);
            case 1:
                return addShadow<VFontEffect::InnerShadow>(looks, &VFEffect::addInnerShadowText);
            case 2:
                return addGlow<VFontEffect::OuterGlow>(looks, &VFEffect::addOuterGlowText);
            case 3:
                return addGlow<VFontEffect::InnerGlow>(looks, &VFEffect::addInnerGlowText);
            case 4:
                return addLinear(looks);
            case 5:
                return addRadial(looks);
            case 6:
                return addStroke(looks);
            default:
                return addPattern(looks);
        }
    }

  private:
    unsigned colour() { return mRandom.next() & 0xFFFFFF; }
    float opacity() { return mRandom.chance(40) ? 1.0F : mRandom.real(0, 1); }
    float size() { return mRandom.real(0, 9); }

    std::vector<VFGradient> stops(int fewest) {
        std::vector<VFGradient> drawn;
        for (int i = mRandom.between(fewest, 4); i > 0; --i)
            drawn.push_back({colour(), opacity(), mRandom.real(0, 1)});
        std::sort(drawn.begin(), drawn.end(),
                  [](const VFGradient& a, const VFGradient& b) { return a.mLocation < b.mLocation; });
        return drawn;
    }
    static std::vector<VFontEffect::Stop> modern(const std::vector<VFGradient>& stops) {
        std::vector<VFontEffect::Stop> list;
        for (const VFGradient& stop : stops)
            list.push_back({rgb(stop.mColor), stop.mOpacity, stop.mLocation});
        return list;
    }

    template <class Shadow, class Call>
    void addShadow(TwoLooks& looks, Call call) {
        const float angle = mRandom.real(-400, 400);
        const float distance = size();
        const float blur = size();
        const unsigned color = colour();
        const float o = opacity();
        looks.look.add(Shadow(rgb(color)).angle(angle).distance(distance).size(blur).opacity(o));
        (looks.set.*call)(angle, distance, blur, color, o);
    }
    template <class Glow, class Call>
    void addGlow(TwoLooks& looks, Call call) {
        const float reach = size();
        const unsigned color = colour();
        const float o = opacity();
        std::vector<VFGradient> list = stops(0);
        looks.look.add(Glow(reach, rgb(color)).opacity(o).stops(modern(list)));
        (looks.set.*call)(reach, color, o, static_cast<int>(list.size()), list.data());
    }
    void addLinear(TwoLooks& looks) {
        const float angle = mRandom.real(0, 360);
        const float scale = mRandom.real(0, 2);
        const float o = opacity();
        std::vector<VFGradient> list = stops(1);
        looks.look.add(VFontEffect::LinearGradient(modern(list)).angle(angle).scale(scale).opacity(o));
        looks.set.addLinearGradientText(angle, scale, o, static_cast<int>(list.size()), list.data());
    }
    void addRadial(TwoLooks& looks) {
        const float scale = mRandom.real(0, 2);
        const float o = opacity();
        std::vector<VFGradient> list = stops(1);
        looks.look.add(VFontEffect::RadialGradient(modern(list)).scale(scale).opacity(o));
        looks.set.addRadialGradientText(scale, o, static_cast<int>(list.size()), list.data());
    }
    void addStroke(TwoLooks& looks) {
        const float width = size();
        const unsigned color = colour();
        const float o = opacity();
        const int position = mRandom.between(0, 2);
        looks.look.add(
            VFontEffect::Stroke(width, rgb(color)).opacity(o).position(static_cast<Position>(position)));
        looks.set.addStrokeText(width, color, o, 0, position);
    }
    void addPattern(TwoLooks& looks) {
        Page pixels = randomPage(mRandom, mRandom.between(1, 6), mRandom.between(1, 6));
        const float scale = mRandom.real(0, 4);
        const float o = opacity();
        looks.look.add(VFontEffect::Pattern({pixels.bytes.data(), pixels.width, pixels.height})
                           .scale(scale)
                           .opacity(o));
        std::vector<unsigned char> argb;
        for (size_t i = 0; i < pixels.bytes.size(); i += 4)
            argb.insert(argb.end(), {pixels.bytes[i + 3], pixels.bytes[i], pixels.bytes[i + 1],
                                     pixels.bytes[i + 2]});
        VFBitmap bitmap(static_cast<unsigned>(pixels.width), static_cast<unsigned>(pixels.height),
                        argb.data(), 4);
        looks.set.addPatternText(&bitmap, scale, o);
    }

    Random& mRandom;
};

/// Up to five effects, the later of a kind replacing the earlier; the fill and the opacity of the text
/// stand anywhere among them in the modern face, and where they must for the classes.
inline TwoLooks randomLook(Random& random) {
    TwoLooks looks;
    const unsigned color = random.next() & 0xFFFFFF;
    const float fillOpacity = random.chance(50) ? 1.0F : random.real(0, 1);
    const float textOpacity = random.chance(60) ? 1.0F : random.real(0, 1);
    const bool isFilled = random.chance(80);
    const int effects = random.between(0, 5);
    const int placeOfFill = random.between(0, effects);
    const int placeOfOpacity = random.between(0, effects);
    RandomEffect effect(random);
    for (int i = 0; i <= effects; ++i) {
        if (i == placeOfFill) looks.look.fill(rgb(color), fillOpacity);
        if (i == placeOfOpacity) looks.look.textOpacity(textOpacity);
        if (i < effects) effect.add(looks);
    }
    if (!isFilled) looks.look.noFill();
    const float shown = isFilled ? textOpacity : 0.0F;
    looks.set.setTextOpacity(shown);
    looks.set.addText(color, fillOpacity * shown);
    return looks;
}

}  // namespace vorel_test
