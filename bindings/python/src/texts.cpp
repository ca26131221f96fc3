#include "texts.h"

#include <pybind11/stl.h>

#include <cmath>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "arrays.h"
#include "benches.h"
#include "compose/vorelcompose.h"
#include "native_look.h"
#include "native_style.h"
#include "unicode/utf8.h"
#include "without_gil.h"

namespace vorelpython {
namespace {

using vorelcompose::Background;
using vorelcompose::Composition;
using vorelcompose::FoundStyle;
using vorelcompose::Limits;
using vorelcompose::Request;
using voreltext::Image;

/// The benches of this process. A child that was forked has its own: those of its parent may have been
/// in the hands of a thread that it has not, and stay as they are.
Benches*& benches() {
    static auto* benches = new Benches;
    return benches;
}

/// A workbench for the time of one call.
class BenchOfCall {
  public:
    explicit BenchOfCall(Benches& benches) : mBenches(benches), mBench(benches.take()) {}
    ~BenchOfCall() { mBenches.giveBack(std::move(mBench)); }
    BenchOfCall(const BenchOfCall&) = delete;
    BenchOfCall& operator=(const BenchOfCall&) = delete;

    vorelcompose::Workbench& bench() { return *mBench; }

  private:
    Benches& mBenches;
    Benches::Bench mBench;
};

/// The arguments of a call by their names.
class Arguments {
  public:
    explicit Arguments(const py::dict& given) : mGiven(given) {}

    bool has(const char* name) const { return !mGiven[name].is_none(); }

    template <typename Value>
    Value value(const char* name) const {
        return mGiven[name].cast<Value>();
    }

    int whole(const char* name, const Limits<int>& limits) const {
        const int number = integer(mGiven[name], name);
        requireWithin(name, "no whole number from ", limits, number);
        return number;
    }
    std::optional<int> wholeIfAny(const char* name, const Limits<int>& limits) const {
        return has(name) ? std::optional<int>(whole(name, limits)) : std::nullopt;
    }

    float number(const char* name, const Limits<float>& limits) const {
        const auto number = static_cast<float>(value<double>(name));
        requireWithin(name, "no number from ", limits, number);
        return number;
    }
    std::optional<float> numberIfAny(const char* name, const Limits<float>& limits) const {
        return has(name) ? std::optional<float>(number(name, limits)) : std::nullopt;
    }

    template <typename Words>
    auto word(const char* name, const Words& words) const {
        const auto given = value<std::string>(name);
        std::vector<std::string_view> names;
        for (const auto& [word, meaning] : words) {
            if (given == word) return meaning;
            names.emplace_back(word);
        }
        fail(name, "'" + given + "' is " + vorelstyle::noneOf(given, names));
    }

    [[noreturn]] static void fail(const char* name, const std::string& what) {
        throw py::value_error(std::string(name) + ": " + what);
    }

  private:
    template <typename Number>
    void requireWithin(const char* name, const char* refusal, const Limits<Number>& limits,
                       Number number) const {
        if (contains(limits, number)) return;
        fail(name, std::string(py::str(mGiven[name])) + " is " + refusal + spelled(limits));
    }

    const py::dict& mGiven;
};

vorelstyle::Length letterSpacingOf(const Arguments& given) {
    constexpr const char* kName = "letter_spacing";
    const auto [value, isPercent] = given.value<std::pair<double, bool>>(kName);
    const auto number = static_cast<float>(value);
    if (!contains(vorelcompose::kLetterSpacing, number)) {
        Arguments::fail(kName, "no length from " + spelled(vorelcompose::kLetterSpacing) +
                                   " in pixels or, with a %, in percent");
    }
    return {number, isPercent ? vorelstyle::Length::Unit::percent : vorelstyle::Length::Unit::pixels};
}

std::vector<std::string> fontsOf(const Arguments& given) {
    auto fonts = given.value<std::vector<std::string>>("font");
    if (fonts.empty()) Arguments::fail("font", "none is given");
    if (fonts.size() > vorelcompose::kMostFonts) {
        Arguments::fail("font",
                        "a text has at most " + std::to_string(vorelcompose::kMostFonts) + " fonts");
    }
    for (const std::string& font : fonts) {
        if (font.find('\0') != std::string::npos) Arguments::fail("font", "has a NUL character");
    }
    return fonts;
}

std::vector<voreltext::FontVariation> variationsOf(const Arguments& given) {
    std::vector<voreltext::FontVariation> variations;
    for (const auto& [axis, value] :
         given.value<std::vector<std::pair<std::string, float>>>("variations")) {
        if (axis.size() != 4) Arguments::fail("variations", "'" + axis + "' is no axis of four letters");
        variations.push_back({axis, value});
    }
    return variations;
}

voreltext::CanvasRequest canvasOf(const Arguments& given) {
    return {given.wholeIfAny("width", vorelcompose::kCanvasSide),
            given.wholeIfAny("height", vorelcompose::kCanvasSide),
            given.word("anchor", vorelcompose::kAnchors), given.whole("margin", vorelcompose::kMargin),
            given.whole("padding", vorelcompose::kPadding)};
}

Request requestOf(const Arguments& given) {
    Request request;
    request.fonts = fontsOf(given);
    request.features = given.value<std::vector<std::string>>("features");
    request.variations = variationsOf(given);
    request.size = given.whole("size", vorelcompose::kFontSize);
    request.align = given.word("align", vorelcompose::kAligns);
    request.lineHeight = given.number("line_height", vorelcompose::kLineHeight);
    request.letterSpacing = letterSpacingOf(given);
    request.color = given.value<std::optional<uint32_t>>("color");
    request.opacity = given.numberIfAny("opacity", vorelcompose::kOpacity);
    request.effectScale = given.number("effect_scale", vorelcompose::kEffectScale);
    request.canvas = canvasOf(given);
    request.fit = given.word("fit", vorelcompose::kFits);
    request.box = given.word("box", vorelcompose::kBoxes);
    request.strict = given.value<bool>("strict");
    checkCanvas(request);
    return request;
}

std::string textOf(const Arguments& given) {
    auto text = given.value<std::string>("text");
    if (text.size() > vorelcompose::kMaxTextBytes) {
        Arguments::fail(
            "text", "longer than " + std::to_string(vorelcompose::kMaxTextBytes) + " bytes of UTF-8");
    }
    return text;
}

/// Of a NativeStyle, or of a list of looks.
FoundStyle styleOf(const py::object& look) {
    if (py::isinstance<NativeStyle>(look)) return look.cast<const NativeStyle&>().found;
    const auto looks = look.cast<std::vector<std::shared_ptr<NativeLook>>>();
    if (looks.empty()) return {std::make_shared<vorelstyle::Style>(), {}};
    return styleOf(looks);
}

std::optional<Background> backgroundOf(const Arguments& given) {
    const auto name = given.value<std::optional<std::string>>("background");
    if (!name) return std::nullopt;
    const std::optional<Background> background = vorelcompose::parseBackground(*name);
    if (!background) {
        Arguments::fail("background",
                        "'" + *name + "' is none of transparent, checkerboard, #RRGGBB, #RGB");
    }
    return background;
}

py::tuple tupleOf(const voreltext::Box& box, const voreltext::Canvas& canvas) {
    return py::make_tuple(box.left + canvas.x, box.top + canvas.y, box.right + canvas.x,
                          box.bottom + canvas.y);
}

/// What is known of a picture, in plain values: it outlives the fonts.
struct Facts {
    explicit Facts(const Composition& of)
        : canvas(of.canvas()),
          baseline(of.text().layout().lines().front().baseline + of.canvas().y),
          size(of.text().size()),
          ink(of.text().layout().inkBox()),
          box(of.text().box()),
          margins(of.margins()),
          key(of.looks().stack().key()),
          fonts(of.text().layout().fontsUsed()) {
        for (const voreltext::MissingCharacter& each : of.text().layout().missing())
            missing.push_back(vorelunicode::encoded(each.code));
        of.notes().giveTo([this](const std::string& note) { notes.push_back(note); });
    }

    voreltext::Canvas canvas;
    int baseline;
    int size;
    voreltext::Box ink;
    voreltext::Box box;
    voreltext::Margins margins;
    std::string key;
    std::vector<std::string> fonts;
    std::vector<std::string> missing;
    std::vector<std::string> notes;
};

struct Painted {
    Image image;
    Facts facts;
};

Painted painted(const Request& request, const std::string& text, bool hasMarkup, const FoundStyle& style,
                const std::optional<Background>& background) {
    const WithoutGil released;
    BenchOfCall call(*benches());
    const Composition composition(
        request, vorelcompose::SourceText(text, hasMarkup), [&] { return style; }, call.bench());
    Painted painted{composition.paint(), Facts(composition)};
    if (background) layOn(painted.image, *background);
    return painted;
}

py::str decoded(const std::string& bytes) {
    return py::reinterpret_steal<py::str>(
        PyUnicode_DecodeUTF8(bytes.data(), static_cast<py::ssize_t>(bytes.size()), "replace"));
}

py::list decoded(const std::vector<std::string>& texts) {
    py::list list;
    for (const std::string& text : texts)
        list.append(decoded(text));
    return list;
}

/// The pixels and what is known of them. Straight on a background, premultiplied without one.
py::tuple paintText(const py::dict& arguments, const py::object& look) {
    const Arguments given(arguments);
    Painted done = painted(requestOf(given), textOf(given), given.value<bool>("markup"), styleOf(look),
                           backgroundOf(given));
    const Facts& facts = done.facts;
    const voreltext::Margins& margins = facts.margins;
    const int width = done.image.width;
    const int height = done.image.height;
    return py::make_tuple(arrayOf<Image>(std::move(done.image), width, height,
                                         [](Image& image) { return image.pixels.data(); }),
                          facts.canvas.x, facts.canvas.y, facts.baseline, facts.size,
                          tupleOf(facts.ink, facts.canvas), tupleOf(facts.box, facts.canvas),
                          py::make_tuple(margins.left, margins.top, margins.right, margins.bottom),
                          py::bytes(facts.key), decoded(facts.fonts), decoded(facts.missing),
                          decoded(facts.notes));
}

}  // namespace

void defineTexts(py::module_& module) {
    benches();  // made before there are threads
    module.def("paint_text", paintText);
    module.def("after_fork_in_child", [] { benches() = new Benches; });
}

}  // namespace vorelpython
