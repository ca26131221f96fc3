#include "style/write_cpp.h"

#include <array>
#include <cstdio>
#include <string_view>
#include <utility>
#include <variant>

#include "style/error.h"
#include "style/message.h"
#include "style/note.h"
#include "style/resolved_style.h"
#include "style/stack.h"

namespace vorelstyle {
namespace {

constexpr size_t kMaxPatternPixels = size_t{1} << 16;
constexpr size_t kBytesPerLine = 16;

constexpr const char* kHowToPaint =
    R"(/// In the order of painting. A look paints each of its spans (block, line, word or glyph), in
/// reading order, as a run into a transparent picture of its own, which, moved by the look's offset,
/// is laid over what is painted before: each premultiplied channel becomes
/// source + destination * (255 - source alpha) / 255, rounded to nearest.
)";

/// The shortest spelling that is read as the very same float: 0.6F, 100.
std::string literal(float value) {
    const std::string digits = spelled(value);
    const bool whole = digits.find_first_of(".e") == std::string::npos;
    return digits + (whole ? "" : "F");
}

std::string literal(int value) {
    return std::to_string(value);
}

/// 0xRRGGBB.
std::string colourLiteral(uint32_t colour) {
    std::array<char, 16> text{};
    std::snprintf(text.data(), text.size(), "0x%06X", colour);
    return text.data();
}

/// A sentence in one line. A comment must not end with a backslash, which would take the next line in.
std::string sentence(const std::string& text) {
    const bool ended = !text.empty() && text.back() == '.';
    return printable(text) + (ended ? "" : ".");
}

/// What is written, from the front to the back.
class Source {
  public:
    Source& operator<<(std::string_view piece) {
        mText += piece;
        return *this;
    }
    Source& operator<<(char letter) {
        mText += letter;
        return *this;
    }

    const std::string& text() const { return mText; }

  private:
    std::string mText;
};

/// Writes the call of one effect, with the array that it needs before it.
class CallWriter {
  public:
    CallWriter(Source& out, const TextPaint& text, const LoadImage& load)
        : mOut(out), mText(text), mLoad(load) {}

    void operator()(const OuterShadow& e) const { shadow("addOuterShadowText", e); }
    void operator()(const InnerShadow& e) const { shadow("addInnerShadowText", e); }
    void operator()(const OuterGlow& e) const { glow("addOuterGlowText", "outerGlowStops", e); }
    void operator()(const InnerGlow& e) const { glow("addInnerGlowText", "innerGlowStops", e); }
    void operator()(const Bevel& e) const { relief("addBevelText", e); }
    void operator()(const Emboss& e) const { relief("addEmbossText", e); }
    void operator()(const LinearGradient& e) const {
        const std::string array = stops("linearStops", e.gradient);
        call("addLinearGradientText", literal(e.angle), literal(e.scale), literal(e.opacity), array);
    }
    void operator()(const RadialGradient& e) const {
        const std::string array = stops("radialStops", e.gradient);
        call("addRadialGradientText", literal(e.scale), literal(e.opacity), array);
    }
    void operator()(const Stroke& e) const {
        call("addStrokeText", literal(e.size.value), colourLiteral(e.color), literal(e.opacity),
             literal(e.strokeStyle), literal(e.position));
    }
    void operator()(const Pattern& e) const {
        const PatternImage image = patternImage(e, mLoad);
        pixels(e, image);
        const float scale = patternScale(e, image, [](const std::string&) {});
        call("addPatternText", "&pattern", literal(scale), literal(e.opacity));
    }
    void operator()(const TextFill& e) const { fill(e.opacity * mText.opacity); }

    void fill(float opacity) const { call("addText", colourLiteral(mText.fill), literal(opacity)); }

  private:
    template <typename... Arguments>
    void call(const char* name, const std::string& first, const Arguments&... others) const {
        mOut << "    look." << name << "(" << first;
        ((mOut << ", " << others), ...);
        mOut << ");\n";
    }

    void shadow(const char* name, const Shadow& e) const {
        call(name, literal(e.angle), literal(e.distance.value), literal(e.size.value),
             colourLiteral(e.color), literal(e.opacity));
    }

    void glow(const char* name, const char* arrayName, const Glow& e) const {
        const std::string array = stops(arrayName, e.gradient);
        call(name, literal(e.size.value), colourLiteral(e.color), literal(e.opacity), array);
    }

    void relief(const char* name, const Relief& e) const {
        mOut << "    // The library has no core for this one: it leaves no mark.\n";
        call(name, literal(e.style), literal(e.size.value), literal(e.depth), literal(e.technique),
             literal(e.direction), literal(e.soften), literal(e.opacity), literal(e.angle),
             literal(e.altitude), colourLiteral(e.highlightColor), literal(e.highlightOpacity),
             colourLiteral(e.shadowColor), literal(e.shadowOpacity));
    }

    /// Writes the array of the stops and returns the two arguments that hand it over.
    std::string stops(const char* name, const Stops& stops) const {
        if (stops.empty()) return "0, nullptr";
        mOut << "    VFontEffect::VFGradient " << name << "[] = {\n";
        for (const VFontEffect::VFGradient& stop : stops) {
            mOut << "        {" << colourLiteral(stop.mColor) << ", " << literal(stop.mOpacity) << ", "
                 << literal(stop.mLocation) << "},\n";
        }
        mOut << "    };\n";
        return std::to_string(stops.size()) + ", " + name;
    }

    void pixels(const Pattern& e, const PatternImage& image) const {
        if (image.pixels.size() > kMaxPatternPixels * 4) {
            throw StyleError("pattern.image: has more than " + std::to_string(kMaxPatternPixels) +
                             " pixels, too many to be written as C++");
        }
        mOut << "    // " << printable(e.image)
             << " as A, R, G, B\n    static unsigned char pixels[] = {";
        for (size_t at = 0; at < image.pixels.size(); ++at) {
            mOut << (at % kBytesPerLine == 0 ? "\n        " : " ") << literal(int{image.pixels[at]})
                 << ',';
        }
        mOut << "\n    };\n    VFontEffect::VFBitmap pattern(" << literal(image.width) << ", "
             << literal(image.height) << ", pixels, 4);\n";
    }

    Source& mOut;
    const TextPaint& mText;
    const LoadImage& mLoad;
};

/// Writes the function that makes the calls of one look.
void writeLook(Source& out, const std::string& name, const LookStyle& look,
               const std::string& description, const TextPaint& text, const LoadImage& load) {
    requireResolved(look);
    if (!description.empty()) out << "/// " << sentence(description) << '\n';
    out << "/// For an empty set; VFEffect.h shows how a set paints a run.\nvoid " << name
        << "(VFontEffect::VFEffect& look) {\n    look.setTextOpacity(" << literal(text.opacity)
        << ");\n";
    const CallWriter writer(out, text, load);
    for (const Effect& effect : look.effects)
        std::visit(writer, effect);
    if (!hasTextFill(look)) writer.fill(text.opacity);
    out << "}\n";
}

std::string nameOfLook(const std::string& name, size_t position) {
    return name + std::to_string(position + 1);
}

/// Writes the array that tells the looks and their places.
void writePlaces(Source& out, const std::string& name, const std::string& description,
                 const std::vector<Place>& places) {
    std::string type = name + "Look";
    if (type.front() >= 'a' && type.front() <= 'z')
        type.front() = static_cast<char>(type.front() - 'a' + 'A');
    const std::string array = type + " " + name + "Looks[" + std::to_string(places.size()) + "]";
    out << "/// One look of the stack and its place.\nstruct " << type << " {\n"
        << "    void (*add)(VFontEffect::VFEffect& look);\n"
        << "    int offsetX;  // in pixels, to the right\n"
        << "    int offsetY;  // in pixels, downwards\n"
        << "    const char* span;  // what is one run, with a text box of its own\n};\n\n";
    if (!description.empty()) out << "/// " << sentence(description) << '\n';
    out << kHowToPaint << "extern const " << array << ";\nconst " << array << " = {\n";
    for (size_t i = 0; i < places.size(); ++i) {
        const Place& place = places[i];
        out << "    {" << nameOfLook(name, i) << ", " << literal(place.offsetX) << ", "
            << literal(place.offsetY) << ", \"" << kSpanNames[static_cast<size_t>(place.span)]
            << "\"},\n";
    }
    out << "};\n";
}

}  // namespace

std::string writtenAsCpp(const std::string& name, const Style& style, std::optional<uint32_t> fill,
                         std::optional<float> textOpacity, const LoadImage& load) {
    Source out;
    const std::vector<Place> places = placesOf(style);
    const bool isOne = isOneInItsPlace(places);
    out << "#include <voreleffect/voreleffect.h>\n\n";
    for (size_t i = 0; i < style.looks.size(); ++i) {
        const LookStyle& look = style.looks[i];
        withFaultsUnder(faultPrefix(style.name) + lookPath(style, i), [&] {
            const TextPaint text = textPaintOf(style, i, fill, textOpacity);
            const bool takesStyles = isOne && look.description.empty();
            writeLook(out, isOne ? name : nameOfLook(name, i), look,
                      takesStyles ? style.description : look.description, text, load);
        });
        if (!isOne) out << '\n';
    }
    if (!isOne) writePlaces(out, name, style.description, places);
    return out.text();
}

std::string functionName(const std::string& look) {
    std::string name = "add";
    bool startsWord = true;
    for (const char c : look) {
        const bool lower = c >= 'a' && c <= 'z';
        const bool upper = c >= 'A' && c <= 'Z';
        const bool digit = c >= '0' && c <= '9';
        if (lower || upper || digit) name += static_cast<char>(lower && startsWord ? c - 'a' + 'A' : c);
        startsWord = !(lower || upper || digit);
    }
    return name == "add" ? "addLook" : name;
}

}  // namespace vorelstyle
