#include "help_text.h"

#include "ranges.h"
#include "settings.h"
#include "style/vorelstyle.h"
#include "subtitle_reader.h"
#include "text/voreltext.h"
#include "wrap.h"

namespace vorelpaint {
namespace {

using voreltext::TextLayout;

constexpr size_t kHelpWidth = 100;

std::string joinedJobKeys() {
    std::vector<std::string> keys;
    for (const Setting& setting : settings()) {
        if (setting.inJobs) keys.push_back(setting.name);
    }
    return vorelstyle::joined(keys);
}

}  // namespace

const std::vector<std::string>& exampleCommands() {
    static const std::vector<std::string> commands{
        R"(vorelpaint --preset gold -o title.png "Once upon a time")",
        R"(vorelpaint --style look.json --size 160 --color '#3366CC' -o title.png "Title")",
        R"(vorelpaint --preset subtitle --align center --text-file lines.txt -o lines.png)",
        R"(fortune | vorelpaint --preset chalk --background '#204030' --text-file - -o - > page.png)",
        R"(vorelpaint --preset neon -o cold.png -- "-40 degrees")",
        R"(vorelpaint --batch titles.jsonl --font 'DejaVu Sans:bold')",
        R"(vorelpaint --sheet --background '#23272E' -o presets.png "Type")",
        R"(vorelpaint --preset subtitle --width 1920 --height 1080 --anchor bottom --margin 60 --fit wrap -o frame.png "A line of dialogue")",
        R"(vorelpaint --preset subtitle --box line --markup -o word.png "<c #FFD040>Sing</c> along")",
        R"(vorelpaint --subtitles talk.srt --over talk.mp4 --fade-in 150 --fade-out 150 -o film.mp4)",
        R"(vorelpaint --subtitles talk.vtt --cue-style Narrator=chalk -o cues.mov)",
        R"(vorelpaint --preset gold --explain "Type")",
        R"(vorelpaint --preset gold --write-cpp > gold.cpp)",
        R"(vorelpaint --list-presets)"};
    return commands;
}

const std::vector<Topic>& topics() {
    static const std::vector<Topic> all{
        {"Style files",
         "A style file is a JSON object with one object per effect (outerShadow, innerShadow, "
         "outerGlow, innerGlow, linearGradient, radialGradient, stroke, pattern, text, bevel, "
         "emboss), or with \"version\": 2 a list of such looks, painted one over the other; the "
         "last lies on top. A length is in pixels, or in percent of the font size: \"4%\". The "
         "presets are style files to start from. Where they and the page of every key lie stands "
         "under Files."},
        {"Fonts",
         "A font is a file, or a family that fontconfig knows, with styles and properties behind "
         "colons: 'DejaVu Sans:bold:italic', 'DejaVu Sans:weight=200'. A style that is misspelt, "
         "or that no face of the family has, is refused; italic and oblique stand for each other. "
         "Characters that a font lacks are taken from the next one that is given, then from an "
         "installed one; the first font alone sets baselines and line heights."},
        {"Canvas",
         "With a width or a height the text's box stands at the anchor within the margins, and what "
         "reaches beyond the picture is cut off. A text whose box is larger is left so, set in a "
         "smaller size (shrink) or in more lines (wrap), broken where UAX #14 allows it."},
        {"Markup",
         "With --markup, <c #F80>word</c> is painted in that colour. Tags may stand within each "
         "other. &lt; and &amp; are < and & themselves."},
        {"Notes",
         "What is painted otherwise than asked for is noted on standard error: characters that no "
         "font has, lengths beyond the library's 100 pixels, what a canvas cuts off, effects without "
         "a core. With --strict the first note is an error, and the picture is not painted."},
        {"Batches",
         "Each line of a batch is a JSON object with the keys of one picture: " + joinedJobKeys() +
             ". They mean what the options of these names mean; style may also be a style itself. "
             "What a job does not say, it takes from the command line. Paths start at the working "
             "directory. A line that fails is reported with its number, and the next one goes on. "
             "When two jobs have one output, nothing is painted. Neither --jobs nor --shard changes "
             "a picture, and what is said comes in the order of the lines. A run that was ended is "
             "finished by the same command with --skip-existing."},
        {"Films",
         "The cues of --subtitles are painted in frames of 1920 x 1080 pixels, or of the clip's sides; "
         "centred lines stand at the bottom, broken where they are too wide. The font has an "
         "eighteenth of the frame's shorter side, the margin a twentieth, and the "
         "look is the preset subtitle; options change all of it. A cue is seen in the frames that "
         "begin within its times. One that begins while others are seen stands above them. Of the "
         "files, times, texts and names are read, not their styles and places. A film has the alpha "
         "of its cues unless there is a clip or a background: .mov (prores, png), .webm (vp9), .mkv "
         "(ffv1, png, vp9); with either .mp4, .mov, .mkv (h264) and .webm (vp9). Raw frames (-, .rgba) "
         "are straight R, G, B, A. FFmpeg, which must be installed, reads clips and writes films; "
         "frames and numbered pictures do without."},
        {"Text",
         "Text is UTF-8; text that begins with - stands behind --. A line ends with LF, CR, CR "
         "LF, or one of U+0085, U+2028 and U+2029; a tab is painted as a blank. Any other control "
         "character is refused, with its place."},
        {"Limits",
         "A picture has at most " + std::to_string(TextLayout::kMaxSide) + " pixels on a side and " +
             std::to_string(voreltext::kMaxPixels) + " in all; a pattern's picture has at most " +
             std::to_string(kMaxPatternSide) + " pixels on a side. A text has at most " +
             std::to_string(kMaxTextBytes) + " bytes, a style file " + std::to_string(kMaxStyleBytes) +
             " and a line of a batch " + std::to_string(kMaxJobBytes) + ". A film has at most " +
             std::to_string(kLongestFilmMs / 3600000) + " hours and " + std::to_string(kMostCues) +
             " cues, in a file of at most " + std::to_string(kMaxSubtitleBytes) + " bytes."},
        {"Colours", "#RGB is short for #RRGGBB with twice the same digits: #F80 is #FF8800."},
        {"Files",
         "Where the program is installed, in /usr for a package: "
         "share/doc/vorelpaint/style-files.md lists every key of a style file, "
         "share/doc/vorelpaint/vorelpaint.md tells of batches and reports, "
         "share/doc/vorelpaint/captions.md has recipes for titles and captions, "
         "share/doc/vorelpaint/at-scale.md spreads batches over cores and machines, "
         "share/doc/vorelpaint/layer-styles.md translates the layer styles of design tools, "
         "share/doc/vorelpaint/film.md tells of films, "
         "share/voreleffect/presets has the presets, and "
         "share/voreleffect/vorelpaint-style.schema.json tells editors what a style file may hold."},
        {"Exit codes",
         "0 done. 2 failed, with one line on standard error; after a batch, with one for each job "
         "that failed and their count. A reader that went away is a failure of writing like any "
         "other."},
        {"Interruption",
         "A picture or a film takes its name when it is whole: whatever signal ends the program, no "
         "half-written one is left and an older one stays. Only SIGKILL and a loss of power can "
         "leave something: on a file system without unnamed files (O_TMPFILE), such as NFS or "
         "FAT, the begun picture as .vorelpaint.XXXXXX in its directory; on others, in the "
         "instant in which an older picture is replaced, the whole new one under such a name."}};
    return all;
}

std::string helpFooter() {
    std::string footer = "Examples:";
    for (const std::string& command : exampleCommands())
        footer += "\n  " + command;
    for (const Topic& topic : topics())
        footer += "\n\n" + topic.heading + ":\n" + wrapped(topic.text, kHelpWidth, 2);
    return footer;
}

}  // namespace vorelpaint
