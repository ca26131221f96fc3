#include "settings.h"

#include <algorithm>
#include <array>
#include <sstream>
#include <string_view>
#include <utility>

#include "error.h"
#include "film_form.h"
#include "output_name.h"
#include "ranges.h"
#include "read_value.h"

namespace vorelpaint {
namespace {

using vorelstyle::Length;
using vorelstyle::parseColour;
using Read = Setting::Read;

template <typename Part>
Read flag(bool Part::*member) {
    return [member](Options& options, const std::string& given) { options.*member = given == "true"; };
}

template <typename Part, typename Member>
Read text(Member Part::*member) {
    return [member](Options& options, const std::string& given) { options.*member = given; };
}

template <typename Number, typename Part, typename Member>
Read numberWithin(const Limits<Number>& limits, Member Part::*member) {
    return
        [=](Options& options, const std::string& given) { options.*member = readNumber(limits, given); };
}

template <typename Member>
Read pixelsOfCanvas(const Limits<int>& limits, Member voreltext::CanvasRequest::*member) {
    return [=](Options& options, const std::string& given) {
        options.canvas.*member = readNumber(limits, given);
    };
}

/// Reads what `parse` understands.
template <typename Parse, typename Part, typename Member>
Read parsed(Parse parse, Member Part::*member, const char* refusal) {
    return [=](Options& options, const std::string& given) {
        const auto value = parse(given);
        if (!value) refuse(given, refusal);
        options.*member = *value;
    };
}

constexpr std::array<Word<PngEffort>, 3> kEfforts{
    {{"fast", PngEffort::fast}, {"normal", PngEffort::normal}, {"small", PngEffort::small}}};
constexpr std::array<Word<PictureOf>, 2> kPicturesOf{
    {{"frame", PictureOf::frame}, {"cue", PictureOf::cue}}};
constexpr std::array<Word<const char*>, 3> kShells{{{"bash", "bash"}, {"zsh", "zsh"}, {"fish", "fish"}}};

template <typename Words, typename Part, typename Member>
Read oneOf(const Words& words, Member Part::*member) {
    return [&words, member](Options& options, const std::string& given) {
        options.*member = wordAmong(words, given);
    };
}

void readSheetSizes(Options& options, const std::string& given) {
    options.sheetSizes.clear();
    for (const std::string& size : partsOf(given))
        options.sheetSizes.push_back(readNumber(kFontSize, size));
    if (!contains(kSheetSizes, options.sheetSizes.size()))
        refuse(given, "no list of " + spelled(kSheetSizes) + " sizes");
}

void readShard(Options& options, const std::string& given) {
    const size_t slash = given.find('/');
    const std::optional<int> index = numberIn<int>(std::string_view(given).substr(0, slash));
    const std::optional<int> count = slash == std::string::npos
                                         ? std::nullopt
                                         : numberIn<int>(std::string_view(given).substr(slash + 1));
    if (!index || !count || !contains(kShards, *count) || !contains({1, *count}, *index)) {
        refuse(given, "no shard I/N, as 2/8 is: N is " + spelled(kShards) + ", I is 1 to N");
    }
    options.shard = Shard{*index, *count};
}

void readVariations(Options& options, const std::string& given) {
    options.variations.clear();
    for (const std::string& part : partsOf(given)) {
        const size_t equals = part.find('=');
        const auto value = equals == 4 ? numberIn<float>(part.substr(equals + 1)) : std::nullopt;
        if (!value) refuse(given, "no list of AXIS=VALUE; an axis has four letters, as in wght=700");
        options.variations.push_back({part.substr(0, equals), *value});
    }
}

void readLetterSpacing(Options& options, const std::string& given) {
    const std::optional<float> pixels = numberIn<float>(given);
    const std::optional<Length> length = pixels ? Length{*pixels} : vorelstyle::parseLength(given);
    if (!length || !contains(kLetterSpacing, length->value)) {
        refuse(given,
               "no length from " + spelled(kLetterSpacing) + " in pixels or, with a %, in percent");
    }
    options.letterSpacing = *length;
}

void addFont(Options& options, const std::string& given) {
    if (options.fonts.size() == kMostFonts) {
        throw ToolError("a text has at most " + std::to_string(kMostFonts) + " fonts");
    }
    options.fonts.push_back(given);
}

/// Films have other endings. They are asked for by --subtitles, which stands before --output in the list
/// of settings, and so is read before it.
void readOutput(Options& options, const std::string& given) {
    if (!options.film.subtitles && namesOtherKind(given)) {
        refuse(given, "named like another kind of file; only PNG is written: end it with .png");
    }
    options.output = given;
}

/// An option that paints a picture, of a job as well as of the command line.
Setting pictureOption(const char* name, const std::string& value, const char* initial, const char* group,
                      const std::string& description, Read read,
                      Setting::Kind kind = Setting::Kind::text) {
    return {name, "", value, initial, group, description, kind, true, false, std::move(read)};
}

Setting pictureNumber(const char* name, const char* value, const char* initial, const char* group,
                      const std::string& description, Read read) {
    return pictureOption(name, value, initial, group, description, std::move(read),
                         Setting::Kind::number);
}

/// An option of the command line alone.
Setting programOption(const char* name, const std::string& value, const char* group,
                      const std::string& description, Read read) {
    const auto kind = value.empty() ? Setting::Kind::flag : Setting::Kind::text;
    return {name, "", value, "", group, description, kind, false, false, std::move(read)};
}

Setting pictureFlag(const char* name, const char* group, const std::string& description, Read read) {
    return pictureOption(name, "", "", group, description, std::move(read), Setting::Kind::flag);
}

std::vector<Setting> textSettings() {
    constexpr const char* kGroup = "Text";
    Setting words = pictureOption("text", "TEXT", "", kGroup, "The text; a line feed starts a new line",
                                  text(&Options::text));
    words.isPositional = true;
    return {
        words,
        pictureOption("text-file", "FILE", "", kGroup, "Read the text from FILE, - for standard input",
                      text(&Options::textFile)),
        pictureFlag("markup", kGroup,
                    "Read <c #RRGGBB>...</c> in the text as a colour; &lt;, &gt; and &amp; stand for "
                    "<, > and &",
                    flag(&Options::markup)),
        pictureOption("align", listed(kAligns, "|"), "left", kGroup,
                      "Where short lines stand; start and end go by the text's direction",
                      oneOf(kAligns, &Options::align)),
        pictureNumber("line-height", "FACTOR", "1", kGroup,
                      "Distance of the lines in line heights of the font, " + spelled(kLineHeight),
                      numberWithin(kLineHeight, &Options::lineHeight)),
        pictureOption("letter-spacing", "LENGTH", "0", kGroup,
                      "Room between letters, in pixels or percent of the size (3px, 5%), " +
                          spelled(kLetterSpacing),
                      readLetterSpacing, Setting::Kind::length)};
}

std::vector<Setting> fontSettings() {
    constexpr const char* kGroup = "Font";
    Setting fonts =
        pictureOption("font", "FONT", "DejaVu Sans", kGroup,
                      "Font file, or family such as 'DejaVu Sans:bold'; given up to " +
                          std::to_string(kMostFonts) + " times, each has what those before it lack",
                      addFont, Setting::Kind::list);
    fonts.forget = [](Options& options) { options.fonts.clear(); };
    return {
        fonts,
        pictureNumber("size", "PX", "96", kGroup, "Size of the font in pixels, " + spelled(kFontSize),
                      numberWithin(kFontSize, &Options::size)),
        pictureOption(
            "font-features", "LIST", "", kGroup, "OpenType features, such as liga=0,ss01",
            [](Options& options, const std::string& given) { options.features = partsOf(given); }),
        pictureOption("font-variations", "LIST", "", kGroup,
                      "Axes of the first font, such as wght=700,wdth=80", readVariations)};
}

std::vector<Setting> lookSettings() {
    constexpr const char* kGroup = "Look";
    return {pictureOption("style", "FILE", "", kGroup, "Read the effects from a style file (JSON)",
                          text(&Options::style)),
            pictureOption("preset", "PRESET", "", kGroup, "Take the effects of a preset",
                          text(&Options::preset)),
            pictureNumber("effect-scale", "FACTOR", "1", kGroup,
                          "Multiply the effects' sizes by " + spelled(kEffectScale),
                          numberWithin(kEffectScale, &Options::effectScale)),
            pictureOption("color", "#RRGGBB", "", kGroup,
                          "Fill of the topmost look that has one (the style's, else #000000)",
                          parsed(parseColour, &Options::color, "no colour; write #RRGGBB or #RGB")),
            pictureNumber("opacity", "NUMBER", "", kGroup,
                          "Opacity of that text, " + spelled(kOpacity) + " (the style's, else 1)",
                          numberWithin(kOpacity, &Options::opacity))};
}

std::vector<Setting> canvasSettings() {
    constexpr const char* kGroup = "Canvas";
    using voreltext::CanvasRequest;
    return {pictureNumber(
                "width", "PX", "", kGroup,
                "Width of the picture, " + spelled(kCanvasSide) + "; without it, what the text needs",
                pixelsOfCanvas(kCanvasSide, &CanvasRequest::width)),
            pictureNumber(
                "height", "PX", "", kGroup,
                "Height of the picture, " + spelled(kCanvasSide) + "; without it, what the text needs",
                pixelsOfCanvas(kCanvasSide, &CanvasRequest::height)),
            pictureOption("anchor", listed(kAnchors, "|"), "center", kGroup,
                          "Where the text stands in that width and height",
                          [](Options& options, const std::string& given) {
                              options.canvas.anchor = wordAmong(kAnchors, given);
                          }),
            pictureNumber("margin", "PX", "0", kGroup,
                          "Pixels between the text and the edges of that width and height, " +
                              spelled(kMargin) + "; effects reach into them",
                          pixelsOfCanvas(kMargin, &CanvasRequest::margin)),
            pictureOption("fit", listed(kFits, "|"), "none", kGroup,
                          "What is done with a text that is larger", oneOf(kFits, &Options::fit)),
            pictureOption("box", listed(kBoxes, "|"), "ink", kGroup,
                          "What counts as the text's box: its ink, or its lines, which have one height "
                          "whatever they say",
                          oneOf(kBoxes, &Options::box)),
            pictureNumber("padding", "PX", "8", kGroup,
                          "Pixels around the text and its effects where no width or height is given, " +
                              spelled(kPadding),
                          pixelsOfCanvas(kPadding, &CanvasRequest::padding))};
}

void addCueStyle(Options& options, const std::string& given) {
    const size_t equals = given.find('=');
    if (equals == 0 || equals == std::string::npos || equals + 1 == given.size()) {
        refuse(given, "no NAME=LOOK, such as Narrator=chalk");
    }
    options.film.cueStyles.push_back({given.substr(0, equals), given.substr(equals + 1)});
}

/// Takes a value over into what is asked of films.
Read ofFilm(const std::function<void(FilmOptions&, const std::string&)>& take) {
    return [take](Options& options, const std::string& given) { take(options.film, given); };
}

void readFrameRate(FilmOptions& film, const std::string& given) {
    film.rate = parseFrameRate(given);
    if (film.rate) return;
    refuse(given, "no frame rate from " + spelled(kFrameRates) + "; write 30 or 24000/1001");
}

void readCodec(FilmOptions& film, const std::string& given) {
    const std::vector<std::string>& names = filmCodecNames();
    if (std::find(names.begin(), names.end(), given) == names.end()) {
        refuse(given, "none of " + vorelstyle::joined(names));
    }
    film.codec = given;
}

/// "h264|vp9".
std::string codecWords() {
    std::string words;
    for (const std::string& name : filmCodecNames())
        words.append(words.empty() ? "" : "|").append(name);
    return words;
}

std::vector<Setting> cueSettings() {
    constexpr const char* kGroup = "Films";
    Setting styles =
        programOption("cue-style", "NAME=LOOK", kGroup,
                      "Paint cues of this name (WebVTT: class, voice or identifier; ASS: style or "
                      "speaker) in a preset or a style file, or with none not at all; of several "
                      "that fit, the first counts",
                      addCueStyle);
    styles.kind = Setting::Kind::list;
    styles.forget = [](Options& options) { options.film.cueStyles.clear(); };
    const std::string fades = "Milliseconds in which a cue appears, " + spelled(kFade);
    return {
        programOption(
            "subtitles", "FILE", kGroup, "Paint the cues of a .srt, .vtt or .ass file as a film",
            ofFilm([](FilmOptions& film, const std::string& given) { film.subtitles = given; })),
        styles,
        programOption("fade-in", "MS", kGroup, fades,
                      ofFilm([](FilmOptions& film, const std::string& given) {
                          film.fadeInMs = readNumber(kFade, given);
                      })),
        programOption("fade-out", "MS", kGroup, "Milliseconds in which it disappears, before its end",
                      ofFilm([](FilmOptions& film, const std::string& given) {
                          film.fadeOutMs = readNumber(kFade, given);
                      }))};
}

std::vector<Setting> filmSettings() {
    constexpr const char* kGroup = "Films";
    return {
        programOption("over", "FILE", kGroup, "Burn the cues into the pictures of this clip",
                      ofFilm([](FilmOptions& film, const std::string& given) { film.over = given; })),
        programOption("fps", "RATE", kGroup,
                      "Frames a second, such as 24 or 24000/1001 (the clip's, else 30)",
                      ofFilm(readFrameRate)),
        programOption("codec", codecWords(), kGroup,
                      "How the film is stored, where its ending leaves a choice", ofFilm(readCodec)),
        programOption("each", listed(kPicturesOf, "|"), kGroup,
                      "What a numbered output has a picture of (frame)",
                      ofFilm([](FilmOptions& film, const std::string& given) {
                          film.pictureOf = wordAmong(kPicturesOf, given);
                      }))};
}

std::vector<Setting> outputSettings() {
    constexpr const char* kGroup = "Picture";
    Setting output = pictureOption(
        "output", "FILE", "", kGroup,
        "The PNG file to write, - for standard output; of --subtitles a .mp4, .mov, .mkv or .webm, "
        "numbered pictures (frame_%05d.png) or raw frames (-, .rgba)",
        readOutput);
    output.letter = "o";
    return {output,
            pictureOption("background", "transparent|checkerboard|#RRGGBB", "transparent", kGroup,
                          "What lies behind the text",
                          parsed(parseBackground, &Options::background,
                                 "none of transparent, checkerboard, #RRGGBB, #RGB")),
            pictureOption("png", listed(kEfforts, "|"), "normal", kGroup,
                          "Whether time or bytes are spared; the pixels are the same",
                          oneOf(kEfforts, &Options::png)),
            programOption("strict", "", kGroup, "Take every note for an error, and paint nothing",
                          flag(&Options::strict))};
}

std::vector<Setting> seriesSettings() {
    constexpr const char* kGroup = "Many pictures";
    return {programOption("batch", "FILE", kGroup,
                          "Paint the jobs of FILE, one JSON object a line; - for standard input",
                          text(&Options::batch)),
            programOption("shard", "I/N", kGroup,
                          "Of a batch every N-th job alone, from job I on, for other processes to do "
                          "the others",
                          readShard),
            programOption("skip-existing", "", kGroup,
                          "Leave the jobs of a batch out whose output is there and not empty",
                          flag(&Options::skipExisting)),
            programOption("jobs", "N", kGroup,
                          "Paint " + spelled(kJobs) +
                              " pictures of a batch, a sheet or a film at a time "
                              "(as many as there are cores)",
                          numberWithin(kJobs, &Options::jobs)),
            programOption("sheet", "", kGroup, "Paint TEXT in every preset, with their names",
                          flag(&Options::sheet)),
            programOption("sizes", "LIST", kGroup,
                          "Sizes of a sheet's columns, such as 24,48,96: " + spelled(kSheetSizes) +
                              " of " + spelled(kFontSize) + " pixels",
                          readSheetSizes)};
}

std::vector<Setting> reportSettings() {
    constexpr const char* kGroup = "Reports";
    return {
        programOption("list-presets", "", kGroup, "List the presets and what they show",
                      flag(&Options::listPresets)),
        programOption("explain", "", kGroup,
                      "Tell how the look is painted: order, margins, cache key; with TEXT also time and "
                      "memory",
                      flag(&Options::explain)),
        programOption("write-cpp", "", kGroup, "Print the look as C++ calls of the library",
                      flag(&Options::writeCpp)),
        programOption("print-key", "", kGroup, "Print the look's cache key in hexadecimal",
                      flag(&Options::printKey)),
        programOption("print-margins", "", kGroup, "Print the pixels that the effects need",
                      flag(&Options::printMargins)),
        programOption("report", "json", kGroup,
                      "Print where text and picture lie: baselines, boxes, margins, cache key, fonts, "
                      "missing characters; of a batch one line a job",
                      [](Options& options, const std::string& given) {
                          if (given != "json") refuse(given, "none of json");
                          options.report = true;
                      })};
}

std::vector<Setting> helpSettings() {
    constexpr const char* kGroup = "Help";
    Setting help = programOption("help", "", kGroup, "Print this help and exit", nullptr);
    help.letter = "h";
    return {
        help,
        programOption("version", "", kGroup, "Print the version and exit", flag(&Options::version)),
        programOption("man", "", kGroup, "Print the manual page, for man -l -", flag(&Options::manual)),
        programOption("completion", listed(kShells, "|"), kGroup, "Print the completions of a shell",
                      oneOf(kShells, &Options::completion))};
}

std::vector<Setting> allSettings() {
    std::vector<Setting> all;
    for (auto part :
         {textSettings(), fontSettings(), lookSettings(), canvasSettings(), cueSettings(),
          filmSettings(), outputSettings(), seriesSettings(), reportSettings(), helpSettings()}) {
        all.insert(all.end(), part.begin(), part.end());
    }
    return all;
}

}  // namespace

const std::vector<Setting>& settings() {
    static const std::vector<Setting> all = allSettings();
    return all;
}

const Setting& settingNamed(std::string_view name) {
    return *std::find_if(settings().begin(), settings().end(),
                         [&](const Setting& setting) { return setting.name == name; });
}

std::string optionName(const Setting& setting) {
    return setting.isPositional ? setting.value : "--" + setting.name;
}

std::vector<std::string> wordsOf(const Setting& setting) {
    std::vector<std::string> words;
    std::istringstream alternatives(setting.value);
    for (std::string word; std::getline(alternatives, word, '|');) {
        const bool literal = std::all_of(word.begin(), word.end(), [](char c) {
            return (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == '-';
        });
        if (literal) words.push_back(word);
    }
    return words;
}

}  // namespace vorelpaint
