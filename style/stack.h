#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "style/key_text.h"
#include "style/look.h"
#include "style/pattern_image.h"
#include "style/style.h"

namespace vorelstyle {

/// What the text of one look takes: its fill, 0xRRGGBB, and its opacity, 0 to 1.
struct TextPaint {
    uint32_t fill;
    float opacity;
};

/// What the look of a style at a position takes for its text, when a caller chooses `fill` and
/// `textOpacity`: they are those of the topmost look that is filled, and the others keep their own.
TextPaint textPaintOf(const Style& style, size_t position, std::optional<uint32_t> fill,
                      std::optional<float> textOpacity);

/// The places of the looks of a resolved style. Throws StyleError when an offset is no whole number of
/// pixels within kMaxOffset.
std::vector<Place> placesOf(const Style& style);

/// Whether these are the places of one look alone, which is not moved and of the whole block.
bool isOneInItsPlace(const std::vector<Place>& places);

/// One look of a stack and where it is painted: once for each span, a run with a text box of its own,
/// into a transparent picture that is then laid, moved by the offset, over the looks beneath.
struct StackedLook {
    Look look;
    Place place;
};

/// The looks of a style, ready to paint runs of text.
class Stack {
  public:
    /// The style is resolved (resolvedStyle). `fill`, 0xRRGGBB, and `textOpacity` overrule those of the
    /// topmost look that is filled. `load` is called, before this returns, for looks with a pattern
    /// only. Throws StyleError when a pattern has no picture, or a length is no number of pixels.
    explicit Stack(const Style& style, std::optional<uint32_t> fill = {},
                   std::optional<float> textOpacity = {}, const LoadImage& load = {});

    /// In the order of painting: the last one lies on top.
    std::vector<StackedLook>& looks() { return mLooks; }
    const std::vector<StackedLook>& looks() const { return mLooks; }

    /// The position of the topmost look that is filled; nothing when none is.
    std::optional<size_t> topFill() const { return mTopFill; }

    /// The cache key: the keys of the looks, the lowest first, each behind the fragment of its place
    /// (placeFragment). One look that is filled and not moved, of the whole block, has its own key
    /// alone. Stacks that differ in the offset or the span of a look, or in whether it is filled, never
    /// share a key.
    const std::string& key() const { return mKey; }

    /// Effects that this library has no core for, with their paths; they are not painted.
    const std::vector<std::string>& unpainted() const { return mUnpainted; }

    /// What is painted otherwise than the style asks for, a line each that begins with the path.
    const std::vector<std::string>& notes() const { return mNotes; }

  private:
    void add(const std::string& path, StackedLook stacked);

    std::vector<StackedLook> mLooks;
    std::optional<size_t> mTopFill;
    std::string mKey;
    std::vector<std::string> mUnpainted;
    std::vector<std::string> mNotes;
};

}  // namespace vorelstyle
