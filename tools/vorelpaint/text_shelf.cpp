#include "text_shelf.h"

#include <optional>
#include <utility>

namespace vorelpaint {

bool TextShelf::Key::operator==(const Key& other) const {
    return text == other.text && numbers == other.numbers && features == other.features &&
           fonts == other.fonts;
}

std::shared_ptr<const SetText> TextShelf::text(const Options& options, FontShelf& fonts,
                                               const SourceText& source) {
    const Key key{source.text(), fonts.keyOf(options), options.features, numbersOf(options)};
    std::shared_ptr<const SetText> kept = mTexts.find(key);
    if (kept) return kept;
    kept = std::make_shared<const SetText>(setToFit(options, fonts, source));
    if (kept->layout().glyphCount() <= kMostGlyphs) mTexts.keep(key, kept);
    return kept;
}

/// All that a text is set by beside its words and fonts. Whole numbers are small enough to be floats.
std::vector<float> TextShelf::numbersOf(const Options& options) {
    const auto side = [](std::optional<int> length) { return static_cast<float>(length.value_or(0)); };
    return {static_cast<float>(options.size),
            static_cast<float>(options.align),
            options.lineHeight,
            options.letterSpacing.value,
            static_cast<float>(options.letterSpacing.unit),
            static_cast<float>(options.fit),
            static_cast<float>(options.box),
            side(options.canvas.width),
            side(options.canvas.height),
            static_cast<float>(options.canvas.margin)};
}

}  // namespace vorelpaint
