/// The bytes are a job of a batch, one line of JSON. Either it is read, with every number in its range,
/// or it is refused with a ToolError of one line; nothing else may be thrown.
#include <cstdint>
#include <string>

#include "batch_job.h"
#include "demand.h"
#include "error.h"
#include "settings.h"

namespace {

using namespace vorel_fuzz;
using namespace vorelpaint;

void require(const Options& options) {
    demandIn(options.size, 1, 1000, "size");
    demandIn(options.canvas.padding, 0, 1000, "padding");
    demandIn(options.canvas.margin, 0, 8000, "margin");
    demandIn(options.canvas.width.value_or(1), 1, 16384, "width");
    demandIn(options.canvas.height.value_or(1), 1, 16384, "height");
    demandIn(double{options.lineHeight}, 0.5, 10, "line-height");
    demandIn(double{options.letterSpacing.value}, -200, 200, "letter-spacing");
    demandIn(static_cast<double>(options.fonts.size()), 1, 16, "fonts");
    demandIn(static_cast<double>(options.effectScale), static_cast<double>(0.05F), 20, "effect-scale");
    if (options.opacity) demandIn(static_cast<double>(*options.opacity), 0, 1, "opacity");
    if (options.color) demandColour(*options.color);
}

/// A first byte of 0 asks for the text as the value of each setting, as a command line gives it.
void readValues(const std::string& value) {
    for (const Setting& setting : settings()) {
        if (!setting.read) continue;
        Options options;
        try {
            setting.read(options, value);
            require(options);
        } catch (const ToolError& error) {
            // The value itself is quoted as it was given.
            if (value.find('\n') == std::string::npos) demandLine(error.what());
        }
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    if (size > 0 && data[0] == 0) {
        readValues(text.substr(1));
        return 0;
    }
    try {
        const Options options = parseJob(text, Options());
        require(options);
        if (!options.output) fail("a job without a picture was read");
        if (options.text.has_value() == options.textFile.has_value()) fail("a job needs one text");
        if (options.style && options.preset) fail("a job has two looks");
    } catch (const ToolError& error) {
        demandLine(error.what());
    }
    return 0;
}
