#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "compose/font_shelf.h"
#include "compose/request.h"
#include "compose/set_text.h"
#include "compose/shelf.h"

namespace vorelcompose {

/// Texts that were set, kept for others that say the same in the same way: kMostTexts of at most
/// kMostGlyphs glyphs. For one thread.
class TextShelf {
  public:
    static constexpr size_t kMostTexts = 16;
    static constexpr size_t kMostGlyphs = 2000;

    /// As setToFit, which it asks where none is kept.
    std::shared_ptr<const SetText> text(const Request& request, FontShelf& fonts,
                                        const SourceText& source);

  private:
    struct Key {
        std::vector<uint32_t> text;
        FontsKey fonts;
        std::vector<std::string> features;
        std::vector<float> numbers;  ///< lengths and choices

        bool operator==(const Key& other) const;
    };

    static std::vector<float> numbersOf(const Request& request);

    Shelf<Key, const SetText> mTexts{kMostTexts};
};

}  // namespace vorelcompose
