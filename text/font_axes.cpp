#include "text/font_axes.h"

#include <ft2build.h>
#include FT_FREETYPE_H
#include FT_MULTIPLE_MASTERS_H

#include <cmath>

#include "text/error.h"
#include "unicode/decimal.h"

namespace voreltext {
namespace {

constexpr double kFixed = 65536;  ///< FreeType's units of places on axes

std::string tagOf(const FT_Var_Axis& axis) {
    std::string tag;
    for (int shift = 24; shift >= 0; shift -= 8)
        tag += static_cast<char>(axis.tag >> shift & 0xFF);
    return tag;
}

/// The axes of a face, none where it is no variable font.
class Axes {
  public:
    explicit Axes(FT_Face face) : mFace(face) {
        if (FT_Get_MM_Var(face, &mAxes) != 0) mAxes = nullptr;
    }
    ~Axes() {
        if (mAxes != nullptr) FT_Done_MM_Var(mFace->glyph->library, mAxes);
    }
    Axes(const Axes&) = delete;
    Axes& operator=(const Axes&) = delete;

    size_t count() const { return mAxes == nullptr ? 0 : mAxes->num_axis; }
    const FT_Var_Axis& operator[](size_t i) const { return mAxes->axis[i]; }

    /// The index of an axis, count() when there is none.
    size_t find(const std::string& tag) const {
        size_t i = 0;
        while (i < count() && tagOf((*this)[i]) != tag)
            ++i;
        return i;
    }

  private:
    FT_Face mFace;
    FT_MM_Var* mAxes = nullptr;
};

std::string placeText(FT_Fixed place) {
    return vorelunicode::decimal(static_cast<double>(place) / kFixed);
}

/// "wght 100 to 900, wdth 75 to 100".
std::string rangesOf(const Axes& axes) {
    std::string text;
    for (size_t i = 0; i < axes.count(); ++i) {
        text += (i == 0 ? "" : ", ") + tagOf(axes[i]) + " " + placeText(axes[i].minimum) + " to " +
                placeText(axes[i].maximum);
    }
    return text;
}

bool isWithin(const FT_Var_Axis& axis, double fixed) {
    return fixed >= static_cast<double>(axis.minimum) && fixed <= static_cast<double>(axis.maximum);
}

}  // namespace

void setAxes(FT_Face face, const std::vector<FontVariation>& variations, const std::string& subject) {
    const Axes axes(face);
    if (axes.count() == 0) {
        throw TextError(subject + "no variable font: it has no axis '" + variations.front().axis + "'");
    }
    std::vector<FT_Fixed> places(axes.count());
    FT_Get_Var_Design_Coordinates(face, static_cast<FT_UInt>(places.size()), places.data());
    for (const FontVariation& variation : variations) {
        const size_t axis = axes.find(variation.axis);
        if (axis == axes.count()) {
            throw TextError(subject + "a font without the axis '" + variation.axis + "'; it has " +
                            rangesOf(axes));
        }
        const double place = std::floor(double{variation.value} * kFixed + 0.5);
        if (!isWithin(axes[axis], place)) {
            throw TextError(subject + "a font without '" + variation.axis + "' of " +
                            vorelunicode::decimal(double{variation.value}) + "; it has " +
                            rangesOf(axes));
        }
        places[axis] = static_cast<FT_Fixed>(place);
    }
    if (FT_Set_Var_Design_Coordinates(face, static_cast<FT_UInt>(places.size()), places.data()) != 0) {
        throw TextError(subject + "a variable font that cannot be moved on its axes");
    }
}

}  // namespace voreltext
