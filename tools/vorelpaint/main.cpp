#include <exception>
#include <filesystem>
#include <new>
#include <optional>
#include <sstream>
#include <string>

#include "batch.h"
#include "completion.h"
#include "console.h"
#include "error.h"
#include "explain.h"
#include "font_choice.h"
#include "interrupt.h"
#include "manual.h"
#include "options.h"
#include "painting.h"
#include "sheet.h"
#include "style/vorelstyle.h"
#include "style_file.h"
#include "text/voreltext.h"
#include "voreleffect/VFVersion.h"

namespace vorelpaint {
namespace {

using vorelstyle::Look;
using vorelstyle::Style;
using voreltext::Font;
using voreltext::Margins;
using voreltext::marginsOf;
using voreltext::TextLayout;

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
    std::ostringstream source;
    vorelstyle::writeCpp(source, vorelstyle::functionName(name), style, options.color, options.opacity,
                         imagesOf(style));
    print(source.str());
}

void printExplanation(const Options& options, const Style& style, Look& look, const TextLayout* text) {
    std::ostringstream lines;
    explain(lines, options, style, look, text);
    print(lines.str());
}

/// What is printed about a look, and its picture.
void present(const Options& options) {
    const Style style = chosenStyle(options);
    Look look = makeLook(options, style, say);
    if (options.writeCpp) printCpp(options, style);
    if (options.printKey) print("key " + vorelstyle::hexadecimal(look.key()) + "\n");
    if (options.printMargins) printMargins(marginsOf(look.effects()));
    if (!options.text && !options.textFile) {
        if (options.explain) printExplanation(options, style, look, nullptr);
        return;
    }
    if (!options.explain && !options.output) return;
    const Font font(findFont(options.font), options.size);
    const TextLayout text = layOutText(options, font, say);
    if (options.explain) printExplanation(options, style, look, &text);
    if (options.output) writePicture(options, paint(look.effects(), text, options.padding));
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
    } else if (options.batch) {
        runBatch(options);
    } else if (options.sheet) {
        paintSheet(options, say);
    } else {
        present(options);
    }
}

int runProgram(int argc, const char* const* argv) {
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
