#include "options.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <array>
#include <memory>
#include <string_view>
#include <utility>
#include <vector>

#include "console.h"
#include "error.h"
#include "file_io.h"
#include "film_request.h"
#include "help_text.h"
#include "settings.h"
#include "style/vorelstyle.h"

namespace vorelpaint {

namespace {

/// What cannot be asked for together, beside what checkCombination explains.
constexpr std::array<std::pair<const char*, const char*>, 33> kExclusions{{
    {"--text-file", "TEXT"},
    {"--preset", "--style"},
    {"--batch", "--output"},
    {"--batch", "--sheet"},
    {"--batch", "--sizes"},
    {"--batch", "--explain"},
    {"--batch", "--write-cpp"},
    {"--batch", "--print-key"},
    {"--batch", "--print-margins"},
    {"--sheet", "--style"},
    {"--sheet", "--preset"},
    {"--sheet", "--explain"},
    {"--sheet", "--write-cpp"},
    {"--sheet", "--print-key"},
    {"--sheet", "--print-margins"},
    {"--sheet", "--report"},
    {"--write-cpp", "--report"},
    {"--write-cpp", "--explain"},
    {"--write-cpp", "--print-key"},
    {"--write-cpp", "--print-margins"},
    {"--subtitles", "TEXT"},
    {"--subtitles", "--text-file"},
    {"--subtitles", "--markup"},
    {"--subtitles", "--batch"},
    {"--subtitles", "--sheet"},
    {"--subtitles", "--explain"},
    {"--subtitles", "--write-cpp"},
    {"--subtitles", "--print-key"},
    {"--subtitles", "--print-margins"},
    {"--subtitles", "--padding"},
    {"--over", "--width"},
    {"--over", "--height"},
    {"--over", "--background"},
}};

/// What is asked of a film alone.
constexpr std::array<const char*, 7> kOfFilms{"--over",      "--fps",   "--fade-in", "--fade-out",
                                              "--cue-style", "--codec", "--each"};

/// The value behind the name, and the default behind the description; the rest that CLI11 would tell,
/// such as what excludes what, is told when it matters.
class HelpFormatter : public CLI::Formatter {
  public:
    std::string make_option_opts(const CLI::Option* option) const override {
        const std::string value = option->get_type_name();
        return value.empty() ? "" : " " + value;
    }
    std::string make_option_desc(const CLI::Option* option) const override {
        const std::string initial = option->get_default_str();
        return option->get_description() + (initial.empty() ? "" : " [" + initial + "]");
    }
};

void addSetting(CLI::App& app, const Setting& setting, Options& options) {
    const std::string name = optionName(setting);
    const std::string names = setting.letter.empty() ? name : "-" + setting.letter + "," + name;
    const auto assign = [&setting, &options, name](const std::string& given) {
        try {
            setting.read(options, given);
        } catch (const ToolError& error) {
            throw CLI::ValidationError(name, error.what());
        }
    };
    const auto assignAll = [&setting, &options, assign](const std::vector<std::string>& given) {
        setting.forget(options);
        for (const std::string& each : given)
            assign(each);
    };
    CLI::Option* option = nullptr;
    if (!setting.read) {
        option = app.set_help_flag(names, setting.description);
    } else if (setting.kind == Setting::Kind::flag) {
        option = app.add_flag_callback(
            names, [assign] { assign("true"); }, setting.description);
    } else if (setting.kind == Setting::Kind::list) {
        option =
            app.add_option_function<std::vector<std::string>>(names, assignAll, setting.description);
        option->allow_extra_args(false);  // one behind each of them; the next word may be the text
        option->type_name(setting.value)->default_str(setting.initial);
    } else {
        option = app.add_option_function<std::string>(names, assign, setting.description);
        option->type_name(setting.isPositional ? "" : setting.value);
        option->default_str(setting.initial);
    }
    option->group(setting.group);
}

bool prints(const Options& options) {
    return options.printKey || options.printMargins || options.explain || options.writeCpp ||
           options.report;
}

void checkOutput(const Options& options) {
    if (!options.output && !prints(options)) {
        throw ToolError("nowhere to paint: give -o FILE, or -o - for standard output");
    }
    checkStandardOutput(options);
    if ((options.output || options.report) && !options.text && !options.textFile) {
        throw ToolError("nothing to paint: give TEXT, or --text-file FILE");
    }
    if (!options.sheetSizes.empty() && !options.sheet) {
        throw ToolError("--sizes are the columns of a --sheet; the size of one picture is --size");
    }
}

/// What is asked for beside what it is about.
void checkSeries(const Options& options) {
    if (options.shard && !options.batch) throw ToolError("--shard is a part of a --batch");
    if (options.skipExisting && !options.batch) {
        throw ToolError("--skip-existing leaves out jobs of a --batch");
    }
    if (options.jobs && !options.batch && !options.sheet && !options.film.subtitles) {
        throw ToolError("--jobs is for the pictures of --batch, --sheet or --subtitles");
    }
}

/// What is wrong with words that nothing was found for: an option, or else a second text.
std::string faultOf(const std::vector<std::string>& words) {
    const auto option = std::find_if(words.begin(), words.end(),
                                     [](const std::string& word) { return word.rfind('-', 0) == 0; });
    if (option == words.end()) {
        return inQuotes(words.front()) +
               " is one text too many; quotes keep the words of a text together";
    }
    const std::string given = option->substr(0, option->find('='));
    std::vector<std::string> names;
    for (const Setting& setting : settings()) {
        if (!setting.isPositional) names.push_back(setting.name);
    }
    const std::string meant =
        vorelstyle::nearest(given.substr(std::min(given.find_first_not_of('-'), given.size())), names);
    return "no option " + inQuotes(given) +
           (meant.empty() ? "; --help lists them" : "; did you mean --" + meant + "?");
}

/// Standard input can be read once, but each job reads what it is told to.
void checkBatch(const Options& options) {
    if (options.textFile == "-" || options.style == "-") {
        throw ToolError("the jobs of a batch cannot share standard input: name a file instead of -");
    }
}

void checkCombination(const Options& options) {
    const bool tells = options.listPresets || options.version || options.manual || options.completion;
    if (tells) return;
    checkSeries(options);
    if (options.batch) return checkBatch(options);
    if (options.film.subtitles) return checkFilm(options);
    checkOutput(options);
    checkCanvasOf(options);
}

}  // namespace

void checkCanvasOf(const Options& options) {
    checkCanvas(options);
    if (options.sheet && (options.canvas.width || options.canvas.height)) {
        throw ToolError("a sheet has the size of its cells; no width or height can be given");
    }
}

void checkStandardOutput(const Options& options) {
    if (prints(options) && options.output && isStandardOutput(*options.output)) {
        throw ToolError("standard output cannot take both the picture and what is printed");
    }
}

std::optional<Options> parseOptions(int argc, const char* const* argv) {
    Options options;
    CLI::App app(kPurpose, "vorelpaint");
    app.formatter(std::make_shared<HelpFormatter>());
    app.footer(helpFooter());
    for (const Setting& setting : settings())
        addSetting(app, setting, options);
    for (const auto& [one, other] : kExclusions)
        app.get_option(one)->excludes(app.get_option(other));
    for (const char* name : kOfFilms)
        app.get_option(name)->needs(app.get_option("--subtitles"));
    try {
        app.parse(argc, argv);
    } catch (const CLI::Success&) {
        print(app.help());
        return std::nullopt;
    } catch (const CLI::ExtrasError&) {
        throw ToolError(faultOf(app.remaining()));
    } catch (const CLI::ParseError& error) {
        throw ToolError(error.what());
    }
    if (options.film.subtitles) {
        takeFilmDefaults(options, [&](std::string_view name) {
            return app.get_option(optionName(settingNamed(name)))->count() > 0;
        });
    }
    checkCombination(options);
    return options;
}

}  // namespace vorelpaint
