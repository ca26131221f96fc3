#include <exception>
#include <filesystem>
#include <new>
#include <optional>
#include <string>

#include "batch.h"
#include "completion.h"
#include "console.h"
#include "error.h"
#include "explain.h"
#include "film.h"
#include "interrupt.h"
#include "manual.h"
#include "options.h"
#include "painting.h"
#include "sheet.h"
#include "style/vorelstyle.h"
#include "style_file.h"
#include "voreleffect/VFVersion.h"

namespace vorelpaint {
namespace {

using vorelstyle::Style;
using voreltext::Margins;

constexpr int kFailed = 2;

void printPresets() {
    std::string lines;
    for (const std::string& name : presetNames()) {
        lines += name + std::string(name.size() < 12 ? 12 - name.size() : 1, ' ') +
                 vorelstyle::printable(loadStyle(findPreset(name)).description) + "\n";
    }
    print(lines);
}

void printMargins(const Margins& margins) {
    print("margins left " + std::to_string(margins.left) + " top " + std::to_string(margins.top) +
          " right " + std::to_string(margins.right) + " bottom " + std::to_string(margins.bottom) +
          "\n");
}

void printCpp(const Options& options, const Style& style) {
    const std::string name = options.preset.value_or(std::filesystem::path(style.name).stem().string());
    print(vorelstyle::writtenAsCpp(vorelstyle::functionName(name), style, options.color, options.opacity,
                                   imagesOf(style)));
}

void sayNote(const std::string& note) {
    say("note: " + note);
}

void printFacts(const Options& options, const LayerSet& looks, const Margins& margins) {
    if (options.writeCpp) printCpp(options, looks.style());
    if (options.printKey) print("key " + vorelstyle::hexadecimal(looks.stack().key()) + "\n");
    if (options.printMargins) printMargins(margins);
}

/// What is printed about a look that no text is given for.
void presentLook(const Options& options) {
    HeldNotes notes;
    const LayerSet looks = looksOf(options, {}, notes.taker());
    if (options.strict) notes.refuse();
    printFacts(options, looks, voreltext::marginsOf(looks.layers()));
    if (options.explain) print(explanationOf(options, looks));
    notes.giveTo(sayNote);
}

/// What is printed about a look and its picture.
void present(const Options& options) {
    if (!options.text && !options.textFile) return presentLook(options);
    const Composition composition = composed(options);
    printFacts(options, composition.looks(), composition.margins());
    if (options.explain) print(explanationOf(options, composition));
    handOver(options, painted(options, composition), sayNote);
}

void runBatch(const Options& options) {
    const BatchResult result = paintBatch(options);
    if (result.failed == 0) return;
    throw ToolError(std::to_string(result.failed) + " of " + std::to_string(result.jobs) +
                    " jobs failed");
}

void run(const Options& options) {
    if (options.version) {
        print(std::string("vorelpaint ") + VOREL_VERSION_STRING + "\n");
    } else if (options.manual) {
        print(manualPage());
    } else if (options.completion) {
        print(completionScript(*options.completion));
    } else if (options.listPresets) {
        printPresets();
    } else if (options.film.subtitles) {
        makeFilm(options, sayNote);
    } else if (options.batch) {
        runBatch(options);
    } else if (options.sheet) {
        paintSheet(options, sayNote);
    } else {
        present(options);
    }
}

int runProgram(int argc, const char* const* argv) {
    reserveStandardStreams();
    cleanUpOnSignals();
    try {
        const std::optional<Options> options = parseOptions(argc, argv);
        if (options) run(*options);
        return 0;
    } catch (const std::bad_alloc&) {
        say("not enough memory");
    } catch (const std::exception& error) {
        say(error.what());
    }
    return kFailed;
}

}  // namespace
}  // namespace vorelpaint

int main(int argc, char** argv) {
    return vorelpaint::runProgram(argc, argv);
}
