#include "style/stack.h"

#include <cmath>
#include <utility>

#include "style/error.h"
#include "style/message.h"
#include "style/resolved_style.h"

namespace vorelstyle {
namespace {

int wholeOffset(const Length& length, const char* key) {
    const bool isWhole = length.unit == Length::Unit::pixels && length.value == std::round(length.value);
    if (!isWhole || !(std::abs(length.value) <= static_cast<float>(kMaxOffset))) {
        throw StyleError(std::string(key) + ": is no whole number of pixels within " +
                         std::to_string(kMaxOffset));
    }
    return static_cast<int>(length.value);
}

}  // namespace

TextPaint textPaintOf(const Style& style, size_t position, std::optional<uint32_t> fill,
                      std::optional<float> textOpacity) {
    const LookStyle& look = style.looks[position];
    if (topFill(style) != position) return {fillOf(look), opacityOf(look)};
    return {fill.value_or(fillOf(look)), textOpacity.value_or(opacityOf(look))};
}

std::vector<Place> placesOf(const Style& style) {
    std::vector<Place> places;
    for (size_t i = 0; i < style.looks.size(); ++i) {
        const LookStyle& look = style.looks[i];
        withFaultsUnder(faultPrefix(style.name) + lookPath(style, i), [&] {
            places.push_back({wholeOffset(look.offsetX, "offset.x"),
                              wholeOffset(look.offsetY, "offset.y"), look.span, look.isFilled});
        });
    }
    return places;
}

bool isOneInItsPlace(const std::vector<Place>& places) {
    if (places.size() != 1) return false;
    const Place& place = places.front();
    return place.offsetX == 0 && place.offsetY == 0 && place.span == Span::block;
}

Stack::Stack(const Style& style, std::optional<uint32_t> fill, std::optional<float> textOpacity,
             const LoadImage& load)
    : mTopFill(vorelstyle::topFill(style)) {
    const std::vector<Place> places = placesOf(style);
    mLooks.reserve(places.size());
    for (size_t i = 0; i < places.size(); ++i) {
        const TextPaint text = textPaintOf(style, i, fill, textOpacity);
        const std::string path = lookPath(style, i);
        withFaultsUnder(faultPrefix(style.name) + path, [&] {
            add(path, {Look(style.looks[i], text.fill, text.opacity, load), places[i]});
        });
    }
    const bool isPlain = isOneInItsPlace(places) && places.front().isFilled;
    for (const StackedLook& stacked : mLooks) {
        if (!isPlain) mKey += placeFragment(stacked.place);
        mKey += stacked.look.key();
    }
}

void Stack::add(const std::string& path, StackedLook stacked) {
    for (const std::string& effect : stacked.look.unpainted())
        mUnpainted.push_back(path + effect);
    for (const std::string& note : stacked.look.notes())
        mNotes.push_back(path + note);
    mLooks.push_back(std::move(stacked));
}

}  // namespace vorelstyle
