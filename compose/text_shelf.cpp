#include "compose/text_shelf.h"

#include <optional>
#include <utility>

namespace vorelcompose {

bool TextShelf::Key::operator==(const Key& other) const {
    return text == other.text && numbers == other.numbers && features == other.features &&
           fonts == other.fonts;
}

std::shared_ptr<const SetText> TextShelf::text(const Request& request, FontShelf& fonts,
                                               const SourceText& source) {
    const Key key{source.text(), fonts.keyOf(request), request.features, numbersOf(request)};
    std::shared_ptr<const SetText> kept = mTexts.find(key);
    if (kept) return kept;
    kept = std::make_shared<const SetText>(setToFit(request, fonts, source));
    if (kept->layout().glyphCount() <= kMostGlyphs) mTexts.keep(key, kept);
    return kept;
}

/// All that a text is set by beside its words and fonts. Whole numbers are small enough to be floats.
std::vector<float> TextShelf::numbersOf(const Request& request) {
    const auto side = [](std::optional<int> length) { return static_cast<float>(length.value_or(0)); };
    return {static_cast<float>(request.size),
            static_cast<float>(request.align),
            request.lineHeight,
            request.letterSpacing.value,
            static_cast<float>(request.letterSpacing.unit),
            static_cast<float>(request.fit),
            static_cast<float>(request.box),
            side(request.canvas.width),
            side(request.canvas.height),
            static_cast<float>(request.canvas.margin)};
}

}  // namespace vorelcompose
